#include "MTSandFractionGrid.h"

#include "fem/UnitUtil.h"

#include <QHeaderView>

#include <algorithm>

namespace {
constexpr long kSettlingVelocityUnit = 100128;

// The row headings are bare numbers, narrower than the heading "Fraction" above them in the
// corner: the heading column is made as wide as that heading.
class CRowHeadings : public QHeaderView {
public:
    CRowHeadings(const QString& cornerHeading, QWidget* parent)
        : QHeaderView(Qt::Vertical, parent), m_corner(cornerHeading) {
        setSectionsMovable(false);
        setHighlightSections(true);
        setSectionsClickable(true);
    }
    QSize sizeHint() const override {
        QSize hint = QHeaderView::sizeHint();
        const int corner = fontMetrics().horizontalAdvance(m_corner) +
                           2 * style()->pixelMetric(QStyle::PM_HeaderMargin, nullptr, this) + 4;
        hint.setWidth(std::max(hint.width(), corner));
        return hint;
    }

private:
    QString m_corner;
};

CZoEditStyle VelocityStyle() {
    return CZoEditStyle().SetOvuUnitBaseGroup(kSettlingVelocityUnit).SetFormat("%.11g").SetFloatRange();
}
} // namespace

CMTSandFractionGrid::CMTSandFractionGrid(QWidget* parent) : CFemGridWnd(parent) {
    setObjectName("sandFractionGrid");
    setVerticalHeader(new CRowHeadings("Fraction", this));
}

void CMTSandFractionGrid::Initialize(CZoSEDlgBase* dialog, CMTSandFractionListKiv* list) {
    m_list = list;
    CFemGridWnd::Initialize(dialog, list);
    SetColumnHeadings({"Fraction", "Include", "Mean Settling Velocity"});
}

void CMTSandFractionGrid::GetStyleRowCol(int row, int col, CGridCellStyle& style) {
    CFemGridWnd::GetStyleRowCol(row, col, style);
    if (row > 0 && col == 0)
        style.SetStatic(FormatString("%d", row));
    if (row == 0 || col == 0)
        style.SetAlign(ZoCellAlign::Center);
    // Nothing here is in use until sand fractions are included.
    if (m_list && !m_list->IncludeSandFractions())
        style.SetReadOnly();
}

void CMTSandFractionGrid::GetItemStyle(CMTSandFractionItemKiv* item, int, int col,
                                       CGridCellStyle& style) {
    switch (col) {
    case kInclude:
        style.SetCheckBox(item->IncludeSand()).SetAlign(ZoCellAlign::Center);
        break;
    case kVelocity:
        // Held in the file's unit; the cell shows and takes the user's.
        style.SetNumber(item->StoredMeanSettlingVelocity(), VelocityStyle())
            .SetAlign(ZoCellAlign::Right)
            .SetToolTip(CUnitUtil::GetItemToolTip(kSettlingVelocityUnit));
        if (!item->IncludeSand())
            style.SetReadOnly();
        break;
    default:
        break;
    }
}

int CMTSandFractionGrid::StoreItem(CMTSandFractionItemKiv* item, int, int col,
                                   const CGridCellValue& value) {
    switch (col) {
    case kInclude:
        item->IncludeSand(value.checked);
        return kHintValueChanged;
    case kVelocity:
        item->StoredMeanSettlingVelocity(value.number);
        return kHintValueChanged;
    default:
        return 0;
    }
}
