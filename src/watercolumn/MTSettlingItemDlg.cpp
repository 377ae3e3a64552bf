#include "MTSettlingItemDlg.h"

#include "MTSettlingKiv.h"
#include "widgets/FemInDataDlg.h"

#include <QGroupBox>
#include <QVBoxLayout>

IMPLEMENT_DYNCREATE_DLG(CMTSettlingItemDlg)

namespace {
enum SubForm { kConstantVelocity = 0, kCoefficient = 1 };
}

CMTSettlingItemDlg::CMTSettlingItemDlg(QWidget* parent)
    : CZoSEDlgBase(parent), m_frame(new QGroupBox(this)),
      m_subForms(new CSubFormCollection(m_frame)) {
    HelpID(5035);
    m_frame->setObjectName("settlingValueFrame");
    m_subForms->setObjectName("settlingValues");
    auto* inner = new QVBoxLayout(m_frame);
    inner->addWidget(m_subForms);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(m_frame);
    layout->addStretch(1);
}

CMTSettlingItemKiv* CMTSettlingItemDlg::Item() const {
    return Section<CMTSettlingItemKiv>();
}

void CMTSettlingItemDlg::Initialize() {
    // One sub-form per value, in the item's order: constant velocity, then coefficient.
    m_subForms->CreateSubForms(this);
    if (CFemInDataDlg* constant = m_subForms->SubForm(kConstantVelocity))
        constant->setObjectName("constantSettlingVelocity");
    if (CFemInDataDlg* coefficient = m_subForms->SubForm(kCoefficient))
        coefficient->setObjectName("settlingVelocityCoefficient");
    CZoSEDlgBase::Initialize();
}

void CMTSettlingItemDlg::SetData() {
    CZoSEDlgBase::SetData();
    CMTSettlingItemKiv* item = Item();
    const auto* section = item ? dynamic_cast<const CMTSettlingKiv*>(item->GetParent()) : nullptr;
    if (!section)
        return;
    // The value the section's choice needs is the one in use, even before validation.
    item->UpdateValuesInUse();
    const int shown = section->Flocculation() < 1 ? kConstantVelocity : kCoefficient;
    m_subForms->ShowSubForm(shown);
    m_subForms->SetData();
    if (CFemInDataDlg* form = m_subForms->SubForm(shown))
        m_frame->setTitle(QString::fromStdString(form->Data()->GetTitle()));
}
