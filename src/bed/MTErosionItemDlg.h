#pragma once

#include "widgets/ZoSEDlgBase.h"

class CMTErosionItemKiv;
class CSubFormCollection;
class CZoNumberEdit;
class QRadioButton;

// The erosion law of one layer: mud type, power of erosion, erosion coefficient and critical
// shear stress.
class CMTErosionItemDlg : public CZoSEDlgBase {
    Q_OBJECT
public:
    explicit CMTErosionItemDlg(QWidget* parent = nullptr);
    void Initialize() override;
    void SetData() override;

    QRadioButton* SoftMudButton() const { return m_soft; }
    QRadioButton* HardMudButton() const { return m_hard; }
    CZoNumberEdit* PowerEdit() const { return m_power; }
    CSubFormCollection* CoefficientForm() const { return m_coefficient; }
    CSubFormCollection* ShearStressForm() const { return m_shearStress; }

private:
    CMTErosionItemKiv* Item() const;
    void OnMudType(bool soft);

    QRadioButton* m_soft;
    QRadioButton* m_hard;
    CZoNumberEdit* m_power;
    CSubFormCollection* m_coefficient;
    CSubFormCollection* m_shearStress;
};
