#include "MTDredgingFractionGrid.h"

#include "MTDredgingItemsKiv.h"

void CMTDredgingFractionGrid::Initialize(CZoSEDlgBase* dialog, CMTDredgingItemsKiv* dredger) {
    SetDialog(dialog);
    m_dredger = dredger;
    SetRowCount(1);
    Refresh();
}

void CMTDredgingFractionGrid::Refresh() {
    SetColCount(m_dredger ? static_cast<int>(m_dredger->WeightsFraction().size()) : 0);
    Redraw();
    FitColumns();
    SizeToDialog();
}

void CMTDredgingFractionGrid::GetStyleRowCol(int row, int col, CGridCellStyle& style) {
    if (row == 0) {
        style.SetStatic(col == 0 ? CString("Fraction") : FormatString("%d", col))
            .SetAlign(ZoCellAlign::Center);
        return;
    }
    if (col == 0) {
        style.SetStatic("Weight");
        return;
    }
    if (!m_dredger)
        return;
    style.SetNumber(m_dredger->WeightFraction(col), CZoEditStyle().SetFormat("%.11f"))
        .SetAlign(ZoCellAlign::Right)
        .SetToolTip(FormatString("Share of fraction %d in the dredged mass (%%)", col));
}

int CMTDredgingFractionGrid::StoreStyleRowCol(int row, int col, const CGridCellValue& value) {
    if (!m_dredger || row != 1 || col < 1 ||
        col > static_cast<int>(m_dredger->WeightsFraction().size()))
        return 0;
    if (value.number == m_dredger->WeightFraction(col))
        return 0;
    m_dredger->WeightFraction(col, value.number);
    return kHintValueChanged;
}
