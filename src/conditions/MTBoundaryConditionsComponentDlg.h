#pragma once

#include "widgets/ZoSEDlgBase.h"

class QLabel;

// One boundary: nothing to edit here; its fractions' values have forms of their own.
class CMTBoundaryConditionsComponentDlg : public CZoSEDlgBase {
    Q_OBJECT
public:
    explicit CMTBoundaryConditionsComponentDlg(QWidget* parent = nullptr);
    void SetData() override;

private:
    QLabel* m_boundary;
};
