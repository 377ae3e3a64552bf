// The data-file check from the header: kinds, item numbers and unit types, the period's
// time axis, relative names and the header cache.
#include "TestSupport.h"
#include "datafile/DataFileCache.h"
#include "datafile/ZoFileSelector.h"
#include "fem/FemEditorUtil.h"
#include "fem/SimulationPeriodKiv.h"
#include "setupeditor/ZoSEQrdSelection.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>

namespace fs = std::filesystem;

namespace {

// x, y, rate, spill of a dredger over a day, every hour.
const char* const kDredger =
    "qrd0 1\n"
    "start 2024-01-01 00:00:00\n"
    "step 3600\n"
    "steps 25\n"
    "items 4\n"
    "item x 100183\n"
    "item y 100183\n"
    "item rate 100195 t/h\n"
    "item spill 100013 %\n"
    "values\n";

class Selector : public ::testing::Test {
protected:
    void SetUp() override {
        dir = fs::temp_directory_path() /
              ("mudsetup-selector-" +
               std::string(::testing::UnitTest::GetInstance()->current_test_info()->name()));
        fs::remove_all(dir);
        fs::create_directories(dir / "data");
        Write("data/dredger.qrd0", kDredger);
        Write("data/grid.qrd2",
              "qrd2 1\nstart 2024-01-01 00:00\nstep 60\nsteps 1\ngrid 1 1\nitems 1\n"
              "item h 100084\nvalues\n1\n");
    }
    void TearDown() override { fs::remove_all(dir); }
    void Write(const std::string& name, const std::string& text) {
        std::ofstream(dir / name, std::ios::binary) << text;
    }
    // The requests of a dredger's file.
    CZoFileSelector Dredger() {
        CZoFileSelector s;
        s.SetBaseFolder(dir.string());
        s.EnablePlugin(0);
        s.SetMinNoItems(4);
        s.AddRequest("x-coordinate").SetOvuType(100183);
        s.AddRequest("y-coordinate").SetOvuType(100183);
        s.AddRequest("rate of dredged mass").SetMultiOvuType({100195, 100504});
        s.AddRequest("spill").SetMultiOvuType({100013, 100505});
        return s;
    }
    fs::path dir;
};

}  // namespace

TEST_F(Selector, AnswersFromTheHeaderAndSaysWhatFailed) {
    struct Case {
        const char* name;
        std::vector<int> items;
        const char* error;  // empty: valid
    };
    const Case cases[] = {
        {"data/dredger.qrd0", {1, 2, 3, 4}, ""},
        {"data\\dredger.qrd0", {1, 2, 3, 4}, ""},
        {"  ", {1, 2, 3, 4}, "no data file is given"},
        {"data/none.qrd0", {1, 2, 3, 4}, "data/none.qrd0: the file does not exist"},
        {"data", {1, 2, 3, 4}, "data: this is a folder, not a data file"},
        {"data/dredger.qrd0", {1, 2, 3}, "data/dredger.qrd0: 4 items must be chosen, 3 are"},
        {"data/dredger.qrd0", {1, 2, 3, 5}, "data/dredger.qrd0: item 5: the file holds 4 items"},
        {"data/dredger.qrd0", {1, 2, 4, 3},
         "data/dredger.qrd0: item 4 \"spill\" is a Fraction; \"rate of dredged mass\" needs Mass "
         "rate or Mass flux"},
        {"data/grid.qrd2", {1, 1, 1, 1}, "data/grid.qrd2: a 2D grid file, where a time series file is needed"},
    };
    CZoFileSelector s = Dredger();
    s.SetFilter("timeseries (*.qrd0) |*.qrd0|All files (*.*) |*.*||");
    s.SetAcceptedKinds({datafile::Kind::TimeSeries});
    for (const Case& c : cases) {
        CString error;
        EXPECT_EQ(s.IsQrdFileValid(c.name, c.items, &error), *c.error == 0) << c.name;
        EXPECT_EQ(error, c.error) << c.name;
    }
}

TEST_F(Selector, WithoutItemNumbersEveryRequestNeedsAnItemOfItsType) {
    CZoFileSelector s;
    s.SetBaseFolder(dir.string());
    s.SetMinNoItems(3);
    s.AddRequest("Wave height").SetMultiOvuType({100084, 100097});
    CString error;
    EXPECT_FALSE(s.IsQrdFileValid("data/grid.qrd2", &error));
    EXPECT_EQ(error, "data/grid.qrd2: the file holds 1 items, at least 3 are needed");
    s.SetMinNoItems(1);
    EXPECT_TRUE(s.IsQrdFileValid("data/grid.qrd2", &error)) << error;
    s.AddRequest("Wave period").SetOvuType(100085);
    EXPECT_FALSE(s.IsQrdFileValid("data/grid.qrd2", &error));
    EXPECT_EQ(error, "data/grid.qrd2: no item of the file can be the \"Wave period\" (Wave period)");
}

TEST_F(Selector, KindsComeFromTheFilter) {
    CZoFileSelector s;
    s.SetFilter("Wave database file (*.qrd2;*.kx2;*.qrdu)|*.qrd2; *.kx2; *.qrdu||");
    EXPECT_EQ(s.AcceptedKinds(), (std::vector{datafile::Kind::Grid, datafile::Kind::MeshData}));
    s.SetFilter("Time series files (*.qrd0) |*.qrd0|All files (*.*) |*.*||");
    EXPECT_EQ(s.AcceptedKinds().size(), 4u);
    s.SetFilter("");
    EXPECT_EQ(s.AcceptedKinds().size(), 4u);

    EXPECT_EQ(ZoQtFilter("Time series files (*.qrd0) |*.qrd0|Unstructured data files (*.qrdu)|*.qrdu|"
                         "All files (*.*) |*.*||"),
              "Time series files (*.qrd0);;Unstructured data files (*.qrdu);;All files (*)");
    EXPECT_EQ(ZoQtFilter("Wave database file (*.qrd2;*.kx2;*.qrdu)|*.qrd2; *.kx2; *.qrdu||"),
              "Wave database file (*.qrd2 *.kx2 *.qrdu)");
    EXPECT_EQ(ZoQtFilter(""), "");
}

TEST_F(Selector, TheTimeAxisMustCoverThePeriod) {
    CSetupDocument doc;
    CSimulationPeriodKiv* period = doc.GetPeriod();
    period->StartTime("2024-01-01 06:00:00");
    period->TimeStepInterval(600);
    struct Case {
        int steps;
        bool valid;
    };
    // The file runs from 00:00 to 24:00; the period from 06:00 over steps × 10 min.
    for (const Case& c : {Case{0, true}, Case{108, true}, Case{109, false}}) {
        period->TimeStepCount(c.steps);
        CZoFileSelector s = Dredger();
        period->SetUpQrdValidation_SimulationPeriod(s);
        ASSERT_TRUE(s.HasTimeValidation());
        CString error;
        EXPECT_EQ(s.IsQrdFileValid("data/dredger.qrd0", {1, 2, 3, 4}, &error), c.valid) << c.steps;
        if (!c.valid) {
            EXPECT_EQ(error, "data/dredger.qrd0: the time axis (2024-01-01 00:00:00 to 2024-01-02 "
                             "00:00:00) does not cover the simulation period (2024-01-01 06:00:00 "
                             "to 2024-01-02 00:10:00)");
        }
    }
    period->StartTime("2023-12-31 23:59:59");
    period->TimeStepCount(1);
    CZoFileSelector s = Dredger();
    period->SetUpQrdValidation_SimulationPeriod(s);
    EXPECT_FALSE(s.IsQrdFileValid("data/dredger.qrd0", {1, 2, 3, 4}, nullptr));

    // A start that is no date sets no time check; the period reports it itself.
    period->StartTime("soon");
    CZoFileSelector t = Dredger();
    period->SetUpQrdValidation_SimulationPeriod(t);
    EXPECT_FALSE(t.HasTimeValidation());
    EXPECT_EQ(period->ValidateData(), 0);
}

TEST_F(Selector, RelativeNamesAreTakenFromTheSetupFolderWhereverTheProgramRuns) {
    const std::string setup = (dir / "estuary.setup").string();
    {
        CSetupDocument doc;
        std::string error;
        ASSERT_TRUE(doc.SaveAs(setup, &error)) << error;
    }
    CSetupDocument::OpenResult opened = CSetupDocument::Open(setup);
    ASSERT_TRUE(opened.document);
    const fs::path old = fs::current_path();
    fs::current_path(fs::temp_directory_path());
    ZoSEQrdSelection file("Dredging file", "", opened.document.get(), 1);
    file.FileName("data/dredger.qrd0");
    file.SetNoItems(4);
    CString error;
    const bool valid = file.IsFileValid(&error);
    const CString absolute = file.AbsoluteFileName();
    fs::current_path(old);
    EXPECT_TRUE(valid) << error;
    EXPECT_EQ(absolute, (dir / "data" / "dredger.qrd0").string());

    CZoFileSelector s(&file);
    EXPECT_EQ(s.StoredName((dir / "data" / "x.qrd0").string()), "data/x.qrd0");
    EXPECT_EQ(s.StoredName("/elsewhere/x.qrd0"), "/elsewhere/x.qrd0");
    EXPECT_EQ(s.AbsolutePath("/abs/x.qrd0"), "/abs/x.qrd0");
}

TEST_F(Selector, OneHeaderReadForManyItemsOfTheSameFileAndAgainWhenItChanges) {
    CZoFileSelector s = Dredger();
    datafile::ClearHeaderCache();
    const auto before = datafile::HeaderReadCount();
    for (int i = 0; i < 100; ++i)
        ASSERT_TRUE(s.IsQrdFileValid("data/dredger.qrd0", {1, 2, 3, 4}, nullptr));
    EXPECT_EQ(datafile::HeaderReadCount() - before, 1u);
    EXPECT_EQ(s.Header("data/dredger.qrd0")->header->items.size(), 4u);

    // Same name, another content (and size): read again, and the answer follows.
    Write("data/dredger.qrd0", std::string(kDredger).replace(std::string(kDredger).find("item spill 100013 %"), 19, "item spill 100084 m"));
    CString error;
    EXPECT_FALSE(s.IsQrdFileValid("data/dredger.qrd0", {1, 2, 3, 4}, &error));
    EXPECT_EQ(datafile::HeaderReadCount() - before, 2u);
    EXPECT_NE(error.find("item 4 \"spill\" is a Wave height"), CString::npos) << error;

    // A file that disappears is no longer answered from the cache.
    fs::remove(dir / "data" / "dredger.qrd0");
    EXPECT_FALSE(s.IsQrdFileValid("data/dredger.qrd0", {1, 2, 3, 4}, &error));
    EXPECT_EQ(error, "data/dredger.qrd0: the file does not exist");
}

TEST_F(Selector, SelectionNodeReadsWritesAndValidates) {
    auto doc = testsupport::Load("MUD_TRANSPORT_MODULE {\n}\n");
    ZoSEQrdSelection node("File", "FILE", doc.get(), 1);
    node.SetNoItems(3);
    EXPECT_EQ(node.ItemNumber(), (std::vector<int>{1, 2, 3}));
    EXPECT_EQ(node.ItemNumber(4), 0);
    node.ItemNumber(5, 9);
    EXPECT_EQ(node.ItemNumber(), (std::vector<int>{1, 2, 3, 4, 9}));
    node.FileName((dir / "data" / "grid.qrd2").string());
    node.SetNoItems(1);
    EXPECT_EQ(node.ValidateData(), 1);
    node.ItemNumber(1, 2);
    doc->ClearErrors();
    EXPECT_EQ(node.ValidateData(), 0);
    ASSERT_EQ(doc->Errors().size(), 1u);
    EXPECT_EQ(doc->Errors()[0].message, "File is not valid");
}

TEST_F(Selector, PointFilesImportOrLeaveTheArraysAlone) {
    Write("p.xyz", "1 2 3 a\n4 5 6\n");
    Write("bad.xyz", "1 2 3\nx\n");
    std::vector<double> x{9}, y, z;
    std::vector<CString> names;
    EXPECT_FALSE(CFemEditorUtil::ImportXYZ((dir / "bad.xyz").string(), x, y, z, names, false));
    EXPECT_EQ(x, std::vector<double>{9});
    ASSERT_TRUE(CFemEditorUtil::ImportXYZ((dir / "p.xyz").string(), x, y, z, names, false));
    EXPECT_EQ(x, (std::vector<double>{1, 4}));
    EXPECT_EQ(names, (std::vector<CString>{"a", ""}));
}
