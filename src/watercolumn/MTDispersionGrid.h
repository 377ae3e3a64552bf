#pragma once

#include "MTDispersionKiv.h"
#include "widgets/ZoSEGridWndBase.h"

// Every fraction's formulation in one direction, each linked to its item's dialog.
class CMTDispersionGrid : public CFemGridWnd<CMTDispersionItemKiv> {
public:
    explicit CMTDispersionGrid(QWidget* parent = nullptr);
    void Initialize(CZoSEDlgBase* dialog, CMTDispersionListKiv* list);
    void GetStyleRowCol(int row, int col, CGridCellStyle& style) override;

    enum Column { kFormulation = 1, kEdit = 2 };

protected:
    void GetItemStyle(CMTDispersionItemKiv* item, int row, int col, CGridCellStyle& style) override;
};
