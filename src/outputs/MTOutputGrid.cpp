#include "MTOutputGrid.h"

#include "MTOutputKiv.h"
#include "widgets/FemBase.h"

#include <filesystem>

void CMTOutputGrid::Initialize(CZoSEDlgBase* dialog, CMTOutputKiv* list) {
    CFemGridEditWnd::Initialize(dialog, list);
    SetColumnHeadings({"Output No.", "Name", "Include", "Results", "Edit"});
}

void CMTOutputGrid::GetStyleRowCol(int row, int col, CGridCellStyle& style) {
    if (row >= 1 && col == 0) {
        style.SetStatic(std::to_string(row));
        return;
    }
    CFemGridEditWnd::GetStyleRowCol(row, col, style);
}

bool CMTOutputGrid::CanView(CMTOutputItemMainKiv* output) const {
    if (!output->Include() || output->FileName().empty() || !output->CheckData(false))
        return false;
    const CString path = Dialog() ? Dialog()->AbsoluteFilePath(output->FileName()) : output->FileName();
    std::error_code ec;
    return std::filesystem::is_regular_file(path, ec);
}

void CMTOutputGrid::GetItemStyle(CMTOutputItemMainKiv* item, int, int col, CGridCellStyle& style) {
    const bool included = item->Include() != 0;
    switch (col) {
    case 1: style.SetText(item->Title()).SetReadOnly(!included); break;
    case 2: style.SetCheckBox(included); break;
    case 3: style.SetButton("View...").SetReadOnly(!CanView(item)); break;
    case 4: style.SetButton(kGoToLabel).SetReadOnly(!included); break;
    default: break;
    }
}

int CMTOutputGrid::StoreItem(CMTOutputItemMainKiv* item, int, int col, const CGridCellValue& value) {
    if (col == 1) {
        if (value.text == item->Title())
            return 0;
        item->Title(value.text);
        return kHintTitleChanged;
    }
    if (col == 2) {
        item->Include(value.checked ? 1 : 0);
        return kHintValueChanged;
    }
    return 0;
}

void CMTOutputGrid::OnClickedButtonRowCol(int row, int col) {
    CMTOutputItemMainKiv* output = GetItem(row);
    if (!output)
        return;
    if (col == 3) {
        if (CanView(output) && Dialog())
            CFemBase::OpenDataFile(Dialog(), output->FileName(), {});
        return;
    }
    if (col == 4 && output->Include())
        CFemGridEditWnd::OnClickedButtonRowCol(row, col);
}
