#include "ForcingsWaveDBGrid.h"

#include "ForcingsWaveDBAxisKiv.h"
#include "ForcingsWaveDBFile.h"
#include "ForcingsWaveDBListKiv.h"
#include "widgets/ZoFileSelectorDlg.h"

#include <algorithm>

namespace {
constexpr long kSpeedGroup = 100274;
constexpr long kDirectionGroup = 100003;
constexpr long kLevelGroup = 100000;

CString Trimmed(const CString& text) {
    const auto first = text.find_first_not_of(" \t\r\n");
    if (first == CString::npos)
        return {};
    const auto last = text.find_last_not_of(" \t\r\n");
    return text.substr(first, last - first + 1);
}
}  // namespace

const char* const CForcingsWaveDBGrid::kDefaultExt = "kx2";
const char* const CForcingsWaveDBGrid::kFilter =
    "Wave database file (*.qrd2;*.kx2;*.qrdu)|*.qrd2; *.kx2; *.qrdu||";

void CForcingsWaveDBGrid::Initialize(CZoSEDlgBase* dialog, CForcingsWaveDBListKiv* list) {
    m_list = list;
    // At least as wide as the form's columns were drawn: the values, a file name, the button.
    const int widths[] = {75, 75, 75, 125, 25};
    for (int c = 0; c < 5; ++c)
        SetMinimumColumnWidth(c + 1, widths[c]);
    CFemGridWnd::Initialize(dialog, list);
    SetColumnHeadings({"No.", "Wind speed", "Wind direct.", "Water level", "File name", ""});
    Refresh();
}

void CForcingsWaveDBGrid::Refresh() {
    Redraw();
}

int CForcingsWaveDBGrid::RowCountFromData() const {
    if (!m_list || !m_list->AxesValid())
        return 0;
    return m_list->GetItemCount();
}

void CForcingsWaveDBGrid::GetStyleRowCol(int row, int col, CGridCellStyle& style) {
    if (row >= 1 && col == 0) {
        style.SetStatic(FormatString("%d", row));
        return;
    }
    CFemGridWnd::GetStyleRowCol(row, col, style);
}

void CForcingsWaveDBGrid::GetItemStyle(CForcingsWaveDBItemKiv* item, int row, int col,
                                       CGridCellStyle& style) {
    const CForcingsWaveDBListKiv::Point p =
        CForcingsWaveDBListKiv::PointOf(row, m_list->CurrentShape());
    auto value = [&](const CForcingsWaveDBAxisKiv* axis, int index, long group) {
        const CZoEditStyle unit = CZoEditStyle().SetOvuUnitBaseGroup(group);
        style.SetStatic(unit.Format(axis->Value(index - 1), ZoNumberKind::Double).toStdString())
            .SetAlign(ZoCellAlign::Left)
            .SetReadOnly()
            .SetToolTip(unit.ToolTip());
    };
    switch (col) {
    case 1: value(m_list->WindSpeed(), p.speed, kSpeedGroup); break;
    case 2: value(m_list->WindDirection(), p.direction, kDirectionGroup); break;
    case 3: value(m_list->WaterLevel(), p.level, kLevelGroup); break;
    case kFileColumn: style.SetText(item->File()->FileName()); break;
    case kSelectColumn: style.SetButton("  ...  "); break;
    default: break;
    }
}

int CForcingsWaveDBGrid::StoreItem(CForcingsWaveDBItemKiv* item, int, int col,
                                   const CGridCellValue& value) {
    if (col != kFileColumn)
        return 0;
    const CString name = Trimmed(value.text);
    if (name == item->File()->FileName())
        return 0;
    item->File()->FileName(name);
    return 1;
}

void CForcingsWaveDBGrid::OnClickedButtonRowCol(int row, int col) {
    CForcingsWaveDBItemKiv* item = col == kSelectColumn ? GetItem(row) : nullptr;
    if (!item || !ZoSelectDataFile(item->File(), kFilter, kDefaultExt, this))
        return;
    Redraw();
    UpdateDoc(kHintValueChanged);
}
