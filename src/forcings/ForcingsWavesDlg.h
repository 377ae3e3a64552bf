#pragma once

#include "widgets/ZoSEDlgBase.h"

#include <array>

class CForcingsWavesKiv;
class CForcingsWaveDBDlg;
class CMTWaveFieldDlg;
class CZoNumberEdit;
class QCheckBox;
class QComboBox;
class QGroupBox;
class QLabel;
class QRadioButton;
class QStackedWidget;

// Where the waves come from, with the sub-form of the wave field or the wave database, and
// the settings that hold for every kind of waves.
class CForcingsWavesDlg : public CZoSEDlgBase {
    Q_OBJECT
public:
    explicit CForcingsWavesDlg(QWidget* parent = nullptr);
    void Initialize() override;
    void SetData() override;

    QComboBox* TypeBox() const { return m_type; }
    QStackedWidget* SubForms() const { return m_subForms; }
    CMTWaveFieldDlg* WaveFieldForm() const { return m_fieldForm; }
    CForcingsWaveDBDlg* WaveDatabaseForm() const { return m_databaseForm; }
    QCheckBox* LiquefactionBox() const { return m_liquefaction; }
    CZoNumberEdit* LiquefactionFactorEdit() const { return m_factor; }
    CZoNumberEdit* MinimumDepthEdit() const { return m_minimumDepth; }
    QRadioButton* ShearStressButton(int formulation) const;

private:
    CForcingsWavesKiv* Waves() const;
    void OnTypeChosen(int index);
    void OnLiquefactionClicked();
    void OnShearStressClicked(int formulation);

    QComboBox* m_type;
    QStackedWidget* m_subForms;
    CMTWaveFieldDlg* m_fieldForm = nullptr;
    CForcingsWaveDBDlg* m_databaseForm = nullptr;
    QGroupBox* m_liquefactionFrame;
    QCheckBox* m_liquefaction;
    QLabel* m_factorLabel;
    CZoNumberEdit* m_factor;
    QLabel* m_factorUnit;
    QLabel* m_minimumDepthLabel;
    CZoNumberEdit* m_minimumDepth;
    QLabel* m_minimumDepthUnit;
    QGroupBox* m_shearStress;
    std::array<QRadioButton*, 4> m_shearButtons{};
};
