#pragma once

#include "widgets/ZoSEDlgBase.h"

class CMTSourceItemGrid;

// One source: the sediment it brings of every fraction.
class CMTSourceItemDlg : public CZoSEDlgBase {
    Q_OBJECT
public:
    explicit CMTSourceItemDlg(QWidget* parent = nullptr);
    void Initialize() override;
    void SetData() override;

    CMTSourceItemGrid* Grid() const { return m_grid; }

private:
    CMTSourceItemGrid* m_grid;
};
