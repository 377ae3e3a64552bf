#pragma once

#include "widgets/ZoSEDlgBase.h"

class CMTSandFractionGrid;
class CMTSandFractionListKiv;
class QCheckBox;

// The switch that turns sand fractions on, and the grid of the fractions.
class CMTSandFractionListDlg : public CZoSEDlgBase {
    Q_OBJECT
public:
    explicit CMTSandFractionListDlg(QWidget* parent = nullptr);
    void Initialize() override;
    void SetData() override;

    QCheckBox* IncludeBox() const { return m_include; }
    CMTSandFractionGrid* Grid() const { return m_grid; }

private:
    CMTSandFractionListKiv* List() const;
    void OnInclude();

    QCheckBox* m_include;
    CMTSandFractionGrid* m_grid;
};
