// The dredging page (grid of dredgers, row operations, update of the bed) and the dredger
// page (enabling rules, masses, fraction grid, projection, the time series' selector and
// viewer): what each control stores and the hint it sends.
#include "DredgingTestSupport.h"
#include "core/ParameterSelectionKiv.h"
#include "dredging/MTDredgingDlg.h"
#include "dredging/MTDredgingFractionGrid.h"
#include "dredging/MTDredgingGrid.h"
#include "dredging/MTDredgingItemsDlg.h"
#include "dredging/MTDredgingMapDlg.h"
#include "fem/DomainKiv.h"
#include "fem/UnitUtil.h"
#include "support/UiTestSupport.h"
#include "widgets/ZoDataViewerDlg.h"
#include "widgets/ZoFileSelectorDlg.h"
#include "widgets/ZoNumberEdit.h"
#include "widgets/ZoSEGridToolbar.h"

#include <QAbstractItemView>
#include <QAction>
#include <QCheckBox>
#include <QComboBox>
#include <QCoreApplication>
#include <QLabel>
#include <QPushButton>
#include <QStyleOptionButton>
#include <QTest>

using namespace uitest;
using namespace dredgingtest;

namespace {

void ClickCell(CZoGridWnd* grid, int row, int col) {
    ASSERT_NE(grid, nullptr);
    const QRect cell = grid->CellRect(row, col);
    ASSERT_TRUE(cell.isValid()) << "cell " << row << "," << col << " is not shown";
    QTest::mouseClick(grid->viewport(), Qt::LeftButton, Qt::NoModifier, cell.center());
}

// Clicks a text or number cell (which opens its editor), types the text and presses Return.
void EnterInCell(CZoGridWnd* grid, int row, int col, const QString& text) {
    ClickCell(grid, row, col);
    auto* editor = grid->viewport()->findChild<QLineEdit*>();
    ASSERT_NE(editor, nullptr) << "no editor opened in cell " << row << "," << col;
    Enter(editor, text);
    QCoreApplication::processEvents();
}

void ClickBox(QCheckBox* box) {
    ASSERT_NE(box, nullptr);
    QStyleOptionButton option;
    option.initFrom(box);
    const QRect indicator = box->style()->subElementRect(QStyle::SE_CheckBoxIndicator, &option, box);
    QTest::mouseClick(box, Qt::LeftButton, Qt::NoModifier, indicator.center());
}

std::string Cell(CZoGridWnd* grid, int row, int col) {
    return grid->CellStyle(row, col).DisplayText().toStdString();
}

std::vector<std::string> Names(CMTDredgingKiv* list) {
    std::vector<std::string> out;
    for (int i = 1; i <= list->GetItemCount(); ++i)
        out.push_back(list->GetItem(i)->Name());
    return out;
}

class DredgingPage : public ::testing::Test {
protected:
    void Open(int dredgers) {
        Dredging(doc)->SetItemCount(dredgers, 1);
        dlg = OpenDialog(Dredging(doc), host);
        ASSERT_TRUE(dlg);
        page = dynamic_cast<CMTDredgingDlg*>(dlg.get());
        ASSERT_NE(page, nullptr);
        host.Clear();
    }
    CSetupDocument doc;
    CRecordingHost host;
    std::unique_ptr<CZoSEDlgBase> dlg;
    CMTDredgingDlg* page = nullptr;
};

class DredgerPage : public ::testing::Test {
protected:
    void TearDown() override { CUnitUtil::ResetUserUnits(); }
    void Open(int fractions = 3) {
        ModelDefinition(doc.Module())->NumberOfFractions(fractions);
        dredger = Dredging(doc)->Append();
        Reopen();
    }
    void Reopen() {
        dlg = OpenDialog(dredger, host, QSize(800, 700));
        ASSERT_TRUE(dlg);
        page = dynamic_cast<CMTDredgingItemsDlg*>(dlg.get());
        ASSERT_NE(page, nullptr);
        host.Clear();
    }
    CSetupDocument doc;
    CRecordingHost host;
    CMTDredgingItemsKiv* dredger = nullptr;
    std::unique_ptr<CZoSEDlgBase> dlg;
    CMTDredgingItemsDlg* page = nullptr;
};

}  // namespace

TEST_F(DredgingPage, TheGridShowsNumberNameIncludeAndLink) {
    Open(2);
    CMTDredgingGrid* grid = page->Grid();
    EXPECT_EQ(grid->GetRowCount(), 2);
    EXPECT_EQ(Cell(grid, 0, 0), "Dredger No.");
    EXPECT_EQ(Cell(grid, 0, 1), "Name");
    EXPECT_EQ(Cell(grid, 0, 2), "Include");
    EXPECT_EQ(Cell(grid, 0, 3), "Edit");
    EXPECT_EQ(QString::fromStdString(Cell(grid, 2, 0)).trimmed(), "2");
    EXPECT_EQ(Cell(grid, 2, 1), "Dredger 2");
    EXPECT_EQ(grid->CellStyle(1, 1).align, ZoCellAlign::Left);
    EXPECT_EQ(Cell(grid, 1, 3), "Go to...");

    ClickCell(grid, 2, 3);
    EXPECT_EQ(host.selected, (std::vector<CZoSEKivBase*>{Dredging(doc)->GetItem(2)}));

    EnterInCell(grid, 1, 1, "Hopper");
    EXPECT_EQ(Dredging(doc)->GetItem(1)->GetTitle(), "Hopper");
    EXPECT_EQ(host.hints, (std::vector<int>{8}));
}

TEST_F(DredgingPage, ADredgerLeftOutShowsNameAndLinkGreyedButStaysIncludable) {
    Open(2);
    CMTDredgingGrid* grid = page->Grid();
    ClickCell(grid, 2, 2);
    EXPECT_EQ(Dredging(doc)->GetItem(2)->Include(), 0);
    EXPECT_EQ(host.hints, (std::vector<int>{1}));
    EXPECT_TRUE(grid->CellStyle(2, 1).readOnly);
    EXPECT_TRUE(grid->CellStyle(2, 3).readOnly);
    EXPECT_FALSE(grid->CellStyle(2, 2).readOnly);
    EXPECT_FALSE(grid->CellStyle(1, 3).readOnly);
    EXPECT_EQ(Cell(grid, 2, 1), "Dredger 2");
    // The greyed link goes nowhere; the check box brings the dredger back.
    ClickCell(grid, 2, 3);
    EXPECT_TRUE(host.selected.empty());
    ClickCell(grid, 2, 2);
    EXPECT_EQ(Dredging(doc)->GetItem(2)->Include(), 1);
}

TEST_F(DredgingPage, NewAndDeleteButtonsAndTheBedUpdate) {
    Open(0);
    for (int i = 0; i < 5; ++i)
        QTest::mouseClick(page->NewButton(), Qt::LeftButton);
    EXPECT_EQ(page->Grid()->GetRowCount(), 5);
    EXPECT_EQ(host.hints, (std::vector<int>{2, 16, 2, 16, 2, 16, 2, 16, 2, 16}));
    EXPECT_EQ(Names(Dredging(doc)), (std::vector<std::string>{"Dredger 1", "Dredger 2", "Dredger 3",
                                                             "Dredger 4", "Dredger 5"}));

    // Nothing selected: nothing goes.
    host.Clear();
    QTest::mouseClick(page->DeleteButton(), Qt::LeftButton);
    EXPECT_EQ(Dredging(doc)->GetItemCount(), 5);
    EXPECT_TRUE(host.hints.empty());

    page->Grid()->SelectRows(2, 4);
    QTest::mouseClick(page->DeleteButton(), Qt::LeftButton);
    EXPECT_EQ(Names(Dredging(doc)), (std::vector<std::string>{"Dredger 1", "Dredger 5"}));
    EXPECT_EQ(page->Grid()->GetRowCount(), 2);
    EXPECT_EQ(host.hints, (std::vector<int>{4}));

    host.Clear();
    ClickBox(page->UpdateBedBox());
    EXPECT_FALSE(Dredging(doc)->UpdateBed());
    EXPECT_EQ(host.hints, (std::vector<int>{1}));
}

TEST_F(DredgingPage, RowOperationsFromTheToolbarAndTheKeys) {
    Open(3);
    CMTDredgingGrid* grid = page->Grid();
    grid->SelectRows(2, 2);
    page->Toolbar()->MoveUpAction()->trigger();
    EXPECT_EQ(Names(Dredging(doc)), (std::vector<std::string>{"Dredger 2", "Dredger 1", "Dredger 3"}));
    EXPECT_EQ(host.hints, (std::vector<int>{16}));

    host.Clear();
    grid->SetCurrentCell(3, 1);
    grid->setFocus();
    QTest::keyClick(grid, Qt::Key_Insert, Qt::ControlModifier);
    EXPECT_EQ(Dredging(doc)->GetItemCount(), 4);
    EXPECT_EQ(Dredging(doc)->GetItem(3)->Name(), "Dredger 4");
    EXPECT_EQ(host.hints, (std::vector<int>{2}));

    host.Clear();
    grid->SelectRows(1, 2);
    page->Toolbar()->DeleteAction()->trigger();
    EXPECT_EQ(Names(Dredging(doc)), (std::vector<std::string>{"Dredger 4", "Dredger 3"}));
    EXPECT_EQ(host.hints, (std::vector<int>{4}));
}

TEST_F(DredgerPage, SpillPlacementOnlyInAThreeDimensionalDomain) {
    Open();
    dredger->Type(3);
    page->SetData();
    EXPECT_FALSE(page->SpillBox()->isEnabled());
    EXPECT_FALSE(page->SpillLabel()->isEnabled());
    EXPECT_EQ(page->SpillBox()->currentText(), "Spill uniformed in the bottom and the top layer");
    EXPECT_EQ(page->SpillBox()->count(), 4);

    Domain(doc.Module())->ThreeD(true);
    page->SetData();
    EXPECT_TRUE(page->SpillBox()->isEnabled());
    EXPECT_TRUE(page->SpillLabel()->isEnabled());
    Choose(page->SpillBox(), "Spill uniformed distributed in the water column");
    EXPECT_EQ(dredger->Type(), 4);
    ASSERT_FALSE(host.hints.empty());
    EXPECT_EQ(host.hints.back(), 1);

    // A type no entry stands for is shown, not changed.
    dredger->Type(9);
    page->SetData();
    EXPECT_EQ(page->SpillBox()->currentText(), "Unknown type of spilling 9");
    EXPECT_EQ(dredger->Type(), 9);

    // It makes the dredger invalid in two dimensions too, so it can be mended there.
    Domain(doc.Module())->ThreeD(false);
    page->SetData();
    EXPECT_TRUE(page->SpillBox()->isEnabled());
    EXPECT_TRUE(page->SpillLabel()->isEnabled());
    EXPECT_EQ(dredger->ValidateData(), 0);
    // One pick in the list's popup; the choice greys again once the type is known.
    QComboBox* box = page->SpillBox();
    box->showPopup();
    QAbstractItemView* view = box->view();
    const QModelIndex first = view->model()->index(0, 0);
    QTest::mouseClick(view->viewport(), Qt::LeftButton, {}, view->visualRect(first).center());
    EXPECT_EQ(dredger->Type(), 1);
    page->SetData();
    EXPECT_EQ(page->SpillBox()->count(), 4);
    EXPECT_FALSE(page->SpillBox()->isEnabled());
}

TEST_F(DredgerPage, MassesAreEditableOnlyWhileTheDredgerIsUpdated) {
    Open();
    EXPECT_TRUE(page->UpdateDredgerBox()->isChecked());
    EXPECT_TRUE(page->MaximumMassEdit()->isEnabled());
    EXPECT_EQ(page->MaximumMassEdit()->text().toDouble(), 1e7);

    Enter(page->InitialMassEdit(), "250");
    EXPECT_EQ(dredger->InitialDredgerMass(), 250.0);
    EXPECT_EQ(host.hints, (std::vector<int>{1}));

    host.Clear();
    ClickBox(page->UpdateDredgerBox());
    EXPECT_FALSE(dredger->UpdateDredger());
    EXPECT_EQ(host.hints, (std::vector<int>{1}));
    EXPECT_FALSE(page->InitialMassEdit()->isEnabled());
    EXPECT_FALSE(page->MaximumMassEdit()->isEnabled());
    EXPECT_EQ(dredger->InitialDredgerMass(), 250.0);
    EXPECT_EQ(dredger->MaximumDredgerMass(), 1e7);

    // Shown in the user's unit, stored in kilograms.
    const QuantityInfo* mass = CUnitUtil::FindQuantity(100076);
    ASSERT_NE(mass, nullptr);
    for (const UnitInfo& u : mass->units) {
        if (std::string(u.name) == "t") {
            ASSERT_TRUE(CUnitUtil::SetUserUnit(100076, u.id));
        }
    }
    ClickBox(page->UpdateDredgerBox());
    host.Clear();
    page->SetData();
    EXPECT_EQ(page->MaximumMassEdit()->text().toDouble(), 10000.0);
    Enter(page->MaximumMassEdit(), "12.5");
    EXPECT_EQ(dredger->MaximumDredgerMass(), 12500.0);
    EXPECT_EQ(host.hints, (std::vector<int>{1}));
}

TEST_F(DredgerPage, TheFractionGridShowsAndStoresTheWeights) {
    Open(3);
    CMTDredgingFractionGrid* grid = page->FractionGrid();
    EXPECT_EQ(grid->GetColCount(), 3);
    EXPECT_EQ(grid->GetRowCount(), 1);
    EXPECT_EQ(Cell(grid, 0, 0), "Fraction");
    EXPECT_EQ(Cell(grid, 0, 3), "3");
    EXPECT_EQ(Cell(grid, 1, 0), "Weight");
    EXPECT_EQ(Cell(grid, 1, 2), "33.33333333333");
    EXPECT_EQ(grid->CellStyle(1, 2).align, ZoCellAlign::Right);

    EnterInCell(grid, 1, 2, "50");
    EXPECT_EQ(dredger->WeightsFraction(), (std::vector<double>{100.0 / 3, 50.0, 100.0 / 3}));
    EXPECT_EQ(host.hints, (std::vector<int>{1}));
    EXPECT_EQ(Cell(grid, 1, 2), "50.00000000000");
}

TEST_F(DredgerPage, OpenedAfterTheFractionsChangedTheWeightsAreEven) {
    Open(2);
    dredger->WeightsFraction({90.0, 10.0});
    ModelDefinition(doc.Module())->NumberOfFractions(4);
    Reopen();
    EXPECT_EQ(dredger->WeightsFraction(), (std::vector<double>(4, 25.0)));
    EXPECT_EQ(page->FractionGrid()->GetColCount(), 4);
    EXPECT_EQ(Cell(page->FractionGrid(), 1, 4), "25.00000000000");
}

TEST_F(DredgerPage, TheProjectionIsChosenFromTheRegistry) {
    Open();
    QComboBox* box = page->ProjectionBox();
    EXPECT_EQ(box->currentText(), "UTM-32");
    // Picked from the list, as the drop-down does.
    box->setCurrentIndex(box->findText("UTM-33"));
    EXPECT_EQ(dredger->CoordinateType(), "UTM-33");
    EXPECT_EQ(host.hints, (std::vector<int>{1}));
    // Typed.
    host.Clear();
    Enter(box->lineEdit(), "LONG/LAT");
    EXPECT_EQ(dredger->CoordinateType(), "LONG/LAT");
    EXPECT_EQ(host.hints, (std::vector<int>{1}));

    host.Clear();
    MessageRecorder messages;
    Enter(box->lineEdit(), "Mercator?");
    EXPECT_EQ(dredger->CoordinateType(), "LONG/LAT");
    EXPECT_TRUE(host.hints.empty());
    ASSERT_EQ(messages.Messages().size(), 1u);
    EXPECT_EQ(messages.Messages()[0], "Dredger 1: \"Mercator?\" is not a known projection.");
    EXPECT_EQ(box->currentText(), "LONG/LAT");
    EXPECT_EQ(box->findText("Mercator?"), -1);
}

TEST_F(DredgerPage, SelectTakesFileItemsAndNamesAndViewShowsThem) {
    TempDir dir;
    const std::string path = dir.Write("track.qrd0", Series(100157));
    Open();
    Enter(page->ProjectionBox()->lineEdit(), "LONG/LAT");
    ASSERT_EQ(dredger->CoordinateType(), "LONG/LAT");
    host.Clear();
    int shown = 0;
    ZoFileSelectorHook previous = ZoSetFileSelectorHook([&](CZoFileSelectorDlg& d) {
        ++shown;
        d.Prepare();
        EXPECT_EQ(d.RequestCount(), 4);
        EXPECT_EQ(d.Request(0).Description(), "x-coordinate");
        EXPECT_EQ(d.Request(1).OvuTypes(), (std::vector<long>{100157}));
        EXPECT_EQ(d.Request(3).OvuTypes(), (std::vector<long>{100013, 100505}));
        EXPECT_EQ(d.GetMinNoItems(), 4);
        EXPECT_FALSE(d.PluginEnabled());
        EXPECT_EQ(d.SelectedItems(), (std::vector<int>{1, 2, 3, 4}));
        if (shown == 2)
            return int(QDialog::Rejected);
        d.ChooseFile(path);
        for (int i = 0; i < 4; ++i)
            EXPECT_TRUE(d.AssignItem(i, i + 1));
        d.accept();
        return d.result();
    });
    QTest::mouseClick(page->SelectButton(), Qt::LeftButton);
    EXPECT_EQ(dredger->DataFile()->FileName(), path);
    EXPECT_EQ(dredger->DataFile()->ItemName(1), "x");
    EXPECT_EQ(dredger->DataFile()->ItemName(4), "spill");
    EXPECT_EQ(page->FileNameEdit()->text().toStdString(), path);
    EXPECT_EQ(page->ItemEdit(2)->text(), "Item:   rate");
    EXPECT_EQ(host.hints, (std::vector<int>{1}));

    // Cancel changes nothing.
    host.Clear();
    QTest::mouseClick(page->SelectButton(), Qt::LeftButton);
    ZoSetFileSelectorHook(previous);
    EXPECT_EQ(shown, 2);
    EXPECT_EQ(dredger->DataFile()->FileName(), path);
    EXPECT_TRUE(host.hints.empty());

    QTest::mouseClick(page->ViewButton(), Qt::LeftButton);
    CZoDataViewerDlg* viewer = page->findChild<CZoDataViewerDlg*>();
    ASSERT_TRUE(viewer);
    EXPECT_EQ(viewer->Path(), path);
    EXPECT_EQ(viewer->Items(), (std::vector<int>{1, 2, 3, 4}));
    viewer->close();
}

TEST_F(DredgingPage, TracksAreDrawnOnTheMapAndAClickSelectsTheirRow) {
    TempDir dir;
    const std::string path = dir.Write(
        "track.qrd0", "qrd0 1\nstart 2024-01-01 00:00\nstep 3600\nsteps 3\nitems 4\n"
                      "item x 100183\nitem y 100183\nitem r 100195\nitem s 100013\nvalues\n"
                      "497500 5960800 0 0\n498500 5960400 0 0\n499500 5959900 0 0\n");
    Dredging(doc)->SetItemCount(3, 1);
    for (int i : {1, 3})
        Dredging(doc)->GetItem(i)->DataFile()->FileName(path);
    Dredging(doc)->GetItem(3)->Include(0);  // left out: not drawn
    Open(3);
    CMTDredgingMapDlg* map = page->MapPage();
    ASSERT_NE(map, nullptr);
    ASSERT_GE(map->TrackOverlay(), 0);
    const CZoMapOverlay& tracks = map->Map()->Overlay(map->TrackOverlay());
    ASSERT_EQ(tracks.features.size(), 1u);
    EXPECT_EQ(tracks.features[0].number, 1);
    EXPECT_EQ(tracks.features[0].points.size(), 3);
    EXPECT_DOUBLE_EQ(tracks.features[0].points[0].x(), 497500);

    emit map->featureSelected(map->TrackOverlay(), 1);
    const auto ranges = page->Grid()->GetSelectedRowRanges();
    ASSERT_EQ(ranges.size(), 1u);
    EXPECT_EQ(ranges[0].top, 1);
    EXPECT_EQ(ranges[0].bottom, 1);

    // On the dredger's own page its track is the one highlighted.
    CRecordingHost other;
    auto own = OpenDialog(Dredging(doc)->GetItem(1), other);
    auto* dredgerPage = dynamic_cast<CMTDredgingItemsDlg*>(own.get());
    ASSERT_NE(dredgerPage, nullptr);
    CMTDredgingMapDlg* ownMap = dredgerPage->MapPage();
    EXPECT_EQ(ownMap->Map()->Overlay(ownMap->TrackOverlay()).selected, 1);
}
