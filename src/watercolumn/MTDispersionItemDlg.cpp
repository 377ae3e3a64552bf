#include "MTDispersionItemDlg.h"

#include "MTDispersionKiv.h"
#include "widgets/FemInDataDlg.h"

#include <QComboBox>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QPointer>
#include <QSignalBlocker>
#include <QVBoxLayout>

IMPLEMENT_DYNCREATE_DLG(CMTDispersionItemDlg)

CMTDispersionItemDlg::CMTDispersionItemDlg(QWidget* parent)
    : CZoSEDlgBase(parent), m_formulation(new QComboBox(this)), m_upperFrame(new QGroupBox(this)),
      m_lowerFrame(new QGroupBox(this)) {
    HelpID(5023);
    m_formulation->setObjectName("formulation");
    auto* label = new QLabel("Formulation", this);
    label->setBuddy(m_formulation);
    auto* row = new QHBoxLayout;
    row->addWidget(label);
    row->addWidget(m_formulation);
    row->addStretch(1);
    auto* layout = new QVBoxLayout(this);
    layout->addLayout(row);
    layout->addWidget(m_upperFrame);
    layout->addWidget(m_lowerFrame);
    layout->addStretch(1);
    connect(m_formulation, &QComboBox::activated, this, &CMTDispersionItemDlg::OnFormulation);
}

CMTDispersionItemKiv* CMTDispersionItemDlg::Item() const {
    return Section<CMTDispersionItemKiv>();
}

void CMTDispersionItemDlg::Initialize() {
    for (int type = CMTDispersionItemKiv::kNoDispersion;
         type <= CMTDispersionItemKiv::kScaledEddyViscosity; ++type)
        m_formulation->addItem(QString::fromStdString(CMTDispersionItemKiv::FormulationText(type)));
    if (CMTDispersionItemKiv* item = Item()) {
        // The values are the item's own, not child nodes: one sub-form each, in its frame.
        auto place = [this](QGroupBox* frame, CFemInDataKiv* value, const char* name) {
            frame->setTitle(QString::fromStdString(value->GetTitle()));
            auto* form = new CFemInDataDlg(value, this, frame);
            form->setObjectName(name);
            auto* inner = new QVBoxLayout(frame);
            inner->addWidget(form);
            return form;
        };
        m_eddyViscosity = place(m_upperFrame, item->ScaledEddyViscosity(), "scaledEddyViscosity");
        m_coefficient = place(m_lowerFrame, item->DispersionCoefficient(), "dispersionCoefficient");
        UpdateSubForms();
    }
    CZoSEDlgBase::Initialize();
}

void CMTDispersionItemDlg::SetData() {
    CZoSEDlgBase::SetData();
    CMTDispersionItemKiv* item = Item();
    if (!item)
        return;
    {
        // A type no entry stands for (kept from the file) shows no entry.
        const QSignalBlocker block(m_formulation);
        const int type = item->FormulationType();
        m_formulation->setCurrentIndex(type >= 0 && type < m_formulation->count() ? type : -1);
    }
    for (CFemInDataDlg* form : {m_eddyViscosity, m_coefficient})
        if (form)
            form->SetData();
}

void CMTDispersionItemDlg::OnFormulation(int index) {
    CMTDispersionItemKiv* item = Item();
    if (!item || index < 0)
        return;
    item->FormulationType(index);
    item->ScaledEddyViscosity()->Type(index);
    item->DispersionCoefficient()->Type(index);
    QPointer<CMTDispersionItemDlg> self(this);
    UpdateDoc(kHintValueChanged);
    if (self)
        UpdateSubForms();
}

void CMTDispersionItemDlg::UpdateSubForms() {
    CMTDispersionItemKiv* item = Item();
    if (!item || !m_eddyViscosity || !m_coefficient)
        return;
    // Only the chosen formulation's value is in use; no dispersion uses neither.
    item->UpdateValuesInUse();
    m_eddyViscosity->EnableControls(!item->ScaledEddyViscosity()->IsDisabled());
    m_coefficient->EnableControls(!item->DispersionCoefficient()->IsDisabled());
}
