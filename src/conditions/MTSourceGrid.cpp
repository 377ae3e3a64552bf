#include "MTSourceGrid.h"

#include "hydro/HDSourcesKiv.h"

CMTSourceGrid::CMTSourceGrid(QWidget* parent) : CFemGridWnd(parent) { setObjectName("sourceGrid"); }

void CMTSourceGrid::Initialize(CZoSEDlgBase* dialog, CMTSourceKiv* list, bool nameReadOnly) {
    m_sources = HDSources(list);
    m_nameReadOnly = nameReadOnly;
    CFemGridWnd::Initialize(dialog, list);
    // The form's widths, at least; wider where the texts ask for it.
    SetMinimumColumnWidth(0, 50);
    SetMinimumColumnWidth(kName, 150);
    SetColumnHeadings({"Source No.", "Name", ""});
}

void CMTSourceGrid::SetSourceRows(int rows) {
    m_rows = std::max(rows, 0);
    Redraw();
}

int CMTSourceGrid::RowCountFromData() const {
    // The host's sources may have changed since SetData: never a row past either list.
    int rows = std::min(m_rows, CFemGridWnd::RowCountFromData());
    if (m_sources)
        rows = std::min(rows, m_sources->GetItemCount());
    return rows;
}

bool CMTSourceGrid::Included(int row) const {
    const CHDSourceItemKiv* source = m_sources ? m_sources->GetItem(row) : nullptr;
    return source && source->Include() != 0;
}

void CMTSourceGrid::GetStyleRowCol(int row, int col, CGridCellStyle& style) {
    if (row > 0 && col == 0) {
        style.SetStatic(std::to_string(row)).SetAlign(ZoCellAlign::Center);
        if (!Included(row))
            style.SetReadOnly();
        return;
    }
    CFemGridWnd::GetStyleRowCol(row, col, style);
    if (row == 0 && col == 0)
        style.SetAlign(ZoCellAlign::Center);
}

void CMTSourceGrid::GetItemStyle(CMTSourceItemKiv*, int row, int col, CGridCellStyle& style) {
    if (col == kName) {
        const CHDSourceItemKiv* source = m_sources ? m_sources->GetItem(row) : nullptr;
        style.SetText(source ? source->GetTitle() : CString());
        if (m_nameReadOnly || !Included(row))
            style.SetReadOnly();
    } else if (col == kEdit) {
        style.SetButton(kGoToLabel);
    }
}
