#include "MTBoundaryConditionsGridDlg.h"

#include "hydro/HDBoundaryConditionsKiv.h"

#include <QHeaderView>

CMTBoundaryConditionsGridDlg::CMTBoundaryConditionsGridDlg(QWidget* parent) : CFemGridWnd(parent) {
    setObjectName("boundaryConditionsGrid");
}

void CMTBoundaryConditionsGridDlg::Initialize(CZoSEDlgBase* dialog, CMTBoundaryConditionsKiv* list) {
    CFemGridWnd::Initialize(dialog, list);
    SetColumnHeadings({"Boundary Name", "Format", "Edit"});
}

int CMTBoundaryConditionsGridDlg::Fractions() const {
    const CParameterSelectionKiv* model = GetList() ? ModelDefinition(GetList()) : nullptr;
    return model ? std::max(model->NumberOfFractions(), 0) : 0;
}

int CMTBoundaryConditionsGridDlg::RowCountFromData() const {
    return GetList() ? GetList()->GetItemCount() * (Fractions() + 1) : 0;
}

CMTBoundaryConditionsGridDlg::RowPlace CMTBoundaryConditionsGridDlg::PlaceOfRow(int row) const {
    const int block = Fractions() + 1;
    if (row < 1 || !GetList() || row > GetList()->GetItemCount() * block)
        return {};
    return {(row - 1) / block + 1, (row - 1) % block};
}

CZoSEKivBase* CMTBoundaryConditionsGridDlg::ItemNodeOfRow(int row) const {
    const RowPlace place = PlaceOfRow(row);
    CMTBoundaryConditionsComponentKiv* component =
        place.component ? GetList()->GetItem(place.component) : nullptr;
    if (!component || place.fraction == 0)
        return component;
    return component->GetItem(place.fraction);
}

bool CMTBoundaryConditionsGridDlg::IsTitleRow(int row) const {
    const RowPlace place = PlaceOfRow(row);
    return place.component != 0 && place.fraction == 0;
}

void CMTBoundaryConditionsGridDlg::GetStyleRowCol(int row, int col, CGridCellStyle& style) {
    if (row == 0) {
        CFemGridWnd::GetStyleRowCol(row, col, style);
        if (col <= kFormat)
            style.SetAlign(ZoCellAlign::Center);
        return;
    }
    const RowPlace place = PlaceOfRow(row);
    if (!place.component)
        return;
    if (place.fraction == 0) {
        // The boundary's row: its name, as the host's boundary-condition list titles it.
        if (col == 0) {
            CString title;
            if (const auto* host = GetImportant<CHDBoundaryConditionsKiv>(GetList(), "BoundaryConditions");
                host && host->GetItem(place.component))
                title = host->GetItem(place.component)->GetTitle();
            else
                title = GetList()->GetItem(place.component)->GetTitle();
            style.SetStatic(title).SetAlign(ZoCellAlign::Center);
        } else {
            style.SetStatic("");  // covered by the title
        }
        return;
    }
    const auto* item =
        dynamic_cast<const CMTBoundaryConditionsComponentItemKiv*>(ItemNodeOfRow(row));
    if (!item)
        return;
    switch (col) {
    case 0: style.SetStatic(item->GetTitle()).SetAlign(ZoCellAlign::Center); break;
    case kFormat: style.SetStatic(item->TypeText()).SetReadOnly().SetAlign(ZoCellAlign::Center); break;
    case kEdit: style.SetButton(kGoToLabel); break;
    default: break;
    }
}

void CMTBoundaryConditionsGridDlg::OnClickedButtonRowCol(int row, int) {
    if (PlaceOfRow(row).fraction == 0)
        return;
    if (CZoSEKivBase* item = ItemNodeOfRow(row); item && Dialog())
        Dialog()->SelectTreeItem(item);
}
