// The file selector and the data viewer as a user drives them, on the example's data files.
#include "datafile/DataFileCache.h"
#include "fem/FemInDataKiv.h"
#include "fem/SimulationPeriodKiv.h"
#include "host/SetupDocument.h"
#include "setupeditor/ZoSEQrdSelection.h"
#include "support/UiTestSupport.h"
#include "widgets/FemBase.h"
#include "widgets/FemInDataDlg.h"
#include "widgets/ZoDataViewerDlg.h"
#include "widgets/ZoFileSelectorDlg.h"

#include <QAbstractItemModel>
#include <QComboBox>
#include <QLabel>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QSpinBox>
#include <QTableView>
#include <QTableWidget>
#include <QTest>
#include <QTreeWidget>

#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>

using namespace uitest;
namespace fs = std::filesystem;

namespace {

const std::string kData = std::string(MUD_SOURCE_DIR) + "/examples/data";

// A dredger's file: x, y, rate of dredged mass and spill.
class DredgerFile : public ZoSEQrdSelection {
public:
    explicit DredgerFile(CZoSEKivBase* parent) : ZoSEQrdSelection("MT Dredging file", "", parent, 1) {
        SetNoItems(4);
    }
    void SetUpFileSelector(CZoFileSelector& s) override {
        s.EnablePlugin(0);
        s.SetMinNoItems(4);
        s.AddRequest("x-coordinate").SetOvuType(100183);
        s.AddRequest("y-coordinate").SetOvuType(100183);
        s.AddRequest("rate of dredged mass").SetMultiOvuType({100195, 100504});
        s.AddRequest("spill").SetMultiOvuType({100013, 100505});
    }
};

const char* const kFilter = "timeseries (*.qrd0) |*.qrd0|All files (*.*) |*.*||";

// Runs ZoSelectDataFile with the dialog driven by steps instead of a user.
bool Select(ZoSEQrdSelection* node, const std::function<void(CZoFileSelectorDlg&)>& steps) {
    const ZoFileSelectorHook previous = ZoSetFileSelectorHook([&](CZoFileSelectorDlg& d) {
        d.Prepare();
        d.show();
        steps(d);
        return d.result();
    });
    const bool ok = ZoSelectDataFile(node, kFilter, "qrd0", nullptr);
    ZoSetFileSelectorHook(previous);
    return ok;
}

QStringList ComboTexts(QComboBox* box) {
    QStringList texts;
    for (int i = 0; i < box->count(); ++i)
        texts << box->itemText(i);
    return texts;
}

class Selector : public ::testing::Test {
protected:
    void SetUp() override { datafile::ClearHeaderCache(); }
    CSetupDocument doc;
};

}  // namespace

TEST_F(Selector, ShowsTheFileItemsAndTheRequestsOfferingOnlyFittingItems) {
    DredgerFile node(&doc);
    node.FileName(kData + "/dredger_1.qrd0");
    Select(&node, [](CZoFileSelectorDlg& d) {
        QTreeWidget* items = d.ItemList();
        ASSERT_EQ(items->topLevelItemCount(), 4);
        EXPECT_EQ(items->topLevelItem(2)->text(1), "rate of dredged mass");
        EXPECT_EQ(items->topLevelItem(2)->text(2), "Mass rate (100195)");
        EXPECT_EQ(items->topLevelItem(2)->text(3), "t/h");
        EXPECT_TRUE(d.SummaryLabel()->text().contains("145 time steps of 1 h from 2021-06-01 00:00:00"));

        QTableWidget* requests = d.RequestTable();
        ASSERT_EQ(requests->rowCount(), 4);
        EXPECT_EQ(requests->item(0, 0)->text(), "x-coordinate");
        EXPECT_EQ(requests->item(2, 1)->text(), "Mass rate or Mass flux");
        EXPECT_EQ(requests->item(3, 1)->text(), "Fraction or Spill rate");
        auto* x = Child<QComboBox>(requests, "request1");
        EXPECT_EQ(ComboTexts(x), (QStringList{"(none)", "1: x [m]", "2: y [m]"}));
        EXPECT_EQ(x->currentText(), "1: x [m]");
        auto* spill = Child<QComboBox>(requests, "request4");
        EXPECT_EQ(ComboTexts(spill), (QStringList{"(none)", "4: spill [%]"}));
        EXPECT_TRUE(d.OkButton()->isEnabled());
        EXPECT_EQ(d.StatusLabel()->text(), "The file holds what is requested.");
        d.reject();
    });
}

TEST_F(Selector, AnItemOfAnotherQuantityCannotBeAssigned) {
    DredgerFile node(&doc);
    node.FileName(kData + "/dredger_1.qrd0");
    Select(&node, [](CZoFileSelectorDlg& d) {
        EXPECT_FALSE(d.AssignItem(2, 4));
        EXPECT_EQ(d.ChosenItems(), (std::vector<int>{1, 2, 3, 4}));
        EXPECT_TRUE(d.StatusLabel()->text().contains(
            "item 4 \"spill\" is a Fraction; \"rate of dredged mass\" needs Mass rate or Mass flux"))
            << d.StatusLabel()->text().toStdString();

        // The same through the list: pick the item, pick the request, Assign.
        d.ItemList()->setCurrentItem(d.ItemList()->topLevelItem(0));
        d.RequestTable()->selectRow(3);
        QTest::mouseClick(Child<QPushButton>(&d, "assign"), Qt::LeftButton);
        EXPECT_EQ(d.ChosenItems()[3], 4);

        // Unassigning leaves the request open and OK off until it is filled again.
        EXPECT_TRUE(d.AssignItem(1, 0));
        EXPECT_FALSE(d.OkButton()->isEnabled());
        EXPECT_EQ(d.StatusLabel()->text(), "no item is assigned to \"y-coordinate\"");
        EXPECT_TRUE(d.AssignItem(1, 1));
        EXPECT_TRUE(d.OkButton()->isEnabled());
        d.reject();
    });
}

TEST_F(Selector, OkStoresTheNameAndNumbersAndCancelChangesNothing) {
    DredgerFile node(&doc);
    node.FileName("old.qrd0");
    const bool cancelled = Select(&node, [](CZoFileSelectorDlg& d) {
        d.ChooseFile(kData + "/dredger_1.qrd0");
        d.AssignItem(0, 2);
        d.AssignItem(1, 1);
        QTest::mouseClick(Child<QPushButton>(&d, "cancel"), Qt::LeftButton);
    });
    EXPECT_FALSE(cancelled);
    EXPECT_EQ(node.FileName(), "old.qrd0");
    EXPECT_EQ(node.ItemNumber(), (std::vector<int>{1, 2, 3, 4}));

    const bool ok = Select(&node, [](CZoFileSelectorDlg& d) {
        // The old file does not exist: OK is off and does nothing.
        EXPECT_FALSE(d.OkButton()->isEnabled());
        d.accept();
        EXPECT_EQ(d.result(), QDialog::Rejected);
        Enter(d.FileNameEdit(), QString::fromStdString(kData + "/dredger_1"));  // extension added
        d.AssignItem(0, 2);
        d.AssignItem(1, 1);
        QTest::mouseClick(d.OkButton(), Qt::LeftButton);
    });
    EXPECT_TRUE(ok);
    EXPECT_EQ(node.FileName(), kData + "/dredger_1.qrd0");
    EXPECT_EQ(node.ItemNumber(), (std::vector<int>{2, 1, 3, 4}));
}

TEST_F(Selector, BrowsingStoresANameRelativeToTheSetupFolder) {
    const fs::path dir = fs::temp_directory_path() / "mudsetup-selector-ui";
    fs::remove_all(dir);
    fs::create_directories(dir / "data");
    fs::copy_file(kData + "/dredger_1.qrd0", dir / "data" / "dredger_1.qrd0");
    std::string error;
    ASSERT_TRUE(doc.SaveAs((dir / "estuary.setup").string(), &error)) << error;
    DredgerFile node(&doc);
    FileChooserStub chooser(QString::fromStdString((dir / "data" / "dredger_1.qrd0").string()));
    const bool ok = Select(&node, [](CZoFileSelectorDlg& d) {
        QTest::mouseClick(Child<QPushButton>(&d, "browse"), Qt::LeftButton);
        QTest::mouseClick(d.OkButton(), Qt::LeftButton);
    });
    EXPECT_EQ(chooser.Calls(), 1);
    EXPECT_TRUE(ok);
    EXPECT_EQ(node.FileName(), "data/dredger_1.qrd0");
    EXPECT_EQ(node.ValidateData(), 1);
    fs::remove_all(dir);
}

TEST_F(Selector, WithoutRequestsTheUserTicksItems) {
    ZoSEQrdSelection node("Any file", "", &doc, 1);
    node.FileName(kData + "/waves_mouth.qrd0");
    node.ItemNumber(std::vector<int>{2});
    const bool ok = Select(&node, [](CZoFileSelectorDlg& d) {
        EXPECT_TRUE(d.RequestTable()->isHidden());
        QTreeWidget* items = d.ItemList();
        EXPECT_EQ(items->topLevelItem(1)->checkState(0), Qt::Checked);
        items->topLevelItem(2)->setCheckState(0, Qt::Checked);
        items->topLevelItem(1)->setCheckState(0, Qt::Unchecked);
        EXPECT_EQ(d.ChosenItems(), std::vector<int>{3});
        QTest::mouseClick(d.OkButton(), Qt::LeftButton);
    });
    EXPECT_TRUE(ok);
    EXPECT_EQ(node.ItemNumber(), std::vector<int>{3});
}

TEST(DataViewer, ShowsTheHeaderTheValuesAndAPlot) {
    CZoDataViewerDlg* viewer = CFemBase::OpenDataFile(kData + "/dredger_1.qrd0", {3, 4, 99});
    ASSERT_TRUE(viewer);
    EXPECT_TRUE(viewer->isVisible());
    EXPECT_EQ(viewer->Items(), (std::vector<int>{3, 4}));
    const QString header = viewer->HeaderText()->toPlainText();
    EXPECT_TRUE(header.contains("Kind: time series (qrd0)"));
    EXPECT_TRUE(header.contains("Title: Dredger 1: position, dredged mass and spill"));
    EXPECT_TRUE(header.contains("rate of dredged mass  Mass rate (100195)  [t/h]"));
    EXPECT_TRUE(viewer->PointBox()->isHidden());

    QAbstractItemModel* table = viewer->Table()->model();
    EXPECT_EQ(table->rowCount(), 145);
    EXPECT_EQ(table->columnCount(), 3);
    EXPECT_EQ(table->headerData(1, Qt::Horizontal).toString(), "rate of dredged mass [t/h]");
    EXPECT_EQ(table->index(0, 0).data().toString(), "2021-06-01 00:00:00");
    EXPECT_EQ(table->index(0, 1).data().toString(), "1250");
    EXPECT_EQ(table->index(6, 1).data().toString(), "0");
    EXPECT_EQ(table->index(144, 0).data().toString(), "2021-06-07 00:00:00");
    EXPECT_EQ(viewer->Plot()->SeriesCount(), 2);
    EXPECT_EQ(viewer->StatusLabel()->text(), "");
    EXPECT_FALSE(viewer->Plot()->grab().isNull());
    viewer->close();
}

TEST(DataViewer, SpatialFilesShowOnePointAtATimeAndBadFilesSayWhy) {
    const fs::path dir = fs::temp_directory_path() / "mudsetup-viewer-ui";
    fs::create_directories(dir);
    std::ofstream(dir / "g.qrd2") << "qrd2 1\nstart 2024-01-01 00:00\nstep 60\nsteps 2\ngrid 2 1\n"
                                     "items 1\nitem h 100084\nvalues\n1 2\n3 4\n";
    std::ofstream(dir / "bad.qrd0") << "qrd0 1\nstart 2024-01-01 00:00\n";
    CZoDataViewerDlg grid((dir / "g.qrd2").string(), {});
    EXPECT_FALSE(grid.PointBox()->isHidden());
    EXPECT_EQ(grid.PointBox()->maximum(), 2);
    EXPECT_EQ(grid.Table()->model()->index(1, 1).data().toString(), "3");
    grid.ShowPoint(2);
    EXPECT_EQ(grid.Table()->model()->index(1, 1).data().toString(), "4");

    CZoDataViewerDlg bad((dir / "bad.qrd0").string(), {1});
    EXPECT_TRUE(bad.StatusLabel()->text().endsWith("bad.qrd0:3:1: the header ends without a \"values\" line (the file is cut short)"))
        << bad.StatusLabel()->text().toStdString();
    EXPECT_EQ(bad.Table()->model()->rowCount(), 0);
    fs::remove_all(dir);
}

TEST(DataInputValue, SelectsItsFileAndItemWithTheSelectorAndViewsIt) {
    const fs::path dir = fs::temp_directory_path() / "mudsetup-indata-ui";
    fs::remove_all(dir);
    fs::create_directories(dir / "data");
    fs::copy_file(kData + "/waves_mouth.qrd0", dir / "data" / "waves_mouth.qrd0");
    CSetupDocument doc;
    std::string error;
    ASSERT_TRUE(doc.SaveAs((dir / "estuary.setup").string(), &error)) << error;
    doc.GetPeriod()->StartTime("2021-06-02 00:00:00");
    doc.GetPeriod()->TimeStepCount(10);
    auto* value = new CFemInDataKiv("WAVE_HEIGHT", "Wave height", 3, false, false, 1.0, 100084, &doc);
    doc.AddChild(value);
    value->Format(1);
    CRecordingHost host;
    CZoSEDlgBase owner;
    owner.Attach(value, &host);
    CFemInDataDlg form(value, &owner, &owner);
    owner.show();
    EXPECT_TRUE(form.SelectButton()->isEnabled());
    EXPECT_FALSE(form.ViewButton()->isEnabled());

    FileChooserStub chooser(QString::fromStdString((dir / "data" / "waves_mouth.qrd0").string()));
    const ZoFileSelectorHook previous = ZoSetFileSelectorHook([](CZoFileSelectorDlg& d) {
        d.Prepare();
        EXPECT_EQ(d.RequestCount(), 1);
        EXPECT_EQ(d.Request(0).Description(), "Wave height");
        EXPECT_TRUE(d.HasTimeValidation());
        QTest::mouseClick(Child<QPushButton>(&d, "browse"), Qt::LeftButton);
        EXPECT_FALSE(d.AssignItem(0, 2));  // the wave period
        EXPECT_TRUE(d.AssignItem(0, 1));
        QTest::mouseClick(d.OkButton(), Qt::LeftButton);
        return d.result();
    });
    QTest::mouseClick(form.SelectButton(), Qt::LeftButton);
    ZoSetFileSelectorHook(previous);
    EXPECT_EQ(value->QrdData()->FileName(), "data/waves_mouth.qrd0");
    EXPECT_EQ(value->QrdData()->ItemNumbers(), std::vector<int>{1});
    EXPECT_EQ(value->QrdData()->ItemName(), "height");
    EXPECT_EQ(host.hints, std::vector<int>{1});
    EXPECT_EQ(form.FileNameEdit()->text(), "data/waves_mouth.qrd0");
    EXPECT_EQ(value->ValidateData(), 1);

    ASSERT_TRUE(form.ViewButton()->isEnabled());
    QTest::mouseClick(form.ViewButton(), Qt::LeftButton);
    CZoDataViewerDlg* viewer = owner.findChild<CZoDataViewerDlg*>();
    ASSERT_TRUE(viewer);
    EXPECT_EQ(viewer->Items(), std::vector<int>{1});
    viewer->close();

    // The period past the file's end makes the value invalid, with the reason.
    doc.GetPeriod()->TimeStepCount(1000000);
    doc.ClearErrors();
    EXPECT_EQ(value->ValidateData(), 0);
    ASSERT_EQ(doc.Errors().size(), 1u);
    EXPECT_NE(doc.Errors()[0].message.find("does not cover the simulation period"), std::string::npos)
        << doc.Errors()[0].message;
    fs::remove_all(dir);
}
