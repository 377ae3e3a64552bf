#include "MTBedValueDlg.h"

#include "fem/FemInDataKiv.h"
#include "widgets/FemInDataDlg.h"

#include <QGroupBox>
#include <QVBoxLayout>

CMTBedValueDlg::CMTBedValueDlg(unsigned long helpId, QWidget* parent) : CZoSEDlgBase(parent) {
    HelpID(helpId);
    auto* frame = new QGroupBox(this);
    m_forms = new CSubFormCollection(frame);
    m_forms->setObjectName("subForms");
    auto* inner = new QVBoxLayout(frame);
    inner->addWidget(m_forms);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(frame);
    layout->addStretch(1);
}

void CMTBedValueDlg::Initialize() {
    if (CFemInDataKiv* value = Value())
        m_forms->ShowSubForm(m_forms->CreateSubForm(new CFemInDataDlg(value, this, m_forms)));
    CZoSEDlgBase::Initialize();
}

void CMTBedValueDlg::SetData() {
    CZoSEDlgBase::SetData();
    m_forms->SetData();
}
