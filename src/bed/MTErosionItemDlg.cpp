#include "MTErosionItemDlg.h"

#include "MTErosionItemKiv.h"
#include "widgets/FemInDataDlg.h"
#include "widgets/ZoNumberEdit.h"

#include <QGridLayout>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QRadioButton>
#include <QSignalBlocker>
#include <QVBoxLayout>

IMPLEMENT_DYNCREATE_DLG(CMTErosionItemDlg)

namespace {
constexpr long kPowerGroup = 999;

// The place of a data-input value's sub-form: a frame, titled with the value's title once
// the dialog knows its item.
CSubFormCollection* AddValueFrame(QWidget* parent, QVBoxLayout* layout, const char* name) {
    auto* frame = new QGroupBox(parent);
    auto* inner = new QVBoxLayout(frame);
    auto* forms = new CSubFormCollection(frame);
    forms->setObjectName(name);
    inner->addWidget(forms);
    layout->addWidget(frame);
    return forms;
}
} // namespace

CMTErosionItemDlg::CMTErosionItemDlg(QWidget* parent)
    : CZoSEDlgBase(parent), m_soft(new QRadioButton("Soft mud", this)),
      m_hard(new QRadioButton("Hard mud", this)),
      m_power(new CZoNumberEdit(CZoEditStyle().SetOvuUnitBaseGroup(kPowerGroup), this)) {
    HelpID(5026);
    m_soft->setObjectName("softMud");
    m_hard->setObjectName("hardMud");
    m_power->setObjectName("powerOfErosion");

    auto* layout = new QVBoxLayout(this);

    auto* description = new QGroupBox("Erosion description", this);
    auto* radios = new QHBoxLayout(description);
    radios->addWidget(m_soft);
    radios->addWidget(m_hard);
    radios->addStretch(1);
    layout->addWidget(description);

    auto* power = new QGroupBox("Power of erosion", this);
    auto* powerRow = new QGridLayout(power);
    auto* label = new QLabel("Value", power);
    label->setBuddy(m_power);
    powerRow->addWidget(label, 0, 0);
    powerRow->addWidget(m_power, 0, 1);
    powerRow->setColumnStretch(2, 1);
    layout->addWidget(power);

    m_coefficient = AddValueFrame(this, layout, "erosionCoefficient");
    m_shearStress = AddValueFrame(this, layout, "criticalShearStress");
    layout->addStretch(1);

    connect(m_soft, &QRadioButton::clicked, this, [this] { OnMudType(true); });
    connect(m_hard, &QRadioButton::clicked, this, [this] { OnMudType(false); });
}

CMTErosionItemKiv* CMTErosionItemDlg::Item() const {
    return Section<CMTErosionItemKiv>();
}

void CMTErosionItemDlg::Initialize() {
    if (CMTErosionItemKiv* item = Item()) {
        m_power->BindDouble(
            this, [this] { return Item()->PowerOfErosion(); },
            [this](double power) { Item()->PowerOfErosion(power); });
        auto frame = [&](CSubFormCollection* forms, CFemInDataKiv* value) {
            static_cast<QGroupBox*>(forms->parentWidget())
                ->setTitle(QString::fromStdString(value->GetTitle()));
            forms->ShowSubForm(forms->CreateSubForm(new CFemInDataDlg(value, this, forms)));
        };
        frame(m_coefficient, item->ErosionCoefficient());
        frame(m_shearStress, item->CriticalShearStress());
    }
    CZoSEDlgBase::Initialize();
}

void CMTErosionItemDlg::SetData() {
    CZoSEDlgBase::SetData();
    CMTErosionItemKiv* item = Item();
    if (!item)
        return;
    {
        const QSignalBlocker blockSoft(m_soft);
        const QSignalBlocker blockHard(m_hard);
        (item->SoftMud() ? m_soft : m_hard)->setChecked(true);
    }
    m_coefficient->SetData();
    m_shearStress->SetData();
}

void CMTErosionItemDlg::OnMudType(bool soft) {
    CMTErosionItemKiv* item = Item();
    if (!item)
        return;
    // Only an actual change of type replaces the power of erosion (the item's setter).
    item->SoftMud(soft);
    UpdateDoc(kHintValueChanged);
}
