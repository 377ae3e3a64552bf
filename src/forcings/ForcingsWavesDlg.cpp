#include "ForcingsWavesDlg.h"

#include "ForcingsWaveDBDlg.h"
#include "ForcingsWavesKiv.h"
#include "MTWaveFieldDlg.h"
#include "widgets/ZoNumberEdit.h"

#include <QCheckBox>
#include <QComboBox>
#include <QGridLayout>
#include <QGroupBox>
#include <QLabel>
#include <QRadioButton>
#include <QSignalBlocker>
#include <QStackedWidget>
#include <QVBoxLayout>

IMPLEMENT_DYNCREATE_DLG(CForcingsWavesDlg)

namespace {
constexpr long kFactorGroup = 999;
constexpr long kWaterDepthGroup = 100000;
constexpr int kFieldForm = 0;
constexpr int kDatabaseForm = 1;
}  // namespace

CForcingsWavesDlg::CForcingsWavesDlg(QWidget* parent)
    : CZoSEDlgBase(parent), m_type(new QComboBox(this)), m_subForms(new QStackedWidget(this)),
      m_liquefactionFrame(new QGroupBox(this)),
      m_liquefaction(new QCheckBox("Include Liquefaction", m_liquefactionFrame)),
      m_factorLabel(new QLabel("Liquefaction Factor", m_liquefactionFrame)),
      m_factor(new CZoNumberEdit(CZoEditStyle().SetOvuUnitBaseGroup(kFactorGroup),
                                 m_liquefactionFrame)),
      m_factorUnit(new QLabel(m_liquefactionFrame)),
      m_minimumDepthLabel(new QLabel("Minimum Water Depth", this)),
      m_minimumDepth(
          new CZoNumberEdit(CZoEditStyle().SetOvuUnitBaseGroup(kWaterDepthGroup), this)),
      m_minimumDepthUnit(new QLabel(this)),
      m_shearStress(new QGroupBox("Shear Stress Formulation", this)) {
    HelpID(5003);
    m_type->setObjectName("type");
    m_subForms->setObjectName("subForms");
    m_liquefactionFrame->setObjectName("liquefactionFrame");
    m_liquefaction->setObjectName("includeLiquefaction");
    m_factorLabel->setObjectName("liquefactionFactorLabel");
    m_factor->setObjectName("liquefactionFactor");
    m_factorUnit->setObjectName("liquefactionFactorUnit");
    m_minimumDepthLabel->setObjectName("minimumWaterDepthLabel");
    m_minimumDepth->setObjectName("minimumWaterDepth");
    m_minimumDepthUnit->setObjectName("minimumWaterDepthUnit");
    m_shearStress->setObjectName("shearStressFormulation");
    m_factorLabel->setBuddy(m_factor);
    m_minimumDepthLabel->setBuddy(m_minimumDepth);

    auto* typeLabel = new QLabel("Type", this);
    typeLabel->setBuddy(m_type);
    auto* typeRow = new QHBoxLayout;
    typeRow->addWidget(typeLabel);
    typeRow->addWidget(m_type);
    typeRow->addStretch(1);

    auto* liquefaction = new QGridLayout(m_liquefactionFrame);
    liquefaction->addWidget(m_liquefaction, 0, 0, 1, 3);
    liquefaction->addWidget(m_factorLabel, 1, 0);
    liquefaction->addWidget(m_factor, 1, 1);
    liquefaction->addWidget(m_factorUnit, 1, 2);
    liquefaction->setColumnStretch(3, 1);

    auto* depth = new QHBoxLayout;
    depth->addWidget(m_minimumDepthLabel);
    depth->addWidget(m_minimumDepth);
    depth->addWidget(m_minimumDepthUnit);
    depth->addStretch(1);

    auto* shear = new QVBoxLayout(m_shearStress);
    const std::vector<CString>& texts = CForcingsWavesKiv::ShearStressTexts();
    for (int i = 0; i < static_cast<int>(m_shearButtons.size()); ++i) {
        auto* b = new QRadioButton(QString::fromStdString(texts[static_cast<size_t>(i)]),
                                   m_shearStress);
        b->setObjectName(QString("shearStress%1").arg(i));
        shear->addWidget(b);
        connect(b, &QRadioButton::clicked, this, [this, i] { OnShearStressClicked(i); });
        m_shearButtons[static_cast<size_t>(i)] = b;
    }
    // Not offered by the engine.
    m_shearButtons[1]->setEnabled(false);

    auto* layout = new QVBoxLayout(this);
    layout->addLayout(typeRow);
    layout->addWidget(m_subForms);
    layout->addWidget(m_liquefactionFrame);
    layout->addLayout(depth);
    layout->addWidget(m_shearStress);
    layout->addStretch(1);

    connect(m_type, &QComboBox::activated, this, &CForcingsWavesDlg::OnTypeChosen);
    connect(m_liquefaction, &QCheckBox::clicked, this, &CForcingsWavesDlg::OnLiquefactionClicked);
}

CForcingsWavesKiv* CForcingsWavesDlg::Waves() const { return Section<CForcingsWavesKiv>(); }

QRadioButton* CForcingsWavesDlg::ShearStressButton(int formulation) const {
    if (formulation < 0 || formulation >= static_cast<int>(m_shearButtons.size()))
        return nullptr;
    return m_shearButtons[static_cast<size_t>(formulation)];
}

void CForcingsWavesDlg::Initialize() {
    if (CForcingsWavesKiv* w = Waves()) {
        m_fieldForm = new CMTWaveFieldDlg(w->WaveField(), this, m_subForms);
        m_databaseForm = new CForcingsWaveDBDlg(w->WaveDatabase(), this, m_subForms);
        m_subForms->insertWidget(kFieldForm, m_fieldForm);
        m_subForms->insertWidget(kDatabaseForm, m_databaseForm);
        {
            const QSignalBlocker block(m_type);
            m_type->clear();
            for (int type : w->AvailableWaveTypes())
                m_type->addItem(QString::fromStdString(CForcingsWavesKiv::WaveTypeText(type)),
                                type);
        }
        m_factor->BindDouble(
            this, [this] { return Waves()->LiquefactionFactor(); },
            [this](double v) { Waves()->LiquefactionFactor(v); });
        m_minimumDepth->BindDouble(
            this, [this] { return Waves()->MinimumWaterDepth(); },
            [this](double v) { Waves()->MinimumWaterDepth(v); });
    }
    m_subForms->hide();
    CZoSEDlgBase::Initialize();
}

void CForcingsWavesDlg::SetData() {
    CZoSEDlgBase::SetData();
    CForcingsWavesKiv* w = Waves();
    if (!w)
        return;
    const int type = w->WaveType();
    {
        const QSignalBlocker blockType(m_type);
        const QSignalBlocker blockLiquefaction(m_liquefaction);
        // A stored type that is not offered matches no entry.
        m_type->setCurrentIndex(m_type->findData(type));
        m_liquefaction->setChecked(w->IncludeLiquefaction());
        // A stored formulation outside the four checks none, so exclusivity is off meanwhile.
        for (int i = 0; i < static_cast<int>(m_shearButtons.size()); ++i) {
            QRadioButton* b = m_shearButtons[static_cast<size_t>(i)];
            b->setAutoExclusive(false);
            b->setChecked(i == w->ShearStressFormulation());
            b->setAutoExclusive(true);
        }
    }
    m_factorUnit->setText(QString::fromStdString(m_factor->Style().UnitName()));
    m_minimumDepthUnit->setText(QString::fromStdString(m_minimumDepth->Style().UnitName()));

    if (type == CForcingsWavesKiv::kWaveField && m_fieldForm) {
        m_subForms->setCurrentIndex(kFieldForm);
        m_subForms->show();
        m_fieldForm->SetData();
    } else if (type == CForcingsWavesKiv::kWaveDatabase && m_databaseForm) {
        m_subForms->setCurrentIndex(kDatabaseForm);
        m_subForms->show();  // the grid fits itself to where it is shown
        m_databaseForm->SetData();
    } else {
        m_subForms->hide();
    }

    // Without waves nothing below the type applies; the values are kept all the same.
    const bool waves = type != CForcingsWavesKiv::kNoWaves;
    m_liquefactionFrame->setVisible(waves);
    m_minimumDepthLabel->setVisible(waves);
    m_minimumDepth->setVisible(waves);
    m_minimumDepthUnit->setVisible(waves);
    m_shearStress->setVisible(waves);
    const bool liquefaction = w->IncludeLiquefaction();
    m_factorLabel->setEnabled(liquefaction);
    m_factor->setEnabled(liquefaction);
    m_factorUnit->setEnabled(liquefaction);
}

void CForcingsWavesDlg::OnTypeChosen(int index) {
    CForcingsWavesKiv* w = Waves();
    if (!w || index < 0)
        return;
    w->WaveType(m_type->itemData(index).toInt());
    UpdateDoc(kHintValueChanged);
}

void CForcingsWavesDlg::OnLiquefactionClicked() {
    if (CForcingsWavesKiv* w = Waves()) {
        w->IncludeLiquefaction(m_liquefaction->isChecked());
        UpdateDoc(kHintValueChanged);
    }
}

void CForcingsWavesDlg::OnShearStressClicked(int formulation) {
    if (CForcingsWavesKiv* w = Waves()) {
        w->ShearStressFormulation(formulation);
        UpdateDoc(kHintValueChanged);
    }
}
