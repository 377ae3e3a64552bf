#pragma once

#include "widgets/ZoSEDlgBase.h"

class CInitialConditionsLayersGrid;

// The initial thickness of every bed layer, each linked to its own form.
class CInitialConditionsLayersDlg : public CZoSEDlgBase {
    Q_OBJECT
public:
    explicit CInitialConditionsLayersDlg(QWidget* parent = nullptr);
    void Initialize() override;
    void SetData() override;

    CInitialConditionsLayersGrid* Grid() const { return m_grid; }

private:
    CInitialConditionsLayersGrid* m_grid;
};
