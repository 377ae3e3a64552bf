#pragma once

#include "InitialConditionsKiv.h"
#include "widgets/ZoSEGridWndBase.h"

// The grids of the concentrations and thicknesses: the item, the format of its value and a
// link to the item's dialog.
template <class T>
class CInitialConditionsValueGrid : public CFemGridWnd<T> {
public:
    enum Column { kFormat = 1, kEdit = 2 };

    CInitialConditionsValueGrid(const char* itemHeading, QWidget* parent)
        : CFemGridWnd<T>(parent), m_heading(itemHeading) {}

    void Initialize(CZoSEDlgBase* dialog, CZoSEKivAbstractListBase<T>* list) {
        CFemGridWnd<T>::Initialize(dialog, list);
        this->SetColumnHeadings({m_heading, "Format", "Edit"});
        this->setToolTipDuration(-1);
    }

    void GetStyleRowCol(int row, int col, CGridCellStyle& style) override {
        CFemGridWnd<T>::GetStyleRowCol(row, col, style);
        if (col == 0 || col == kFormat)
            style.SetAlign(ZoCellAlign::Center);
    }

protected:
    void GetItemStyle(T* item, int, int col, CGridCellStyle& style) override {
        if (col == kFormat)
            style.SetStatic(item->Value()->FormatText()).SetReadOnly();
        else if (col == kEdit)
            style.SetButton(kGoToLabel);
    }

private:
    const char* m_heading;
};

class CInitialConditionsFractionsGrid
    : public CInitialConditionsValueGrid<CInitialConditionsFractionsItemKiv> {
public:
    explicit CInitialConditionsFractionsGrid(QWidget* parent = nullptr)
        : CInitialConditionsValueGrid("Fraction", parent) {
        setObjectName("fractionsGrid");
    }
};
