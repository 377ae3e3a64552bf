#pragma once

#include "widgets/ZoSEDlgBase.h"

class CInitialConditionsFractionsGrid;

// The initial concentration of every fraction, each linked to its own form.
class CInitialConditionsFractionsDlg : public CZoSEDlgBase {
    Q_OBJECT
public:
    explicit CInitialConditionsFractionsDlg(QWidget* parent = nullptr);
    void Initialize() override;
    void SetData() override;

    CInitialConditionsFractionsGrid* Grid() const { return m_grid; }

private:
    CInitialConditionsFractionsGrid* m_grid;
};
