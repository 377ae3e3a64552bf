#include "BedUiTestSupport.h"
#include "bed/MTTransitionGrid.h"
#include "bed/MTTransitionListKiv.h"

#include <QCheckBox>
#include <QHeaderView>

using namespace bedtest;
using namespace uitest;

namespace {

CMTTransitionListKiv* Transition(CSetupDocument& doc) {
    return Node<CMTTransitionListKiv>(doc, {"BED", "TRANSITION"});
}

// Cells whose greying differs from the expectation, headings and row titles included.
std::vector<std::string> CellsNotGreyed(CZoGridWnd* grid, bool greyed) {
    std::vector<std::string> wrong;
    for (int row = 0; row <= grid->GetRowCount(); ++row)
        for (int col = 0; col <= grid->GetColCount(); ++col) {
            // The format column is read-only whatever the flag.
            const bool expected = greyed || (row > 0 && col == 1);
            if (grid->CellStyle(row, col).readOnly != expected)
                wrong.push_back(std::to_string(row) + "," + std::to_string(col));
        }
    return wrong;
}

} // namespace

TEST(MTTransitionListDlg, GridIsGreyedWhileTransitionIsNotIncluded) {
    auto doc = NewSetup(3);
    CRecordingHost host;
    auto dlg = OpenDialog(Transition(*doc), host);
    auto* grid = Child<CMTTransitionGrid>(dlg.get(), "grid");
    auto* include = Child<QCheckBox>(dlg.get(), "include");
    ASSERT_TRUE(grid && include);
    EXPECT_EQ(include->text(), "Include");
    EXPECT_FALSE(include->isChecked());
    EXPECT_EQ(RowTexts(grid, 0), (std::vector<std::string>{"Transition", "Format", "Edit"}));
    EXPECT_EQ(RowTexts(grid, 2),
              (std::vector<std::string>{"Between layer 2 and 3", "Constant 0.001 1/s", "Go to..."}));

    EXPECT_EQ(CellsNotGreyed(grid, true), std::vector<std::string>{});
    // Drawn disabled: button-face background and grey text, the headings as well.
    const QModelIndex link = grid->IndexOf(1, 2);
    EXPECT_EQ(link.data(Qt::ForegroundRole).value<QBrush>().color(), QColor(160, 160, 160));
    EXPECT_EQ(link.data(Qt::BackgroundRole).value<QBrush>().color(),
              grid->palette().color(QPalette::Active, QPalette::Button));
    EXPECT_EQ(
        grid->model()->headerData(0, Qt::Horizontal, Qt::ForegroundRole).value<QBrush>().color(),
        QColor(160, 160, 160));
    // A greyed link does nothing.
    ClickCell(grid, 1, 2);
    EXPECT_TRUE(host.selected.empty());

    ClickButton(include);
    EXPECT_TRUE(Transition(*doc)->IncludeTransition());
    EXPECT_EQ(host.hints, (std::vector<int>{1}));
    EXPECT_TRUE(include->isChecked());
    EXPECT_EQ(CellsNotGreyed(grid, false), std::vector<std::string>{});
    ClickCell(grid, 2, 2);
    EXPECT_EQ(host.selected, (std::vector<CZoSEKivBase*>{Transition(*doc)->GetItem(2)}));

    host.Clear();
    ClickButton(include);
    EXPECT_FALSE(Transition(*doc)->IncludeTransition());
    EXPECT_EQ(host.hints, (std::vector<int>{1}));
    EXPECT_EQ(CellsNotGreyed(grid, true), std::vector<std::string>{});
}

TEST(MTTransitionListDlg, ShowsTheStoredFlagWithNoRowsForOneLayer) {
    auto doc = testsupport::Load(R"(
MUD_TRANSPORT_MODULE {
    MODEL_DEFINITION {
        number_of_layers = 1
    }
    BED {
        TRANSITION {
            include_transition = true
        }
    }
}
)");
    CRecordingHost host;
    auto dlg = OpenDialog(Transition(*doc), host);
    auto* grid = Child<CMTTransitionGrid>(dlg.get(), "grid");
    EXPECT_TRUE(Child<QCheckBox>(dlg.get(), "include")->isChecked());
    EXPECT_EQ(grid->GetRowCount(), 0);
    EXPECT_EQ(grid->CellStyle(0, 0).DisplayText(), "Transition");
}
