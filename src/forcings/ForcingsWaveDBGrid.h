#pragma once

#include "ForcingsWaveDBItemKiv.h"
#include "widgets/ZoSEGridWndBase.h"

class CForcingsWaveDBListKiv;

// One row per point of the wave database: its wind speed, direction and water level, and
// its file, typed or chosen in the file selector.
class CForcingsWaveDBGrid : public CFemGridWnd<CForcingsWaveDBItemKiv> {
public:
    using CFemGridWnd::CFemGridWnd;
    void Initialize(CZoSEDlgBase* dialog, CForcingsWaveDBListKiv* list);
    // Rows follow the axes again.
    void Refresh();

    static constexpr int kFileColumn = 4;
    static constexpr int kSelectColumn = 5;
    // The selector's default extension and filter.
    static const char* const kDefaultExt;
    static const char* const kFilter;

    void GetStyleRowCol(int row, int col, CGridCellStyle& style) override;
    void OnClickedButtonRowCol(int row, int col) override;

protected:
    // No rows while an axis holds values it does not accept; the items are kept.
    int RowCountFromData() const override;
    void GetItemStyle(CForcingsWaveDBItemKiv* item, int row, int col,
                      CGridCellStyle& style) override;
    int StoreItem(CForcingsWaveDBItemKiv* item, int row, int col,
                  const CGridCellValue& value) override;

private:
    CForcingsWaveDBListKiv* m_list = nullptr;
};
