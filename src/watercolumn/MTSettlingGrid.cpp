#include "MTSettlingGrid.h"

CMTSettlingGrid::CMTSettlingGrid(Value value, QWidget* parent)
    : CFemGridWnd(parent), m_value(value) {}

void CMTSettlingGrid::Initialize(CZoSEDlgBase* dialog, CMTSettlingKiv* section) {
    m_section = section;
    CFemGridWnd::Initialize(dialog, section);
    SetColumnHeadings({"Fraction", "Format", "Edit"});
}

int CMTSettlingGrid::RowCountFromData() const {
    return m_section ? m_section->ItemInUseCount() : 0;
}

CZoSEKivBase* CMTSettlingGrid::ItemNodeOfRow(int row) const {
    return m_section ? m_section->GetItemInUse(row) : nullptr;
}

void CMTSettlingGrid::GetItemStyle(CMTSettlingItemKiv* item, int, int col, CGridCellStyle& style) {
    switch (col) {
    case kFormat: {
        const CFemInDataKiv* value = m_value == kConstantVelocity
                                         ? item->ConstantSettlingVelocity()
                                         : item->SettlingVelocityCoefficient();
        style.SetStatic(value->FormatText()).SetReadOnly();
        break;
    }
    case kEdit:
        style.SetButton(kGoToLabel);
        break;
    default:
        break;
    }
}
