#pragma once

#include "widgets/ZoSEDlgBase.h"

class CMTErosionGrid;
class CMTErosionListKiv;
class CZoNumberEdit;
class QLabel;

// The erosion laws of all layers, and the largest concentration erosion may produce.
class CMTErosionListDlg : public CZoSEDlgBase {
    Q_OBJECT
public:
    explicit CMTErosionListDlg(QWidget* parent = nullptr);
    void Initialize() override;
    void SetData() override;

    CMTErosionGrid* Grid() const { return m_grid; }
    CZoNumberEdit* MaxConcentrationEdit() const { return m_maxConcentration; }

private:
    CMTErosionListKiv* List() const;

    CZoNumberEdit* m_maxConcentration;
    QLabel* m_unit;
    CMTErosionGrid* m_grid;
};
