#pragma once

#include "MTSettlingKiv.h"
#include "widgets/ZoSEGridWndBase.h"

// The settling values of the fractions in use (sand fractions are skipped: row r shows the
// r-th item in use), each linked to its item's dialog. One grid shows the constant settling
// velocities, the other the settling velocity coefficients.
class CMTSettlingGrid : public CFemGridWnd<CMTSettlingItemKiv> {
public:
    enum Value { kConstantVelocity, kCoefficient };

    explicit CMTSettlingGrid(Value value, QWidget* parent = nullptr);

    void Initialize(CZoSEDlgBase* dialog, CMTSettlingKiv* section);
    Value ShownValue() const { return m_value; }
    CZoSEKivBase* ItemNodeOfRow(int row) const override;

    enum Column { kFormat = 1, kEdit = 2 };

protected:
    int RowCountFromData() const override;
    void GetItemStyle(CMTSettlingItemKiv* item, int row, int col, CGridCellStyle& style) override;

private:
    Value m_value;
    CMTSettlingKiv* m_section = nullptr;
};
