#pragma once

#include "MTSandFractionListKiv.h"
#include "widgets/ZoSEGridWndBase.h"

// One row per fraction: whether it is sand and its mean settling velocity, in the user's
// unit. The whole grid is greyed while sand fractions are not included.
class CMTSandFractionGrid : public CFemGridWnd<CMTSandFractionItemKiv> {
public:
    explicit CMTSandFractionGrid(QWidget* parent = nullptr);

    void Initialize(CZoSEDlgBase* dialog, CMTSandFractionListKiv* list);
    void GetStyleRowCol(int row, int col, CGridCellStyle& style) override;

    enum Column { kInclude = 1, kVelocity = 2 };

protected:
    void GetItemStyle(CMTSandFractionItemKiv* item, int row, int col,
                      CGridCellStyle& style) override;
    int StoreItem(CMTSandFractionItemKiv* item, int row, int col,
                  const CGridCellValue& value) override;

private:
    CMTSandFractionListKiv* m_list = nullptr;
};
