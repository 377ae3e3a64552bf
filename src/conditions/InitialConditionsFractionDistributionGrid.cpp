#include "InitialConditionsFractionDistributionGrid.h"

#include <QHeaderView>

CInitialConditionsFractionDistributionGrid::CInitialConditionsFractionDistributionGrid(
    QWidget* parent)
    : CFemGridWnd(parent) {
    setObjectName("distributionGrid");
}

void CInitialConditionsFractionDistributionGrid::Initialize(
    CZoSEDlgBase* dialog, CInitialConditionsFractionDistributionKiv* list) {
    CFemGridWnd::Initialize(dialog, list);
    QFont bold = verticalHeader()->font();
    bold.setBold(true);
    verticalHeader()->setFont(bold);
    SetColumns();
}

void CInitialConditionsFractionDistributionGrid::SetColumns() {
    const CParameterSelectionKiv* model = ModelDefinition(GetList());
    const int fractions = model ? std::max(model->NumberOfFractions(), 0) : 0;
    if (fractions == m_fractions)
        return;
    m_fractions = fractions;
    std::vector<CString> headings{""};
    for (int j = 1; j <= fractions; ++j)
        headings.push_back(FormatString("Fraction %d", j));
    SetColumnHeadings(headings);
}

void CInitialConditionsFractionDistributionGrid::GetStyleRowCol(int row, int col,
                                                                CGridCellStyle& style) {
    if (row > 0 && col == 0) {
        style.SetStatic(FormatString("Layer %d", row));
        return;
    }
    CFemGridWnd::GetStyleRowCol(row, col, style);
}

void CInitialConditionsFractionDistributionGrid::GetItemStyle(
    CInitialConditionsFractionDistributionItemKiv* layer, int, int col, CGridCellStyle& style) {
    // A column beyond the layer's fractions (the number just fell) shows nothing.
    if (const auto* element = layer->GetItem(col))
        style.SetNumber(element->ConstantValue(), CZoEditStyle(), ZoNumberKind::Float)
            .SetToolTip("Share of the fraction in the layer [%]");
    else
        style.SetStatic("").SetReadOnly();
}

int CInitialConditionsFractionDistributionGrid::StoreItem(
    CInitialConditionsFractionDistributionItemKiv* layer, int, int col,
    const CGridCellValue& value) {
    auto* element = layer->GetItem(col);
    if (!element || value.kind != ZoCellKind::Number)
        return 0;
    element->ConstantValue(static_cast<float>(value.number));
    return kHintValueChanged;
}
