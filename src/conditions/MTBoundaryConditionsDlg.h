#pragma once

#include "widgets/ZoSEDlgBase.h"

class CMTBoundaryConditionsGridDlg;

// The list view of the boundary conditions: every boundary with its fractions' values.
class CMTBoundaryConditionsDlg : public CZoSEDlgBase {
    Q_OBJECT
public:
    explicit CMTBoundaryConditionsDlg(QWidget* parent = nullptr);
    void Initialize() override;
    void SetData() override;

    CMTBoundaryConditionsGridDlg* Grid() const { return m_grid; }

private:
    void FitGrid();
    CMTBoundaryConditionsGridDlg* m_grid;
};
