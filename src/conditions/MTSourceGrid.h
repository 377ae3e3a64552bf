#pragma once

#include "MTSourceKiv.h"
#include "widgets/ZoSEGridWndBase.h"

class CHDSourcesKiv;

// Every source of the flow model by number and name, linked to its sediment's dialog. Sources
// left out of the flow model are greyed.
class CMTSourceGrid : public CFemGridWnd<CMTSourceItemKiv> {
public:
    enum Column { kName = 1, kEdit = 2 };

    explicit CMTSourceGrid(QWidget* parent = nullptr);
    void Initialize(CZoSEDlgBase* dialog, CMTSourceKiv* list, bool nameReadOnly);
    void GetStyleRowCol(int row, int col, CGridCellStyle& style) override;
    // One row per hydrodynamic source (SetData); never more than this module's items.
    void SetSourceRows(int rows);

protected:
    int RowCountFromData() const override;
    void GetItemStyle(CMTSourceItemKiv* item, int row, int col, CGridCellStyle& style) override;

private:
    bool Included(int row) const;
    CHDSourcesKiv* m_sources = nullptr;
    bool m_nameReadOnly = true;
    int m_rows = 1;
};
