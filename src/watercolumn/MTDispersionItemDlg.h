#pragma once

#include "widgets/ZoSEDlgBase.h"

class CFemInDataDlg;
class CMTDispersionItemKiv;
class QComboBox;
class QGroupBox;

// One fraction's formulation and its two values; only the chosen formulation's value is
// open for editing.
class CMTDispersionItemDlg : public CZoSEDlgBase {
    Q_OBJECT
public:
    explicit CMTDispersionItemDlg(QWidget* parent = nullptr);
    void Initialize() override;
    void SetData() override;

    QComboBox* FormulationBox() const { return m_formulation; }
    CFemInDataDlg* ScaledEddyViscosityForm() const { return m_eddyViscosity; }
    CFemInDataDlg* DispersionCoefficientForm() const { return m_coefficient; }

private:
    CMTDispersionItemKiv* Item() const;
    void OnFormulation(int index);
    void UpdateSubForms();

    QComboBox* m_formulation;
    QGroupBox* m_upperFrame;
    QGroupBox* m_lowerFrame;
    CFemInDataDlg* m_eddyViscosity = nullptr;
    CFemInDataDlg* m_coefficient = nullptr;
};
