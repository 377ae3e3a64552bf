#include "OutputTestSupport.h"
#include "bed/BedUiTestSupport.h"
#include "outputs/MTOutputCoordGrid.h"
#include "outputs/MTOutputCoordListKiv.h"
#include "outputs/MTOutputDischargeDlg.h"
#include "outputs/MTOutputDlg.h"
#include "outputs/MTOutputGisNavigationDlg.h"
#include "outputs/MTOutputGrid.h"
#include "outputs/MTOutputItemMainDlg.h"
#include "outputs/MTOutputItemPropertySheet.h"
#include "outputs/MTOutputItemSubDischargeKiv.h"
#include "outputs/MTOutputItemSubDlg.h"
#include "outputs/MTOutputItemSubMassbudgetKiv.h"
#include "outputs/MTOutputItemSubKiv.h"
#include "projection/ZoMapProjection.h"
#include "widgets/OutputItemsDlg.h"
#include "widgets/ZoNumberEdit.h"
#include "widgets/ZoSEGridToolbar.h"

#include <QAction>
#include <QComboBox>
#include <QGroupBox>
#include <QLabel>
#include <QListWidget>
#include <QPainter>
#include <QPushButton>
#include <QTabWidget>
#include <QTest>

#include <filesystem>
#include <fstream>

using namespace outputtest;
using namespace uitest;
using bedtest::ClickCell;
using bedtest::RowTexts;

namespace {

std::vector<QString> Entries(QComboBox* box) {
    std::vector<QString> out;
    for (int i = 0; i < box->count(); ++i)
        out.push_back(box->itemText(i));
    return out;
}

std::vector<QString> Rows(QListWidget* list) {
    std::vector<QString> out;
    for (int i = 0; i < list->count(); ++i)
        out.push_back(list->item(i)->text());
    return out;
}

CGridCellValue Number(double v) {
    CGridCellValue value;
    value.kind = ZoCellKind::Number;
    value.number = v;
    return value;
}

struct ScratchDir {
    std::filesystem::path path;
    ScratchDir() {
        path = std::filesystem::temp_directory_path() /
               (std::string("outputs-ui-") + ::testing::UnitTest::GetInstance()->current_test_info()->name());
        std::filesystem::create_directories(path);
    }
    ~ScratchDir() {
        std::error_code ec;
        std::filesystem::remove_all(path, ec);
    }
    QString Write(const std::string& name, const std::string& text) const {
        std::ofstream(path / name) << text;
        return QString::fromStdString((path / name).string());
    }
};

// The "Output specification" page of an output inside its sheet.
CMTOutputItemMainDlg* SpecificationPage(CZoSEDlgBase* sheet) {
    auto* s = dynamic_cast<CMTOutputItemPropertySheet*>(sheet);
    EXPECT_NE(s, nullptr);
    return s ? dynamic_cast<CMTOutputItemMainDlg*>(s->GetPage(1)) : nullptr;
}

}  // namespace

// --- the list of outputs ------------------------------------------------------------------

TEST(MTOutputDlg, NewOutputIsNamedAndDeleteRemovesTheSelectedRows) {
    auto doc = WithOutputs(false, false, 0);
    CRecordingHost host;
    auto dlg = OpenDialog(Outputs(*doc), host);
    auto* grid = Child<CMTOutputGrid>(dlg.get(), "grid");
    ASSERT_NE(grid, nullptr);
    EXPECT_EQ(RowTexts(grid, 0), (std::vector<std::string>{"Output No.", "Name", "Include", "Results", "Edit"}));

    for (int i = 0; i < 3; ++i)
        Child<QPushButton>(dlg.get(), "newOutput")->click();
    EXPECT_EQ(host.hints, (std::vector<int>{2, 16, 2, 16, 2, 16}));
    ASSERT_EQ(grid->GetRowCount(), 3);
    EXPECT_EQ(Output(*doc, 1)->Title(), "Output 1");
    EXPECT_EQ(RowTexts(grid, 3), (std::vector<std::string>{"3", "Output 3", "", "View...", "Go to..."}));
    EXPECT_EQ(grid->CellStyle(1, 2).kind, ZoCellKind::CheckBox);
    EXPECT_TRUE(grid->CellStyle(1, 3).readOnly);  // no result file yet
    EXPECT_FALSE(grid->CellStyle(1, 4).readOnly);

    host.Clear();
    CMTOutputItemMainKiv* third = Output(*doc, 3);
    grid->SelectRows(1, 2);
    Child<QPushButton>(dlg.get(), "deleteOutput")->click();
    EXPECT_EQ(host.hints, (std::vector<int>{4}));
    ASSERT_EQ(Outputs(*doc)->GetItemCount(), 1);
    EXPECT_EQ(Output(*doc, 1), third);
    // Without a selection of whole rows nothing is deleted.
    host.Clear();
    Child<QPushButton>(dlg.get(), "deleteOutput")->click();
    EXPECT_EQ(Outputs(*doc)->GetItemCount(), 1);
    EXPECT_TRUE(host.hints.empty());
}

TEST(MTOutputDlg, CellsStoreTitleAndIncludeAndViewNeedsAResultFile) {
    ScratchDir dir;
    auto doc = WithOutputs(false, false, 2);
    Outputs(*doc)->NameNewOutputs();
    CRecordingHost host;
    auto dlg = OpenDialog(Outputs(*doc), host);
    auto* grid = Child<CMTOutputGrid>(dlg.get(), "grid");
    CGridCellValue name;
    name.kind = ZoCellKind::Text;
    name.text = "Mouth";
    grid->StoreCell(1, 1, name);
    EXPECT_EQ(Output(*doc, 1)->Title(), "Mouth");
    EXPECT_EQ(host.hints, (std::vector<int>{8}));

    host.Clear();
    ClickCell(grid, 2, 2);
    EXPECT_EQ(Output(*doc, 2)->Include(), 0);
    EXPECT_EQ(host.hints, (std::vector<int>{1}));
    EXPECT_TRUE(grid->CellStyle(2, 1).readOnly);
    EXPECT_TRUE(grid->CellStyle(2, 4).readOnly);

    // A valid output whose result file exists can be viewed.
    const QString file = dir.Write("mouth.qrd0", "not read here\n");
    Output(*doc, 1)->FileName(file.toStdString());
    EXPECT_FALSE(grid->CellStyle(1, 3).readOnly);
    Output(*doc, 1)->FirstTimeStep(-1);
    EXPECT_TRUE(grid->CellStyle(1, 3).readOnly);
    Output(*doc, 1)->FirstTimeStep(0);
    std::filesystem::remove(file.toStdString());
    EXPECT_TRUE(grid->CellStyle(1, 3).readOnly);

    host.Clear();
    ClickCell(grid, 1, 4);
    EXPECT_EQ(host.selected, (std::vector<CZoSEKivBase*>{Output(*doc, 1)}));
}

TEST(MTOutputDlg, OutputsAddedByTheKeysAreNamedAfterTheRefresh) {
    auto doc = WithOutputs(false, false, 1);
    Output(*doc, 1)->Title("Kept");
    CRecordingHost host;
    auto dlg = OpenDialog(Outputs(*doc), host);
    auto* grid = Child<CMTOutputGrid>(dlg.get(), "grid");
    grid->SetCurrentCell(1, 1);
    grid->setFocus();
    QTest::keyPress(grid, Qt::Key_Insert, Qt::ControlModifier);
    QTest::keyRelease(grid, Qt::Key_Insert, Qt::ControlModifier);
    ASSERT_EQ(Outputs(*doc)->GetItemCount(), 2);
    EXPECT_EQ(Output(*doc, 1)->Title(), "Output 1");
    EXPECT_EQ(host.hints, (std::vector<int>{2}));
    QTest::qWait(1);
    QCoreApplication::processEvents();
    EXPECT_EQ(host.hints, (std::vector<int>{2, 8}));
}

// --- the sheet ----------------------------------------------------------------------------

TEST(MTOutputItemPropertySheet, PagesFollowTheTypeAndTheOpenPageIsKept) {
    auto doc = WithOutputs(true, true, 2);
    Output(*doc, 2)->Type(4);
    CRecordingHost host;
    CMTOutputItemPropertySheet::ActivePage() = 0;
    auto dlg = OpenDialog(Output(*doc, 1), host);
    auto* sheet = dynamic_cast<CMTOutputItemPropertySheet*>(dlg.get());
    ASSERT_NE(sheet, nullptr);
    ASSERT_EQ(sheet->GetPageCount(), 3);
    EXPECT_EQ(sheet->Tabs()->tabText(0), "Geographic View");
    EXPECT_EQ(sheet->Tabs()->tabText(1), "Output specification");
    EXPECT_EQ(sheet->Tabs()->tabText(2), "Output items");
    EXPECT_NE(dynamic_cast<CMTOutputGisNavigationDlg*>(sheet->GetPage(0)), nullptr);
    auto* items = dynamic_cast<CMTOutputItemSubDlg*>(sheet->GetPage(2));
    ASSERT_NE(items, nullptr);
    EXPECT_EQ(items->GetSection(), Output(*doc, 1)->Parameters3D());
    EXPECT_EQ(items->GetHelpID(), 5031u);

    // Mass budget: the page is made anew for its selection.
    auto* type = Child<QComboBox>(SpecificationPage(sheet), "fieldType");
    Choose(type, "Mass Budget");
    ASSERT_EQ(sheet->GetPageCount(), 3);
    EXPECT_NE(dynamic_cast<COutputItemsDlg*>(sheet->GetPage(2)), nullptr);
    EXPECT_EQ(sheet->GetPage(2)->GetSection(), Output(*doc, 1)->Massbudget());

    sheet->SetActivePage(2);
    dlg.reset();
    auto next = OpenDialog(Output(*doc, 2), host);
    auto* other = dynamic_cast<CMTOutputItemPropertySheet*>(next.get());
    EXPECT_EQ(other->GetActiveIndex(), 2);
    EXPECT_NE(dynamic_cast<CMTOutputDischargeDlg*>(other->GetPage(2)), nullptr);
    CMTOutputItemPropertySheet::ActivePage() = 0;
}

// --- "Output specification" -----------------------------------------------------------------

TEST(MTOutputItemMainDlg, EntriesAndEnablingFollowTypeAndFormat) {
    auto doc = WithOutputs(true, true, 1);
    CMTOutputItemMainKiv* o = Output(*doc, 1);
    o->Type(1);
    o->Format(2);
    CRecordingHost host;
    auto sheet = OpenDialog(o, host, QSize(800, 700));
    CMTOutputItemMainDlg* page = SpecificationPage(sheet.get());
    ASSERT_NE(page, nullptr);
    auto* type = Child<QComboBox>(page, "fieldType");
    auto* format = Child<QComboBox>(page, "outputFormat");
    auto* layerMin = Child<CZoNumberEdit>(page, "layerMin");
    auto* flood = Child<QComboBox>(page, "floodAndDry");
    auto* grid = Child<CMTOutputCoordGrid>(page, "coordinates");
    auto* toolbar = Child<CZoSEGridToolbar>(page, "coordinatesToolbar");
    EXPECT_EQ(Entries(type), (std::vector<QString>{"2D (horizontal)", "3D", "Mass Budget", "Discharge"}));
    EXPECT_EQ(Entries(format), (std::vector<QString>{"Point series", "Line series", "Area series"}));
    EXPECT_EQ(format->currentText(), "Area series");
    EXPECT_EQ(Child<QGroupBox>(page, "geometry")->title(), "Area series");
    EXPECT_FALSE(layerMin->isVisibleTo(page));
    EXPECT_FALSE(Child<QComboBox>(page, "interpolationType")->isVisibleTo(page));
    EXPECT_EQ(grid->GetRowCount(), 4);  // the corners
    // An area takes discrete values: the third column, unused here, is headed by the layer.
    EXPECT_EQ(RowTexts(grid, 0), (std::vector<std::string>{"", "Easting", "Northing", "Layer no.", "Name"}));

    // To 3D: an area becomes a volume with its layer range.
    host.Clear();
    Choose(type, "3D");
    EXPECT_EQ(o->Type(), 2);
    EXPECT_EQ(o->Format(), 3);
    EXPECT_EQ(format->currentText(), "Volume series");
    EXPECT_TRUE(layerMin->isVisibleTo(page));
    EXPECT_TRUE(layerMin->isEnabled());
    EXPECT_EQ(host.hints, (std::vector<int>{1}));

    // Mass budget: domain series, no format choice, no flood and dry, the layer range shown
    // but not to be edited, the polygon in the grid.
    Choose(type, "Mass Budget");
    EXPECT_EQ(o->Format(), 0);
    EXPECT_EQ(format->currentText(), "Domain series");
    EXPECT_FALSE(format->isEnabled());
    EXPECT_FALSE(flood->isVisibleTo(page));
    EXPECT_FALSE(Child<QLabel>(page, "floodAndDryLabel")->isVisibleTo(page));
    EXPECT_TRUE(layerMin->isVisibleTo(page));
    EXPECT_FALSE(layerMin->isEnabled());
    EXPECT_EQ(grid->GetRowCount(), 4);
    EXPECT_TRUE(toolbar->isVisibleTo(page));

    // Discharge: the line, First and Last, without row operations.
    Choose(type, "Discharge");
    EXPECT_EQ(format->currentText(), "Cross section series");
    ASSERT_EQ(grid->GetRowCount(), 2);
    EXPECT_EQ(RowTexts(grid, 1), (std::vector<std::string>{"First", "1000.00000000000", "5000.00000000000", "", ""}));
    EXPECT_FALSE(toolbar->isVisibleTo(page));

    // In two dimensions there is no 3D entry.
    doc->GetDomain()->ThreeD(false);
    page->SetData();
    EXPECT_EQ(Entries(type), (std::vector<QString>{"2D (horizontal)", "Mass Budget", "Discharge"}));
}

TEST(MTOutputItemMainDlg, PointSeriesInterpolationAndCoordinateCells) {
    auto doc = WithOutputs(true, true, 1);
    CMTOutputItemMainKiv* o = Output(*doc, 1);
    CRecordingHost host;
    auto sheet = OpenDialog(o, host, QSize(800, 700));
    CMTOutputItemMainDlg* page = SpecificationPage(sheet.get());
    auto* grid = Child<CMTOutputCoordGrid>(page, "coordinates");
    auto* interpolation = Child<QComboBox>(page, "interpolationType");
    EXPECT_TRUE(interpolation->isVisibleTo(page));
    EXPECT_EQ(RowTexts(grid, 1), (std::vector<std::string>{"1", "2000.00000000000", "7000.00000000000",
                                                           "-10.00000000000", "Point 1"}));
    Choose(interpolation, "Discrete values");
    EXPECT_EQ(o->InterpolationType(), 1);
    EXPECT_EQ(grid->CellStyle(0, 3).DisplayText(), "Layer no.");
    host.Clear();
    grid->StoreCell(1, 3, Number(4));
    EXPECT_EQ(o->Points()[0].layer, 4);
    grid->StoreCell(1, 1, Number(2500));
    EXPECT_EQ(o->Points()[0].x, 2500.0);
    CGridCellValue name;
    name.kind = ZoCellKind::Text;
    name.text = "Gauge";
    grid->StoreCell(1, 4, name);
    EXPECT_EQ(o->Points()[0].name, "Gauge");
    // Every stored cell reaches the document.
    EXPECT_EQ(host.hints, (std::vector<int>{1, 1, 1}));

    // Flood and dry is stored with a hint as well.
    host.Clear();
    Choose(Child<QComboBox>(page, "floodAndDry"), "Whole area");
    EXPECT_EQ(o->FloodAndDry(), 0);
    EXPECT_EQ(host.hints, (std::vector<int>{1, 1}));  // one step of the arrow keys each

    // A geographical projection names the columns by longitude and latitude.
    Choose(Child<QComboBox>(page, "projection"), "LONG/LAT");
    EXPECT_EQ(o->CoordinateType(), "LONG/LAT");
    EXPECT_EQ(grid->CellStyle(0, 1).DisplayText(), "Longitude");
    EXPECT_EQ(grid->CellStyle(0, 2).DisplayText(), "Latitude");

    // Line series: interpolated values, hidden choice, points on the line shown.
    Choose(Child<QComboBox>(page, "outputFormat"), "Line series");
    EXPECT_EQ(o->InterpolationType(), 2);
    EXPECT_FALSE(interpolation->isVisibleTo(page));
    EXPECT_TRUE(Child<CZoNumberEdit>(page, "pointsOnLine")->isVisibleTo(page));
    host.Clear();
    Enter(Child<CZoNumberEdit>(page, "pointsOnLine"), "12");
    EXPECT_EQ(o->NumberOfPointsOnLine(), 12);
    EXPECT_EQ(host.hints, (std::vector<int>{1}));
    Enter(Child<CZoNumberEdit>(page, "lastTimeStep"), "50");
    EXPECT_EQ(o->LastTimeStep(), 50);
}

TEST(MTOutputItemMainDlg, PolygonRowsAndAnEmptyPolygon) {
    auto doc = WithOutputs(true, false, 2);
    CMTOutputItemMainKiv* o = Output(*doc, 1);
    o->Format(2);
    CRecordingHost host;
    auto sheet = OpenDialog(o, host, QSize(800, 700));
    auto* grid = Child<CMTOutputCoordGrid>(SpecificationPage(sheet.get()), "coordinates");
    ASSERT_EQ(grid->GetRowCount(), 4);
    grid->SelectRows(1, 3);
    grid->DeleteItems();
    // One row left; the polygon keeps three corners, the last two as they were.
    ASSERT_EQ(o->Polygon().size(), 3u);
    EXPECT_EQ(o->Polygon()[0].x, 3020.0);
    EXPECT_EQ(o->Polygon()[1].y, 9040.0);
    EXPECT_EQ(o->Polygon()[2].x, 3020.0);
    EXPECT_EQ(grid->GetRowCount(), 3);

    // A polygon with no corners is not made up of (0, 0) corners by the page.
    CMTOutputItemMainKiv* empty = Output(*doc, 2);
    empty->Type(3);
    empty->Polygon().clear();
    auto other = OpenDialog(empty, host, QSize(800, 700));
    EXPECT_EQ(Child<CMTOutputCoordGrid>(SpecificationPage(other.get()), "coordinates")->GetRowCount(), 0);
    other->SetData();
    EXPECT_TRUE(empty->Polygon().empty());
}

TEST(MTOutputItemMainDlg, ImportFromFile) {
    ScratchDir dir;
    const QString three = dir.Write("three.xyz", "1.0 2.0 3.0 a\n4.0 5.0 6.0 b\n7.0 8.0 9.0 c\n");
    const QString bad = dir.Write("bad.xyz", "1.0 2.0\n");
    auto doc = WithOutputs(true, true, 2);
    CMTOutputItemMainKiv* line = Output(*doc, 1);
    line->Format(1);
    CMTOutputItemMainKiv* points = Output(*doc, 2);
    CRecordingHost host;
    {
        auto sheet = OpenDialog(line, host, QSize(800, 700));
        FileChooserStub chooser(three);
        Child<QPushButton>(SpecificationPage(sheet.get()), "importFromFile")->click();
        EXPECT_EQ(chooser.Calls(), 1);
        EXPECT_EQ(line->Line().xFirst, 1.0);
        EXPECT_EQ(line->Line().zLast, 6.0);
        EXPECT_EQ(host.hints, (std::vector<int>{1}));
    }
    auto sheet = OpenDialog(points, host, QSize(800, 700));
    CMTOutputItemMainDlg* page = SpecificationPage(sheet.get());
    {
        FileChooserStub chooser(three);
        Child<QPushButton>(page, "importFromFile")->click();
        // The file chosen last is where the next choice starts.
        EXPECT_EQ(chooser.LastStartPath(), three);
    }
    ASSERT_EQ(points->Points().size(), 4u);  // appended to the one there was
    EXPECT_EQ(points->Points()[0].name, "Point 1");
    EXPECT_EQ(points->Points()[3].layer, 9);
    EXPECT_EQ(Child<CMTOutputCoordGrid>(page, "coordinates")->GetRowCount(), 4);

    host.Clear();
    MessageRecorder messages;
    FileChooserStub chooser(bad);
    Child<QPushButton>(page, "importFromFile")->click();
    ASSERT_EQ(messages.Messages().size(), 1u);
    EXPECT_TRUE(messages.Messages()[0].contains(
        "Illegal import file:\nFormat is \"x y z name\", where name is optional."));
    EXPECT_TRUE(messages.Messages()[0].contains("bad.xyz"));
    EXPECT_EQ(points->Points().size(), 4u);
    EXPECT_TRUE(host.hints.empty());
}

TEST(MTOutputItemMainDlg, OutputFileTypedOrChosen) {
    auto doc = WithOutputs(false, false, 1);
    CMTOutputItemMainKiv* o = Output(*doc, 1);
    CRecordingHost host;
    auto sheet = OpenDialog(o, host, QSize(800, 700));
    CMTOutputItemMainDlg* page = SpecificationPage(sheet.get());
    Enter(Child<QLineEdit>(page, "outputFile"), "results/a.qrd0");
    EXPECT_EQ(o->FileName(), "results/a.qrd0");
    EXPECT_EQ(host.hints, (std::vector<int>{1}));
    host.Clear();
    FileChooserStub chooser("/data/b.qrd0");
    Child<QPushButton>(page, "browseOutputFile")->click();
    EXPECT_EQ(o->FileName(), "/data/b.qrd0");
    EXPECT_EQ(Child<QLineEdit>(page, "outputFile")->text(), "/data/b.qrd0");
    EXPECT_EQ(host.hints, (std::vector<int>{1}));

    // A name chosen without an ending takes the format's, so that it validates.
    const struct {
        int format;
        const char* chosen;
        const char* stored;
    } cases[] = {
        {0, "/data/c", "/data/c.qrd0"},
        {1, "/data/c", "/data/c.qrd1"},
        {2, "/data/c", "/data/c.qrdu"},
        {0, "/data/c.txt", "/data/c.txt"},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.chosen);
        o->Format(c.format);
        page->SetData();
        FileChooserStub bare(c.chosen);
        Child<QPushButton>(page, "browseOutputFile")->click();
        EXPECT_EQ(o->FileName(), c.stored);
    }
}

// --- quantities ---------------------------------------------------------------------------

TEST(MTOutputItemSubDlg, OffersTheQuantitiesOfTheTypeAndStoresChecks) {
    auto doc = WithOutputs(true, true, 1, 1, 1);
    CMTOutputItemMainKiv* o = Output(*doc, 1);
    o->Type(1);
    CRecordingHost host;
    auto dlg = OpenDialog(o->Parameters2D(), host);
    auto* basic = Child<QListWidget>(dlg.get(), "basicVariables");
    auto* additional = Child<QListWidget>(dlg.get(), "additionalVariables");
    EXPECT_EQ(Rows(basic), (std::vector<QString>{"Bed thickness - layer 1", "Bed mass - layer 1, fraction 1"}));
    EXPECT_EQ(additional->count(), 12);
    EXPECT_EQ(additional->item(0)->text(), "Bed shearstress");
    EXPECT_EQ(additional->item(0)->checkState(), Qt::Unchecked);
    additional->item(0)->setCheckState(Qt::Checked);
    EXPECT_EQ(o->Parameters2D()->Item(CMTOutputItemSubKiv::List::Additional, 1).value, 1);
    EXPECT_EQ(host.hints, (std::vector<int>{1}));
    // In two dimensions all quantities are listed.
    doc->GetDomain()->ThreeD(false);
    dlg->SetData();
    EXPECT_EQ(basic->count(), 3);
    EXPECT_EQ(basic->item(0)->text(), "SSC - fraction 1");
}

TEST(MTOutputDischargeDlg, ListsTheFractionsAndStoresTheKind) {
    auto doc = WithOutputs(false, false, 1, 2, 1);
    CMTOutputItemSubDischargeKiv* discharge = Output(*doc, 1)->Discharge();
    CRecordingHost host;
    auto dlg = OpenDialog(discharge, host);
    auto* list = Child<QListWidget>(dlg.get(), "variables");
    EXPECT_EQ(Rows(list), (std::vector<QString>{"SSC - fraction 1", "SSC - fraction 2"}));
    list->item(1)->setCheckState(Qt::Unchecked);
    EXPECT_FALSE(discharge->IsBasicItemSelected(5));
    EXPECT_TRUE(discharge->IsBasicItemSelected(0));
    EXPECT_EQ(host.hints, (std::vector<int>{1}));
    auto* kind = Child<QComboBox>(dlg.get(), "dischargeType");
    EXPECT_EQ(Entries(kind), (std::vector<QString>{"Basic", "Extended"}));
    Choose(kind, "Extended");
    EXPECT_EQ(discharge->Type(), 2);

    auto budget = OpenDialog(Output(*doc, 1)->Massbudget(), host);
    auto* items = Child<QListWidget>(budget.get(), "items");
    EXPECT_EQ(Rows(items), (std::vector<QString>{"SSC - fraction 1", "SSC - fraction 2"}));
    items->item(0)->setCheckState(Qt::Unchecked);
    EXPECT_FALSE(Output(*doc, 1)->Massbudget()->IsBasicItemSelected(0));
}

// --- the map ------------------------------------------------------------------------------

TEST(MTOutputGisNavigationDlg, ShowsTheGeometryWhereItsCoordinatesSay) {
    auto opened = CSetupDocument::Open(MUD_SOURCE_DIR "/examples/estuary.setup");
    ASSERT_TRUE(opened.document);
    CSetupDocument& doc = *opened.document;
    CMTOutputKiv* outputs = Outputs(doc);
    const int base = outputs->GetItemCount();
    CMTOutputItemMainKiv* points = outputs->Append();
    points->Points() = {{513200.0, 5950300.0, 0, 1, "Outfall"}};
    CMTOutputItemMainKiv* budget = outputs->Append();
    budget->Type(3);
    budget->Polygon() = {{540000, 5935000}, {545000, 5935000}, {545000, 5940000}};
    CMTOutputItemMainKiv* section = outputs->Append();
    section->Type(4);
    section->CoordinateType("LONG/LAT");
    section->Line() = {3, 8.9, 53.86, 0, 9.1, 53.86, 0};
    CRecordingHost host;
    host.setupDir = MUD_SOURCE_DIR "/examples";
    CMTOutputGisNavigationDlg::ResetSharedView();

    auto page = [&](CMTOutputItemMainKiv* o) {
        auto p = std::make_unique<CMTOutputGisNavigationDlg>();
        p->Attach(o, &host);
        p->resize(700, 500);
        p->Initialize();
        p->show();
        EXPECT_TRUE(QTest::qWaitForWindowExposed(p.get()));
        return p;
    };
    auto draw = [](CZoMapView* map) {
        QImage image(map->size(), QImage::Format_ARGB32_Premultiplied);
        QPainter painter(&image);
        map->Render(painter);
        return image;
    };
    {
        auto p = page(points);
        EXPECT_EQ(p->GetHelpID(), 5030u);
        const CZoMapOverlay& layer = p->Map()->Overlay(p->OutputOverlay());
        ASSERT_EQ(layer.features.size(), 1u);
        EXPECT_EQ(layer.features[0].kind, CZoMapFeature::kPoint);
        EXPECT_EQ(layer.features[0].name, "Outfall");
        const QImage image = draw(p->Map());
        EXPECT_EQ(image.pixelColor(p->Map()->ToPixel(513200.0, 5950300.0).toPoint()), layer.colour);
        p->Map()->SetViewRect(QRectF(530000, 5930000, 20000, 12000));
    }
    {
        // The view is shared by every output's map page.
        auto p = page(budget);
        EXPECT_NEAR(p->Map()->ViewRect().center().x(), 540000, 1e-6);
        const CZoMapOverlay& layer = p->Map()->Overlay(p->OutputOverlay());
        ASSERT_EQ(layer.features.size(), 1u);
        EXPECT_EQ(layer.features[0].kind, CZoMapFeature::kPolygon);
        EXPECT_EQ(layer.features[0].points.size(), 3);
        const QColor inside = draw(p->Map()).pixelColor(p->Map()->ToPixel(544000, 5936000).toPoint());
        EXPECT_GT(inside.red(), inside.green());
    }
    {
        auto p = page(section);
        const CZoMapOverlay& layer = p->Map()->Overlay(p->OutputOverlay());
        ASSERT_EQ(layer.features.size(), 1u);
        EXPECT_EQ(layer.features[0].kind, CZoMapFeature::kPolyline);
        EXPECT_EQ(layer.features[0].name, "Output");
        // Given in longitude and latitude, drawn in the mesh's projection.
        double x = 9.0, y = 53.86;
        ASSERT_TRUE(CZoMapProjection("LONG/LAT", "UTM-32").Transform(x, y));
        p->Map()->SetViewRect(QRectF(x - 8000, y - 5000, 16000, 10000));
        EXPECT_EQ(draw(p->Map()).pixelColor(p->Map()->ToPixel(x, y).toPoint()), layer.colour);
    }
    EXPECT_EQ(outputs->GetItemCount(), base + 3);
    CMTOutputGisNavigationDlg::ResetSharedView();
}
