#pragma once

#include "widgets/BoundaryConditionsComponentItemDlg.h"

// The boundary value of one fraction.
class CMTBoundaryConditionsComponentItemDlg : public CBoundaryConditionsComponentItemDlg {
    Q_OBJECT
public:
    explicit CMTBoundaryConditionsComponentItemDlg(QWidget* parent = nullptr);
};
