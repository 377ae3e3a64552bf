#pragma once

#include "InitialConditionsKiv.h"
#include "widgets/ZoSEGridWndBase.h"

// Layers by fractions: each cell the share of a fraction in a layer, in percent.
class CInitialConditionsFractionDistributionGrid
    : public CFemGridWnd<CInitialConditionsFractionDistributionItemKiv> {
public:
    explicit CInitialConditionsFractionDistributionGrid(QWidget* parent = nullptr);
    void Initialize(CZoSEDlgBase* dialog, CInitialConditionsFractionDistributionKiv* list);
    // One column per fraction of the model definition, as it is now.
    void SetColumns();
    void GetStyleRowCol(int row, int col, CGridCellStyle& style) override;

protected:
    void GetItemStyle(CInitialConditionsFractionDistributionItemKiv* layer, int row, int col,
                      CGridCellStyle& style) override;
    int StoreItem(CInitialConditionsFractionDistributionItemKiv* layer, int row, int col,
                  const CGridCellValue& value) override;

private:
    int m_fractions = -1;
};
