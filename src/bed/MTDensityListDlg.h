#pragma once

#include "widgets/ZoSEDlgBase.h"

class CMTDensityGrid;

// The density of every bed layer, each edited in the layer's own dialog.
class CMTDensityListDlg : public CZoSEDlgBase {
    Q_OBJECT
public:
    explicit CMTDensityListDlg(QWidget* parent = nullptr);
    void Initialize() override;
    void SetData() override;

    CMTDensityGrid* Grid() const { return m_grid; }

private:
    CMTDensityGrid* m_grid;
};
