// The overview grids of the per-layer bed lists: the item's title, one read-only column
// that describes the item, and a "Go to..." link to the item's own dialog.
#pragma once

#include "widgets/ZoSEGridWndBase.h"

template <class T> class CMTBedItemGrid : public CFemGridWnd<T> {
public:
    using CFemGridWnd<T>::CFemGridWnd;

    // Headings of the title column, the description column and the link column.
    void Initialize(CZoSEDlgBase* dialog, CZoSEKivAbstractListBase<T>* list,
                    const std::vector<CString>& headings) {
        CFemGridWnd<T>::Initialize(dialog, list);
        this->SetColumnHeadings(headings);
        this->FitColumns();
        this->SizeToDialog();
    }

    // Rows follow the list; columns are fitted to their contents again.
    void Refresh() {
        this->Redraw();
        this->FitColumns();
        this->SizeToDialog();
    }

    void GetStyleRowCol(int row, int col, CGridCellStyle& style) override {
        CFemGridWnd<T>::GetStyleRowCol(row, col, style);
        if (row == 0 || col == 0)
            style.SetAlign(ZoCellAlign::Center);
        if (IsGreyed())
            style.SetReadOnly();
    }

protected:
    // The description column's text.
    virtual CString Description(T* item) const = 0;
    // Every cell, headings included, drawn disabled.
    virtual bool IsGreyed() const { return false; }

    void GetItemStyle(T* item, int, int col, CGridCellStyle& style) override {
        if (col == 1)
            style.SetStatic(Description(item)).SetReadOnly().SetAlign(ZoCellAlign::Center);
        else if (col == 2)
            style.SetButton(kGoToLabel);
    }
};
