// Helpers shared by the bed dialog tests.
#pragma once

#include "BedTestSupport.h"
#include "fem/UnitUtil.h"
#include "support/UiTestSupport.h"
#include "widgets/ZoGridWnd.h"

#include <QAbstractButton>
#include <QCheckBox>
#include <QRadioButton>
#include <QStyleOptionButton>
#include <QTest>

#include <string>
#include <vector>

namespace bedtest {

// Clicks a cell of a grid in its middle, as the user does.
inline void ClickCell(CZoGridWnd* grid, int row, int col) {
    ASSERT_NE(grid, nullptr);
    const QRect rect = grid->CellRect(row, col);
    ASSERT_TRUE(rect.isValid()) << "cell " << row << "," << col << " is not shown";
    QTest::mouseClick(grid->viewport(), Qt::LeftButton, Qt::NoModifier, rect.center());
}

// Clicks a check box or radio button on its indicator, as the user does: its middle may lie
// beyond its text where a layout widens it.
inline void ClickButton(QAbstractButton* button) {
    ASSERT_NE(button, nullptr);
    QStyleOptionButton option;
    option.initFrom(button);
    const bool radio = qobject_cast<QRadioButton*>(button) != nullptr;
    const QRect indicator = button->style()->subElementRect(
        radio ? QStyle::SE_RadioButtonIndicator : QStyle::SE_CheckBoxIndicator, &option, button);
    QTest::mouseClick(button, Qt::LeftButton, Qt::NoModifier, indicator.center());
}

// What a row of a grid shows, column 0 (the row heading) included.
inline std::vector<std::string> RowTexts(CZoGridWnd* grid, int row) {
    std::vector<std::string> out;
    for (int col = 0; col <= grid->GetColCount(); ++col)
        out.push_back(grid->CellStyle(row, col).DisplayText().toStdString());
    return out;
}

// The unit of a quantity by its name ("g/m^3").
inline int UnitNamed(long quantity, const std::string& name) {
    const QuantityInfo* q = CUnitUtil::FindQuantity(quantity);
    EXPECT_NE(q, nullptr);
    for (const UnitInfo& u : q ? q->units : std::vector<UnitInfo>{})
        if (u.name == name)
            return u.id;
    ADD_FAILURE() << "no unit " << name;
    return 0;
}

// Puts the user's unit choices back after a test that changes them.
struct UserUnitsReset {
    ~UserUnitsReset() { CUnitUtil::ResetUserUnits(); }
};

} // namespace bedtest
