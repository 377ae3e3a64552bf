#pragma once

#include "MTBoundaryConditionsKiv.h"
#include "widgets/ZoSEGridWndBase.h"

// Every boundary in a block of rows: the boundary's own row, then one row per fraction with
// its boundary type and a link to the value's dialog. The rows are worked out from the lists
// as they are whenever a cell is drawn, so that boundaries or fractions that change while the
// grid is open never leave a row pointing at an item that is gone.
class CMTBoundaryConditionsGridDlg : public CFemGridWnd<CMTBoundaryConditionsComponentKiv> {
public:
    enum Column { kFormat = 1, kEdit = 2 };

    explicit CMTBoundaryConditionsGridDlg(QWidget* parent = nullptr);
    void Initialize(CZoSEDlgBase* dialog, CMTBoundaryConditionsKiv* list);

    struct RowPlace {
        int component = 0;  // 1-based; 0 when the row shows nothing
        int fraction = 0;   // 0 for the boundary's own row
    };
    RowPlace PlaceOfRow(int row) const;
    // The value of an item row, the component of a boundary row; null past the lists.
    CZoSEKivBase* ItemNodeOfRow(int row) const override;

    // A boundary's row is its title across the row, as one cell over the three columns.
    bool IsTitleRow(int row) const override;
    void GetStyleRowCol(int row, int col, CGridCellStyle& style) override;
    void OnClickedButtonRowCol(int row, int col) override;

protected:
    int RowCountFromData() const override;
    void GetItemStyle(CMTBoundaryConditionsComponentKiv*, int, int, CGridCellStyle&) override {}

private:
    int Fractions() const;
};
