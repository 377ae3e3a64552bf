#include "fem/UnitUtil.h"
#include "support/UiTestSupport.h"
#include "widgets/ZoNumberEdit.h"
#include "widgets/ZoSEGridToolbar.h"
#include "widgets/ZoSEGridWndBase.h"

#include <QAction>
#include <QApplication>
#include <QComboBox>
#include <QHeaderView>
#include <QLayout>
#include <QScrollBar>
#include <QTest>
#include <QVBoxLayout>

#include <algorithm>

#include <gtest/gtest.h>

using namespace uitest;

namespace {

struct Row : CZoSEKivBase {
    explicit Row(CZoSEKivBase* parent) : CZoSEKivBase("Item %d", "ITEM_%d", parent), id(++next) {}
    static inline int next = 0;
    int id;
    bool on = true;
    int kind = 0;
    double velocity = 0.001;
    CString file;
};
using RowList = CZoSEKivListBase<Row>;

// A section grid as sections write them: headings, a style per cell, a store per cell.
template <class Base>
class CTestGrid : public Base {
public:
    using Base::Base;
    void Initialize(CZoSEDlgBase* dialog, RowList* list) {
        Base::Initialize(dialog, list);
        this->SetColumnHeadings({"Item", "On", "Kind", "Velocity", "File", ""});
    }

protected:
    void GetItemStyle(Row* item, int, int col, CGridCellStyle& s) override {
        switch (col) {
        case 1: s.SetCheckBox(item->on); break;
        case 2: s.SetChoice({"Soft", "Hard"}, item->kind); break;
        case 3:
            s.SetNumber(item->velocity, CZoEditStyle().SetOvuUnitBaseGroup(100128).SetMinimum(0))
                .SetReadOnly(!item->on);
            break;
        case 4: s.SetFileName(item->file, "Time series (*.qrd0)"); break;
        case 5: s.SetButton(kGoToLabel).SetReadOnly(!item->on); break;
        }
    }
    int StoreItem(Row* item, int, int col, const CGridCellValue& v) override {
        switch (col) {
        case 1: item->on = v.checked; return kHintValueChanged;
        case 2: item->kind = v.choice; return kHintValueChanged;
        case 3: item->velocity = v.number; return kHintValueChanged;
        case 4: item->file = v.text; return kHintValueChanged;
        }
        return 0;
    }
};

class CGridTestDlg : public CZoSEDlgBase {
public:
    void Place(CZoSEGridWndCore* g) {
        grid = g;
        toolbar = new CZoSEGridToolbar(grid, this);
        auto* layout = new QVBoxLayout(this);
        layout->addWidget(toolbar);
        layout->addWidget(grid);
        layout->addStretch(1);
    }
    void SetData() override {
        CZoSEDlgBase::SetData();
        grid->Redraw();
    }
    CZoSEGridWndCore* grid = nullptr;
    CZoSEGridToolbar* toolbar = nullptr;
};

class Grid : public ::testing::Test {
protected:
    void Open(bool editGrid, int items = 5) {
        Row::next = 0;
        list = new RowList("Items", "ITEMS", &root);
        root.AddChild(list);
        list->SetItemCount(items, 1);
        dialog = std::make_unique<CGridTestDlg>();
        dialog->Attach(list, &host);
        if (editGrid) {
            auto* g = new CTestGrid<CFemGridEditWnd<Row>>(dialog.get());
            g->Initialize(dialog.get(), list);
            grid = g;
        } else {
            auto* g = new CTestGrid<CFemGridWnd<Row>>(dialog.get());
            g->Initialize(dialog.get(), list);
            grid = g;
        }
        dialog->Place(grid);
        dialog->Initialize();
        grid->FitColumns();
        dialog->resize(700, 500);
        dialog->show();
        ASSERT_TRUE(QTest::qWaitForWindowExposed(dialog.get()));
    }
    void TearDown() override { CUnitUtil::ResetUserUnits(); }

    std::vector<int> Ids() const {
        std::vector<int> ids;
        for (int i = 1; i <= list->GetItemCount(); ++i)
            ids.push_back(list->GetItem(i)->id);
        return ids;
    }
    void ClickRowHeading(int row, Qt::KeyboardModifiers modifiers = Qt::NoModifier) {
        QHeaderView* h = grid->verticalHeader();
        const int y = h->sectionViewportPosition(row - 1) + h->sectionSize(row - 1) / 2;
        QTest::mouseClick(h->viewport(), Qt::LeftButton, modifiers, QPoint(h->width() / 2, y));
    }
    void ClickCell(int row, int col, QPoint offset = QPoint()) {
        const QRect r = grid->CellRect(row, col);
        QTest::mouseClick(grid->viewport(), Qt::LeftButton, Qt::NoModifier,
                          offset.isNull() ? r.center() : r.topLeft() + offset);
    }
    void CtrlKey(Qt::Key key) {
        QTest::keyPress(grid, key, Qt::ControlModifier);
        QTest::keyRelease(grid, key, Qt::ControlModifier);
    }
    // The open editor of the grid (closed ones wait hidden for deletion).
    template <class W>
    W* Editor() const {
        for (W* w : grid->viewport()->findChildren<W*>())
            if (w->isVisible())
                return w;
        return nullptr;
    }
    std::vector<std::pair<int, int>> Selected() const {
        std::vector<std::pair<int, int>> out;
        for (const auto& r : grid->GetSelectedRowRanges())
            out.push_back({r.top, r.bottom});
        return out;
    }

    CZoSEKivGlobalBase root;
    RowList* list = nullptr;
    CRecordingHost host;
    std::unique_ptr<CGridTestDlg> dialog;
    CZoSEGridWndCore* grid = nullptr;
};

TEST_F(Grid, EveryCellIsReadFromTheList) {
    CUnitUtil::SetUserUnit(100128, CUnitUtil::FindQuantity(100128)->units.at(1).id);  // mm/s
    Open(true, 3);
    EXPECT_EQ(grid->GetRowCount(), 3);
    EXPECT_EQ(grid->GetColCount(), 5);
    QAbstractItemModel* m = grid->model();
    EXPECT_EQ(grid->CellStyle(0, 0).text, "Item");
    EXPECT_EQ(m->headerData(0, Qt::Horizontal).toString(), "On");
    EXPECT_EQ(m->headerData(2, Qt::Vertical).toString(), "Item 3");
    EXPECT_EQ(m->data(grid->IndexOf(1, 2)).toString(), "Soft");
    EXPECT_EQ(m->data(grid->IndexOf(1, 3)).toString(), "1");
    EXPECT_EQ(m->data(grid->IndexOf(1, 3), Qt::ToolTipRole).toString(), "Settling velocity [mm/s]");
    EXPECT_EQ(m->data(grid->IndexOf(1, 5)).toString(), "Go to...");

    // The grid keeps nothing: a change in the list shows at the next redraw.
    list->GetItem(2)->kind = 1;
    list->Append();
    grid->Redraw();
    EXPECT_EQ(m->data(grid->IndexOf(2, 2)).toString(), "Hard");
    EXPECT_EQ(grid->GetRowCount(), 4);
}

TEST_F(Grid, CtrlInsertOnRowThreeInsertsThereWhenTheKeyIsReleased) {
    Open(true);
    ClickRowHeading(3);
    QTest::keyPress(grid, Qt::Key_Insert, Qt::ControlModifier);
    EXPECT_EQ(Ids(), (std::vector<int>{1, 2, 3, 4, 5}));
    QTest::keyRelease(grid, Qt::Key_Insert, Qt::ControlModifier);
    EXPECT_EQ(Ids(), (std::vector<int>{1, 2, 6, 3, 4, 5}));
    EXPECT_EQ(grid->GetRowCount(), 6);
    EXPECT_EQ(host.hints, (std::vector<int>{2}));
}

TEST_F(Grid, RowKeysActOnTheCurrentRow) {
    Open(true);
    ClickRowHeading(3);
    CtrlKey(Qt::Key_Up);
    EXPECT_EQ(Ids(), (std::vector<int>{1, 3, 2, 4, 5}));
    int row = 0, col = 0;
    ASSERT_TRUE(grid->GetCurrentCell(row, col));
    EXPECT_EQ(row, 2);
    CtrlKey(Qt::Key_Down);
    EXPECT_EQ(Ids(), (std::vector<int>{1, 2, 3, 4, 5}));
    ASSERT_TRUE(grid->GetCurrentCell(row, col));
    EXPECT_EQ(row, 3);
    CtrlKey(Qt::Key_Delete);
    EXPECT_EQ(Ids(), (std::vector<int>{1, 2, 4, 5}));
    EXPECT_EQ(host.hints, (std::vector<int>{16, 16, 4}));

    // Nothing to move past the ends: no hint.
    host.Clear();
    ClickRowHeading(1);
    CtrlKey(Qt::Key_Up);
    ClickRowHeading(4);
    CtrlKey(Qt::Key_Down);
    EXPECT_EQ(Ids(), (std::vector<int>{1, 2, 4, 5}));
    EXPECT_TRUE(host.hints.empty());
}

TEST_F(Grid, RowsSelectedByTheirHeadingsAreDeletedTogether) {
    Open(true);
    ClickRowHeading(2);
    ClickRowHeading(4, Qt::ShiftModifier);
    EXPECT_EQ(Selected(), (std::vector<std::pair<int, int>>{{2, 4}}));
    dialog->toolbar->DeleteAction()->trigger();
    EXPECT_EQ(Ids(), (std::vector<int>{1, 5}));
    EXPECT_EQ(grid->GetRowCount(), 2);
    EXPECT_EQ(host.hints, (std::vector<int>{4}));

    // Two separate ranges are not deleted; the hint comes all the same.
    host.Clear();
    list->SetItemCount(4, 1);
    grid->Redraw();
    ClickRowHeading(1);
    ClickRowHeading(3, Qt::ControlModifier);
    grid->DeleteItems();
    EXPECT_EQ(list->GetItemCount(), 4);
    EXPECT_EQ(host.hints, (std::vector<int>{4}));
}

TEST_F(Grid, MovingRowsTakesTheSelectionAlong) {
    Open(true);
    ClickRowHeading(1);
    dialog->toolbar->MoveUpAction()->trigger();
    EXPECT_EQ(Ids(), (std::vector<int>{1, 2, 3, 4, 5}));
    EXPECT_EQ(host.hints, (std::vector<int>{16}));

    host.Clear();
    ClickRowHeading(2);
    ClickRowHeading(3, Qt::ShiftModifier);
    dialog->toolbar->MoveDownAction()->trigger();
    EXPECT_EQ(Ids(), (std::vector<int>{1, 4, 2, 3, 5}));
    EXPECT_EQ(Selected(), (std::vector<std::pair<int, int>>{{3, 4}}));
    dialog->toolbar->MoveUpAction()->trigger();
    dialog->toolbar->MoveUpAction()->trigger();
    EXPECT_EQ(Ids(), (std::vector<int>{2, 3, 1, 4, 5}));
    EXPECT_EQ(Selected(), (std::vector<std::pair<int, int>>{{1, 2}}));
    ClickRowHeading(5);
    dialog->toolbar->MoveDownAction()->trigger();
    EXPECT_EQ(Ids(), (std::vector<int>{2, 3, 1, 4, 5}));
    EXPECT_EQ(host.hints, (std::vector<int>{16, 16, 16, 16}));
}

TEST_F(Grid, InsertingPutsTheNewItemsWhereTheSelectionBeganOrAppends) {
    Open(true);
    ClickRowHeading(1);
    ClickRowHeading(2, Qt::ShiftModifier);
    dialog->toolbar->InsertAction()->trigger();
    EXPECT_EQ(Ids(), (std::vector<int>{7, 6, 1, 2, 3, 4, 5}));
    EXPECT_EQ(host.hints, (std::vector<int>{2, 16}));

    host.Clear();
    grid->ClearSelection();
    dialog->toolbar->InsertAction()->trigger();
    EXPECT_EQ(Ids(), (std::vector<int>{7, 6, 1, 2, 3, 4, 5, 8}));
    EXPECT_EQ(grid->GetRowCount(), 8);
    EXPECT_EQ(host.hints, (std::vector<int>{2}));
}

TEST_F(Grid, OverviewGridsLeaveTheKeysToThePlainGrid) {
    Open(false);
    ClickRowHeading(2);
    CtrlKey(Qt::Key_Delete);
    CtrlKey(Qt::Key_Insert);
    EXPECT_EQ(Ids(), (std::vector<int>{1, 2, 3, 4, 5}));
    EXPECT_TRUE(host.hints.empty());
    // Its toolbar still works.
    dialog->toolbar->DeleteAction()->trigger();
    EXPECT_EQ(Ids(), (std::vector<int>{1, 3, 4, 5}));
}

TEST_F(Grid, GoToSelectsTheRowsItem) {
    Open(false);
    ClickCell(2, 5);
    ClickCell(4, 5);
    EXPECT_EQ(host.selected, (std::vector<CZoSEKivBase*>{list->GetItem(2), list->GetItem(4)}));
    EXPECT_TRUE(host.hints.empty());
}

TEST_F(Grid, CheckBoxesToggleAndReadOnlyCellsLookDisabled) {
    Open(true, 2);
    QAbstractItemModel* m = grid->model();
    EXPECT_TRUE(m->flags(grid->IndexOf(1, 3)) & Qt::ItemIsEditable);
    EXPECT_FALSE(m->data(grid->IndexOf(1, 3), Qt::BackgroundRole).isValid());
    ClickCell(1, 1);
    EXPECT_FALSE(list->GetItem(1)->on);
    EXPECT_TRUE(list->GetItem(2)->on);
    EXPECT_EQ(host.hints, (std::vector<int>{1}));
    EXPECT_FALSE(m->flags(grid->IndexOf(1, 3)) & Qt::ItemIsEditable);
    EXPECT_EQ(m->data(grid->IndexOf(1, 3), Qt::BackgroundRole).value<QBrush>().color(),
              QApplication::palette().color(QPalette::Button));
    EXPECT_EQ(m->data(grid->IndexOf(1, 3), Qt::ForegroundRole).value<QBrush>().color(),
              QColor(160, 160, 160));
    // A read-only cell opens no editor.
    ClickCell(1, 3);
    EXPECT_EQ(Editor<CZoNumberEdit>(), nullptr);
}

TEST_F(Grid, NumberCellsEditInTheUsersUnitAndRefuseBadInput) {
    CUnitUtil::SetUserUnit(100128, CUnitUtil::FindQuantity(100128)->units.at(1).id);  // mm/s
    Open(true, 2);
    ClickCell(2, 3);
    auto* editor = Editor<CZoNumberEdit>();
    ASSERT_TRUE(editor);
    EXPECT_EQ(editor->text(), "1");
    Enter(editor, "2.5");
    QApplication::processEvents();
    EXPECT_DOUBLE_EQ(list->GetItem(2)->velocity, 0.0025);
    EXPECT_EQ(host.hints, (std::vector<int>{1}));
    EXPECT_EQ(grid->model()->data(grid->IndexOf(2, 3)).toString(), "2.5");

    MessageRecorder messages;
    ClickCell(1, 3);
    editor = Editor<CZoNumberEdit>();
    ASSERT_TRUE(editor);
    Enter(editor, "-1");
    QApplication::processEvents();
    EXPECT_EQ(list->GetItem(1)->velocity, 0.001);
    EXPECT_EQ(messages.Messages(), (std::vector<QString>{"Velocity (Items): Please enter a number of at least 0 mm/s."}));
    EXPECT_EQ(host.hints, (std::vector<int>{1}));
}

TEST_F(Grid, ChoicesAndFileNamesAreStoredAsSoonAsTheyAreMade) {
    Open(true, 2);
    ClickCell(2, 2);
    auto* box = Editor<QComboBox>();
    ASSERT_TRUE(box);
    Choose(box, "Hard");
    EXPECT_EQ(list->GetItem(2)->kind, 1);
    EXPECT_EQ(host.hints, (std::vector<int>{1}));

    {
        FileChooserStub chooser("/data/tide.qrd0");
        const QRect cell = grid->CellRect(1, 4);
        ClickCell(1, 4, QPoint(cell.width() - 4, cell.height() / 2));
        EXPECT_EQ(chooser.Calls(), 1);
    }
    EXPECT_EQ(list->GetItem(1)->file, "/data/tide.qrd0");
    EXPECT_EQ(host.hints, (std::vector<int>{1, 1}));

    // The text part of the cell edits the name itself.
    ClickCell(2, 4, QPoint(4, grid->CellRect(2, 4).height() / 2));
    auto* line = Editor<QLineEdit>();
    ASSERT_TRUE(line);
    Enter(line, "local.qrd0");
    QApplication::processEvents();
    EXPECT_EQ(list->GetItem(2)->file, "local.qrd0");
}

TEST_F(Grid, GreyedLinksAreDrawnInTheDisabledColours) {
    Open(false, 2);
    list->GetItem(2)->on = false;
    grid->Redraw();
    // The darkest pixel of a cell: the label of the button in it.
    auto darkest = [&](int row, int col) {
        const QImage image = grid->viewport()->grab(grid->CellRect(row, col)).toImage();
        int dark = 255;
        for (int y = 0; y < image.height(); ++y)
            for (int x = 0; x < image.width(); ++x)
                dark = std::min(dark, qGray(image.pixel(x, y)));
        return dark;
    };
    auto grey = [&](QPalette::ColorGroup group) {
        return qGray(grid->palette().color(group, QPalette::ButtonText).rgb());
    };
    EXPECT_LE(darkest(1, 5), grey(QPalette::Active) + 40);
    EXPECT_GE(darkest(2, 5), grey(QPalette::Disabled) - 40);
    // A greyed link does nothing.
    ClickCell(2, 5);
    ClickCell(1, 5);
    EXPECT_EQ(host.selected, (std::vector<CZoSEKivBase*>{list->GetItem(1)}));
}

TEST(GridFit, ScrollBarsOnlyWhereTheContentDoesNotFit) {
    const QSize avail(300, 200);
    auto fit = [&](QSize content) { return ZoFitGrid(avail, content, 15, 12); };
    ZoGridFit f = fit({250, 150});
    EXPECT_EQ(f.size, QSize(250, 150));
    EXPECT_FALSE(f.horizontalBar || f.verticalBar);
    f = fit({500, 150});
    EXPECT_EQ(f.size, QSize(300, 162));
    EXPECT_TRUE(f.horizontalBar);
    EXPECT_FALSE(f.verticalBar);
    f = fit({500, 195});
    EXPECT_EQ(f.size, QSize(300, 200));
    EXPECT_TRUE(f.horizontalBar && f.verticalBar);
    f = fit({250, 400});
    EXPECT_EQ(f.size, QSize(265, 200));
    EXPECT_FALSE(f.horizontalBar);
    EXPECT_TRUE(f.verticalBar);
    f = fit({290, 400});
    EXPECT_EQ(f.size, QSize(300, 200));
    EXPECT_TRUE(f.horizontalBar && f.verticalBar);
}

TEST_F(Grid, AGridWiderThanItsDialogReachesTheRightMarginWithAScrollBar) {
    Open(true, 2);
    for (int c = 0; c < grid->GetColCount(); ++c)
        grid->setColumnWidth(c, 150);
    dialog->resize(400, 500);
    QApplication::processEvents();
    grid->SizeToDialog();
    QApplication::processEvents();
    const ZoGridFit& f = grid->LastFit();
    EXPECT_TRUE(f.horizontalBar);
    EXPECT_FALSE(f.verticalBar);
    const int rightMargin = dialog->layout()->contentsMargins().right();
    const int available = dialog->width() - rightMargin - grid->mapTo(dialog.get(), QPoint()).x();
    EXPECT_EQ(grid->width(), available);
    EXPECT_EQ(f.size.width(), available - 2 * grid->frameWidth());
    EXPECT_EQ(grid->horizontalScrollBarPolicy(), Qt::ScrollBarAlwaysOn);

    // A wider dialog fits it again, without the bar.
    dialog->resize(1400, 500);
    QApplication::processEvents();
    EXPECT_FALSE(grid->LastFit().horizontalBar);
}

}  // namespace
