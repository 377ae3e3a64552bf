#pragma once

#include "widgets/ZoSEDlgBase.h"

class CMTDepositionGrid;
class CMTDepositionKiv;
class CZoNumberEdit;
class QLabel;
class QRadioButton;

// The near-bed concentration profile and the grid of the fractions' critical shear stress.
class CMTDepositionDlg : public CZoSEDlgBase {
    Q_OBJECT
public:
    explicit CMTDepositionDlg(QWidget* parent = nullptr);
    void Initialize() override;
    void SetData() override;

    CMTDepositionGrid* Grid() const { return m_grid; }

private:
    CMTDepositionKiv* Deposition() const;
    void Store();

    QRadioButton* m_rouse;
    QRadioButton* m_teeter;
    QLabel* m_centroidLabel;
    CZoNumberEdit* m_centroidHeight;
    CMTDepositionGrid* m_grid;
};
