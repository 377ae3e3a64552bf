#include "MTSourceItemSubDlg.h"

#include "MTSourceKiv.h"
#include "widgets/FemInDataDlg.h"
#include "widgets/HDSourceGisPropSheet.h"

#include <QComboBox>
#include <QGridLayout>
#include <QGroupBox>
#include <QLabel>
#include <QPushButton>
#include <QSignalBlocker>
#include <QVBoxLayout>

IMPLEMENT_DYNCREATE_DLG(CMTSourceItemSubDlg)

CMTSourceItemSubDlg::CMTSourceItemSubDlg(QWidget* parent)
    : CZoSEDlgBase(parent), m_type(new QComboBox(this)),
      m_viewLocation(new QPushButton("View location ...", this)) {
    HelpID(5039);
    m_type->setObjectName("typeOfComponent");
    m_viewLocation->setObjectName("viewLocation");
    auto* top = new QGridLayout;
    auto* label = new QLabel("Type of component", this);
    label->setBuddy(m_type);
    top->addWidget(label, 0, 0);
    top->addWidget(m_type, 0, 1);
    top->addWidget(m_viewLocation, 0, 2);
    top->setColumnStretch(1, 1);
    auto* frame = new QGroupBox("Value", this);
    m_subForms = new CSubFormCollection(frame);
    m_subForms->setObjectName("valueForms");
    auto* inner = new QVBoxLayout(frame);
    inner->addWidget(m_subForms);
    auto* layout = new QVBoxLayout(this);
    layout->addLayout(top);
    layout->addWidget(frame);
    layout->addStretch(1);
    connect(m_type, &QComboBox::activated, this, &CMTSourceItemSubDlg::OnTypeChosen);
    connect(m_viewLocation, &QPushButton::clicked, this, &CMTSourceItemSubDlg::OnViewLocation);
}

void CMTSourceItemSubDlg::Initialize() {
    m_subForms->CreateSubForms(this);
    if (CFemInDataDlg* form = m_subForms->SubForm(0))
        form->setObjectName("value");
    m_subForms->ShowSubForm(0);
    {
        const QSignalBlocker block(m_type);
        m_type->addItem("Specified concentration");
        m_type->addItem("Excess concentration");
        m_type->setCurrentIndex(0);
    }
    CZoSEDlgBase::Initialize();
}

void CMTSourceItemSubDlg::SetData() {
    if (const auto* component = Section<CMTSourceItemSubKiv>()) {
        const QSignalBlocker block(m_type);
        const int type = component->TypeOfComponent();
        // A type read from a file that no entry stands for selects none.
        m_type->setCurrentIndex(type >= 0 && type < m_type->count() ? type : -1);
    }
    CZoSEDlgBase::SetData();
    m_subForms->SetData();
}

void CMTSourceItemSubDlg::OnTypeChosen(int index) {
    auto* component = Section<CMTSourceItemSubKiv>();
    if (!component || index < 0)
        return;
    component->TypeOfComponent(index);
    UpdateDoc(kHintValueChanged);
}

void CMTSourceItemSubDlg::OnViewLocation() {
    const auto* component = Section<CMTSourceItemSubKiv>();
    const auto* source = component ? dynamic_cast<const CZoSEKivBase*>(component->GetParent()) : nullptr;
    CHDSourceGisPropSheet::SetInitialSelectedPage(0);
    CHDSourceGisPropSheet::SetInitialSelectedFeature(source ? source->GetNumberWhatAmI() : 0);
    if (component)
        SelectTreeItem(MTSources(component));
}
