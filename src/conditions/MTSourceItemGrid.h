#pragma once

#include "MTSourceKiv.h"
#include "widgets/ZoSEGridWndBase.h"

// What one source brings of every fraction: the constant or the data file's item.
class CMTSourceItemGrid : public CFemGridWnd<CMTSourceItemSubKiv> {
public:
    enum Column { kValue = 1, kEdit = 2 };

    explicit CMTSourceItemGrid(QWidget* parent = nullptr);
    void Initialize(CZoSEDlgBase* dialog, CMTSourceItemKiv* source);
    void GetStyleRowCol(int row, int col, CGridCellStyle& style) override;
    // "Value: 0.3", or "Item: name (File: name.qrd0)".
    static CString ValueText(const CFemInDataKiv* value);

protected:
    void GetItemStyle(CMTSourceItemSubKiv* component, int row, int col,
                      CGridCellStyle& style) override;
};
