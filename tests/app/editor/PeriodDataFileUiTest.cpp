// The simulation-period page holds a data file against the period while it is edited.
#include "HostDataPages.h"
#include "fem/SimulationPeriodKiv.h"
#include "host/SetupDocument.h"
#include "support/UiTestSupport.h"
#include "widgets/ZoDataViewerDlg.h"
#include "widgets/ZoFileSelectorDlg.h"

#include <QApplication>
#include <QLabel>
#include <QPushButton>
#include <QSpinBox>
#include <QTest>

#include <gtest/gtest.h>

#include <filesystem>

using namespace uitest;
namespace fs = std::filesystem;

namespace {

class PeriodPage : public ::testing::Test {
protected:
    void SetUp() override {
        dir = fs::temp_directory_path() / "mudsetup-period-page";
        fs::remove_all(dir);
        fs::create_directories(dir / "data");
        fs::copy_file(std::string(MUD_SOURCE_DIR) + "/examples/data/waves_mouth.qrd0",
                      dir / "data" / "waves_mouth.qrd0");
        std::string error;
        ASSERT_TRUE(doc.SaveAs((dir / "estuary.setup").string(), &error)) << error;
        CSimulationPeriodKiv* period = doc.GetPeriod();
        period->StartTime("2021-06-01 00:00:00");
        period->TimeStepInterval(30);
        period->TimeStepCount(17280);  // six days
        page.reset(CreateHostDataPage(period, doc));
        ASSERT_TRUE(page);
        page->Attach(period, &host);
        page->Initialize();
        page->show();
    }
    void TearDown() override {
        page.reset();
        fs::remove_all(dir);
    }
    QLabel* Check() const { return Child<QLabel>(page.get(), "dataFileCheck"); }

    fs::path dir;
    CSetupDocument doc;
    CRecordingHost host;
    std::unique_ptr<CZoSEDlgBase> page;
};

}  // namespace

TEST_F(PeriodPage, AFileIsHeldAgainstThePeriodAsItChanges) {
    EXPECT_EQ(Check()->text(), "");
    EXPECT_FALSE(Child<QPushButton>(page.get(), "viewDataFile")->isEnabled());
    Enter(Child<QLineEdit>(page.get(), "dataFile"), "data/waves_mouth.qrd0");
    EXPECT_EQ(Check()->text(), "The file covers the period.");
    EXPECT_TRUE(Child<QPushButton>(page.get(), "viewDataFile")->isEnabled());

    // One more step and the period runs past the file's end.
    doc.GetPeriod()->TimeStepCount(17281);
    page->SetData();
    EXPECT_EQ(Check()->text(),
              "data/waves_mouth.qrd0: the time axis (2021-06-01 00:00:00 to 2021-06-07 00:00:00) "
              "does not cover the simulation period (2021-06-01 00:00:00 to 2021-06-07 00:00:30)");
    // The page stores nothing of the file.
    EXPECT_EQ(doc.ToText().find("waves_mouth"), std::string::npos);
}

TEST_F(PeriodPage, SelectAndViewAFile) {
    FileChooserStub chooser(QString::fromStdString((dir / "data" / "waves_mouth.qrd0").string()));
    const ZoFileSelectorHook previous = ZoSetFileSelectorHook([](CZoFileSelectorDlg& d) {
        d.Prepare();
        EXPECT_TRUE(d.HasTimeValidation());
        QTest::mouseClick(Child<QPushButton>(&d, "browse"), Qt::LeftButton);
        d.accept();
        return d.result();
    });
    QTest::mouseClick(Child<QPushButton>(page.get(), "selectDataFile"), Qt::LeftButton);
    ZoSetFileSelectorHook(previous);
    EXPECT_EQ(Child<QLineEdit>(page.get(), "dataFile")->text(), "data/waves_mouth.qrd0");
    EXPECT_EQ(Check()->text(), "The file covers the period.");

    QTest::mouseClick(Child<QPushButton>(page.get(), "viewDataFile"), Qt::LeftButton);
    CZoDataViewerDlg* viewer = page->findChild<CZoDataViewerDlg*>();
    ASSERT_TRUE(viewer);
    EXPECT_EQ(viewer->Path(), (dir / "data" / "waves_mouth.qrd0").string());
    EXPECT_EQ(viewer->Items(), (std::vector<int>{1, 2, 3}));
    viewer->close();
}
