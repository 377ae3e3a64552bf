#pragma once

#include "widgets/ZoGridWnd.h"

class CMTDredgingItemsKiv;

// The split of a dredger's mass over the fractions: one column per fraction, the fraction
// numbers above and the weights (percent) in one row.
class CMTDredgingFractionGrid : public CZoGridWnd {
public:
    using CZoGridWnd::CZoGridWnd;
    void Initialize(CZoSEDlgBase* dialog, CMTDredgingItemsKiv* dredger);
    // Columns follow the dredger's weights.
    void Refresh();

    void GetStyleRowCol(int row, int col, CGridCellStyle& style) override;
    int StoreStyleRowCol(int row, int col, const CGridCellValue& value) override;

private:
    CMTDredgingItemsKiv* m_dredger = nullptr;
};
