#pragma once

#include "MTDepositionKiv.h"
#include "widgets/ZoSEGridWndBase.h"

// The critical shear stress for deposition of every fraction (sand included), each linked to
// its item's dialog.
class CMTDepositionGrid : public CFemGridWnd<CMTDepositionItemKiv> {
public:
    explicit CMTDepositionGrid(QWidget* parent = nullptr);
    void Initialize(CZoSEDlgBase* dialog, CMTDepositionKiv* section);

    enum Column { kFormat = 1, kEdit = 2 };

protected:
    void GetItemStyle(CMTDepositionItemKiv* item, int row, int col, CGridCellStyle& style) override;
};
