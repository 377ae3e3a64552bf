#include "MTDepositionItemDlg.h"

#include "MTDepositionKiv.h"
#include "widgets/FemInDataDlg.h"

#include <QGroupBox>
#include <QVBoxLayout>

IMPLEMENT_DYNCREATE_DLG(CMTDepositionItemDlg)

CMTDepositionItemDlg::CMTDepositionItemDlg(QWidget* parent) : CZoSEDlgBase(parent) {
    HelpID(5020);
    auto* frame = new QGroupBox("Critical Shear Stress", this);
    m_subForms = new CSubFormCollection(frame);
    m_subForms->setObjectName("criticalShearStressForms");
    auto* inner = new QVBoxLayout(frame);
    inner->addWidget(m_subForms);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(frame);
    layout->addStretch(1);
}

void CMTDepositionItemDlg::Initialize() {
    m_subForms->CreateSubForms(this);
    if (CFemInDataDlg* form = m_subForms->SubForm(0))
        form->setObjectName("criticalShearStress");
    m_subForms->ShowSubForm(0);
    CZoSEDlgBase::Initialize();
}

void CMTDepositionItemDlg::SetData() {
    CZoSEDlgBase::SetData();
    m_subForms->SetData();
}
