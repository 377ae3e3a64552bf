#pragma once

#include "MTWaterColumnDlgSupport.h"
#include "widgets/ZoSEDlgBase.h"

class CMTSettlingGrid;
class CMTSettlingKiv;
class QCheckBox;
class QGroupBox;
class QRadioButton;

// Flocculation and hindered settling, the constants they need, and the fractions' settling
// values: constant velocities without flocculation, coefficients with it.
class CMTSettlingDlg : public CZoSEDlgBase {
    Q_OBJECT
public:
    explicit CMTSettlingDlg(QWidget* parent = nullptr);
    void Initialize() override;
    void SetData() override;

    CMTSettlingGrid* ConstantGrid() const { return m_constantGrid; }
    CMTSettlingGrid* CoefficientGrid() const { return m_coefficientGrid; }

private:
    CMTSettlingKiv* Settling() const;
    // Stores the five choices and tells the document.
    void Store();

    QRadioButton* m_flocculation;
    QRadioButton* m_constant;
    QCheckBox* m_hindered;
    QRadioButton* m_winterwerp;
    QRadioButton* m_richardsonZaki;
    mtdlg::NumberRow m_cgel;
    mtdlg::NumberRow m_rhoSediment;
    mtdlg::NumberRow m_cfloc;
    mtdlg::NumberRow m_chinder;
    QGroupBox* m_gridGroup;
    CMTSettlingGrid* m_constantGrid;
    CMTSettlingGrid* m_coefficientGrid;
};
