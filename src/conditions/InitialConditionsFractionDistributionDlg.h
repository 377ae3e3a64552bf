#pragma once

#include "widgets/ZoSEDlgBase.h"

class CInitialConditionsFractionDistributionGrid;

// How the sediment of every bed layer is shared out among the fractions.
class CInitialConditionsFractionDistributionDlg : public CZoSEDlgBase {
    Q_OBJECT
public:
    explicit CInitialConditionsFractionDistributionDlg(QWidget* parent = nullptr);
    void Initialize() override;
    void SetData() override;

    CInitialConditionsFractionDistributionGrid* Grid() const { return m_grid; }

private:
    CInitialConditionsFractionDistributionGrid* m_grid;
};
