// The coordinates of an output's geometry: points with z or layer and name, corners, or the
// two ends of a line.
#pragma once

#include "MTOutputCoordItemKiv.h"
#include "widgets/ZoSEGridWndBase.h"

class CMTOutputCoordListKiv;
class CMTOutputItemMainKiv;

class CMTOutputCoordGrid : public CFemGridEditWnd<CMTOutputCoordItemKiv> {
public:
    using CFemGridEditWnd::CFemGridEditWnd;
    void Initialize(CZoSEDlgBase* dialog, CMTOutputItemMainKiv* output);
    // Headings after the output's coordinate and interpolation types.
    void UpdateHeadings();

    void GetStyleRowCol(int row, int col, CGridCellStyle& style) override;

protected:
    void GetItemStyle(CMTOutputCoordItemKiv* item, int row, int col, CGridCellStyle& style) override;
    int StoreItem(CMTOutputCoordItemKiv* item, int row, int col, const CGridCellValue& value) override;

private:
    bool Geographical() const;
    CMTOutputItemMainKiv* m_output = nullptr;
};
