#include "MTOutputCoordGrid.h"

#include "MTOutputCoordListKiv.h"
#include "MTOutputItemMainKiv.h"
#include "projection/ZoMapProjection.h"

namespace {
constexpr long kGeographical = 100157;
constexpr long kProjected = 100183;
constexpr long kElevation = 100280;
constexpr long kCount = 100370;
}  // namespace

void CMTOutputCoordGrid::Initialize(CZoSEDlgBase* dialog, CMTOutputItemMainKiv* output) {
    m_output = output;
    CFemGridEditWnd::Initialize(dialog, output->CoordList());
    UpdateHeadings();
}

bool CMTOutputCoordGrid::Geographical() const {
    return m_output && CZoMapProjection::IsGeographical(m_output->CoordinateType());
}

void CMTOutputCoordGrid::UpdateHeadings() {
    if (!m_output)
        return;
    const bool geo = Geographical();
    SetColumnHeadings({"", geo ? "Longitude" : "Easting", geo ? "Latitude" : "Northing",
                       m_output->InterpolationType() == 1 ? "Layer no." : "z", "Name"});
}

void CMTOutputCoordGrid::GetStyleRowCol(int row, int col, CGridCellStyle& style) {
    if (row >= 1 && col == 0 && m_output) {
        if (m_output->UsesLine())
            style.SetStatic(row == 1 ? "First" : "Last");
        else
            style.SetStatic(std::to_string(row));
        return;
    }
    CFemGridEditWnd::GetStyleRowCol(row, col, style);
}

void CMTOutputCoordGrid::GetItemStyle(CMTOutputCoordItemKiv* item, int, int col, CGridCellStyle& style) {
    if (!m_output)
        return;
    const CZoEditStyle coordinate =
        CZoEditStyle().SetOvuUnitBaseGroup(Geographical() ? kGeographical : kProjected).SetFormat("%.11f");
    const int type = m_output->Type();
    const int format = m_output->Format();
    switch (col) {
    case 1:
        style.SetNumber(item->X(), coordinate).SetAlign(ZoCellAlign::Right);
        break;
    case 2:
        style.SetNumber(item->Y(), coordinate).SetAlign(ZoCellAlign::Right);
        break;
    case 3:
        if (type != CMTOutputItemMainKiv::kType3D || (format != 0 && format != 1)) {
            style.SetStatic("").SetReadOnly();
        } else if (m_output->InterpolationType() == 1) {
            style.SetNumber(item->Layer(), CZoEditStyle().SetOvuUnitBaseGroup(kCount), ZoNumberKind::Int)
                .SetAlign(ZoCellAlign::Right);
        } else {
            style.SetNumber(item->Z(), CZoEditStyle().SetOvuUnitBaseGroup(kElevation).SetFormat("%.11f"))
                .SetAlign(ZoCellAlign::Right);
        }
        break;
    case 4:
        if (m_output->UsesPoints())
            style.SetText(item->Name());
        else
            style.SetStatic("").SetReadOnly();
        break;
    default:
        break;
    }
}

int CMTOutputCoordGrid::StoreItem(CMTOutputCoordItemKiv* item, int, int col, const CGridCellValue& value) {
    if (!m_output)
        return 0;
    switch (col) {
    case 1: item->X(value.number); break;
    case 2: item->Y(value.number); break;
    case 3:
        if (m_output->InterpolationType() == 1)
            item->Layer(static_cast<int>(value.number));
        else
            item->Z(value.number);
        break;
    case 4:
        if (m_output->Format() != 0)
            return 0;
        item->Name(value.text);
        break;
    default: return 0;
    }
    m_output->CoordListToGeometry();
    // Every stored cell is an edit of the output, told to the document like any other.
    return kHintValueChanged;
}
