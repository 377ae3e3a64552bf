// Helpers for the water-column and dispersion dialog tests.
#pragma once

#include "WaterColumnTestSupport.h"
#include "fem/UnitUtil.h"
#include "support/UiTestSupport.h"
#include "widgets/ZoGridWnd.h"
#include "widgets/ZoNumberEdit.h"

#include <QAbstractButton>
#include <QCoreApplication>
#include <QRadioButton>
#include <QStyle>
#include <QStyleOptionButton>
#include <QTest>

#include <string>
#include <vector>

namespace wcui {

// Fresh documents, the user's units restored after each test.
class DialogTest : public ::testing::Test {
protected:
    void TearDown() override { CUnitUtil::ResetUserUnits(); }

    // Shows a quantity in its unit named unitName.
    static void UseUnit(long quantity, const char* unitName) {
        const QuantityInfo* q = CUnitUtil::FindQuantity(quantity);
        ASSERT_NE(q, nullptr);
        for (const UnitInfo& u : q->units)
            if (std::string(u.name) == unitName) {
                ASSERT_TRUE(CUnitUtil::SetUserUnit(quantity, u.id));
                return;
            }
        FAIL() << "no unit " << unitName;
    }

    uitest::CRecordingHost host;
};

inline void ClickCell(CZoGridWnd* grid, int row, int col) {
    ASSERT_NE(grid, nullptr);
    const QRect cell = grid->CellRect(row, col);
    ASSERT_TRUE(cell.isValid()) << "cell " << row << "," << col << " is not shown";
    QTest::mouseClick(grid->viewport(), Qt::LeftButton, Qt::NoModifier, cell.center());
}

// Clicks a number cell (which opens its editor), types the text and presses Return.
inline void EnterInCell(CZoGridWnd* grid, int row, int col, const QString& text) {
    ClickCell(grid, row, col);
    auto* editor = grid->viewport()->findChild<CZoNumberEdit*>();
    ASSERT_NE(editor, nullptr) << "no editor opened in cell " << row << "," << col;
    uitest::Enter(editor, text);
    // The grid commits an editor's value after the key has been handled.
    QCoreApplication::processEvents();
}

// Clicks a check box or radio button on its indicator (a click beside its text misses it).
inline void ClickButton(QAbstractButton* button) {
    ASSERT_NE(button, nullptr);
    QStyleOptionButton option;
    option.initFrom(button);
    const bool radio = qobject_cast<QRadioButton*>(button) != nullptr;
    const QRect indicator = button->style()->subElementRect(
        radio ? QStyle::SE_RadioButtonIndicator : QStyle::SE_CheckBoxIndicator, &option, button);
    QTest::mouseClick(button, Qt::LeftButton, Qt::NoModifier, indicator.center());
}

inline std::string CellText(CZoGridWnd* grid, int row, int col) {
    return grid->CellStyle(row, col).DisplayText().toStdString();
}

// The texts of a column, rows 1 to the last.
inline std::vector<std::string> Column(CZoGridWnd* grid, int col) {
    std::vector<std::string> out;
    for (int row = 1; row <= grid->GetRowCount(); ++row)
        out.push_back(CellText(grid, row, col));
    return out;
}

inline std::vector<std::string> Headings(CZoGridWnd* grid) {
    std::vector<std::string> out;
    for (int col = 0; col <= grid->GetColCount(); ++col)
        out.push_back(CellText(grid, 0, col));
    return out;
}

} // namespace wcui
