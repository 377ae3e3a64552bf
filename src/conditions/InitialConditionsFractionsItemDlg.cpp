#include "InitialConditionsFractionsItemDlg.h"

#include "widgets/FemInDataDlg.h"

#include <QGroupBox>
#include <QVBoxLayout>

IMPLEMENT_DYNCREATE_DLG(CInitialConditionsFractionsItemDlg)

CInitialConditionsFractionsItemDlg::CInitialConditionsFractionsItemDlg(QWidget* parent) : CZoSEDlgBase(parent) {
    HelpID(5008);
    auto* frame = new QGroupBox("Initial concentration", this);
    m_subForms = new CSubFormCollection(frame);
    m_subForms->setObjectName("valueForms");
    auto* inner = new QVBoxLayout(frame);
    inner->addWidget(m_subForms);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(frame);
    layout->addStretch(1);
}

void CInitialConditionsFractionsItemDlg::Initialize() {
    m_subForms->CreateSubForms(this);
    if (CFemInDataDlg* form = m_subForms->SubForm(0))
        form->setObjectName("value");
    m_subForms->ShowSubForm(0);
    CZoSEDlgBase::Initialize();
}

void CInitialConditionsFractionsItemDlg::SetData() {
    CZoSEDlgBase::SetData();
    m_subForms->SetData();
}
