// The data-file reader and writer: each kind over good files, a table of bad ones, the
// values, dates and point files.
#include "datafile/DataFile.h"

#include <gtest/gtest.h>

#include <sys/stat.h>
#include <unistd.h>

#include <cmath>
#include <filesystem>
#include <fstream>
#include <string>
#include <string_view>

namespace fs = std::filesystem;
using namespace datafile;
using namespace std::literals;

namespace {

const char* const kSeries =
    "qrd0 1\n"
    "# tide at the mouth\n"
    "title \"Mouth \\\"west\\\"\"\n"
    "start 2024-01-01 00:00:00\n"
    "step 1800\n"
    "steps 3\n"
    "items 2\n"
    "item \"Wave height\" 100084 cm\n"
    "item period \"wave period\"\n"
    "values\n"
    "1.0 4\n"
    "1.5, 4.5  # a comment\n"
    "2.0;5\n";

std::string Text(const std::string& kind, const std::string& layout, int steps = 2) {
    return kind + " 1\nstart 2024-01-01 00:00\nstep 60\nsteps " + std::to_string(steps) + "\n" +
           layout + "items 1\nitem h 100000\nvalues\n";
}

class DataFileDir : public ::testing::Test {
protected:
    void SetUp() override {
        dir = fs::temp_directory_path() /
              ("mudsetup-datafile-" +
               std::string(::testing::UnitTest::GetInstance()->current_test_info()->name()));
        fs::remove_all(dir);
        fs::create_directories(dir);
    }
    void TearDown() override {
        fs::permissions(dir, fs::perms::owner_all, fs::perm_options::add);
        fs::remove_all(dir);
    }
    std::string Write(const std::string& name, const std::string& text) {
        const fs::path p = dir / name;
        std::ofstream(p, std::ios::binary) << text;
        return p.string();
    }
    fs::path dir;
};

}  // namespace

TEST(DataFile, TimeSeriesHeaderNamesItemsUnitsAndTimeAxis) {
    HeaderResult r = ParseHeader(kSeries, "mouth.qrd0");
    ASSERT_FALSE(r.error) << r.error->ToString();
    const datafile::Header& h = *r.header;
    EXPECT_EQ(h.kind, Kind::TimeSeries);
    EXPECT_EQ(h.title, "Mouth \"west\"");
    EXPECT_EQ(FormatDateTime(h.time.start), "2024-01-01 00:00:00");
    EXPECT_EQ(h.time.step, 1800.0);
    EXPECT_EQ(h.time.steps, 3);
    EXPECT_EQ(FormatDateTime(static_cast<std::int64_t>(h.time.End())), "2024-01-01 01:00:00");
    ASSERT_EQ(h.items.size(), 2u);
    EXPECT_EQ(h.items[0].name, "Wave height");
    EXPECT_EQ(h.items[0].unitType, 100084);
    EXPECT_EQ(h.items[0].unit, "cm");
    // A unit type given by its name, the unit left to the type's first.
    EXPECT_EQ(h.items[1].unitType, 100085);
    EXPECT_EQ(h.items[1].unit, "s");
    EXPECT_EQ(h.valuesLine, 11);
}

TEST(DataFile, EachKindReadsItsLayout) {
    struct Case {
        const char* name;
        std::string text;
        Kind kind;
        std::int64_t perStep;
    };
    const Case cases[] = {
        {"old.kx0", Text("kx0", ""), Kind::TimeSeries, 1},
        {"line.qrd1", Text("qrd1", "points 4\n"), Kind::LineSeries, 4},
        {"grid.qrd2", Text("qrd2", "grid 3 2\norigin 10 20.5\ncell_size 5 5\n"), Kind::Grid, 6},
        {"old.kx2", Text("kx2", "grid 2 2\n"), Kind::Grid, 4},
        {"mesh.qrdu", Text("qrdu", "elements 7\n"), Kind::MeshData, 7},
        {"no-extension", Text("qrdu", "nodes 5\n"), Kind::MeshData, 5},
    };
    for (const Case& c : cases) {
        HeaderResult r = ParseHeader(c.text, c.name);
        ASSERT_FALSE(r.error) << c.name << ": " << r.error->ToString();
        EXPECT_EQ(r.header->kind, c.kind) << c.name;
        EXPECT_EQ(r.header->ValuesPerStep(), c.perStep) << c.name;
    }
    const HeaderResult grid = ParseHeader(cases[2].text, "grid.qrd2");
    EXPECT_EQ(grid.header->x0, 10.0);
    EXPECT_EQ(grid.header->y0, 20.5);
    EXPECT_EQ(grid.header->dx, 5.0);
    EXPECT_EQ(ParseHeader(cases[4].text, "m.qrdu").header->location, MeshLocation::Elements);
}

TEST(DataFile, BadHeadersGiveTheirPlaceAndWhy) {
    struct Case {
        std::string_view text;
        const char* name;
        int line, column;
        const char* message;  // part of the message
    };
    const std::string base = "qrd0 1\nstart 2024-01-01 00:00:00\nstep 60\nsteps 2\n";
    const Case cases[] = {
        {"", "a.qrd0", 1, 1, "the file is empty"},
        {"x y z\n", "a.qrd0", 1, 1, "not a data file"},
        {"qrd0 2\n", "a.qrd0", 1, 6, "version must lie between 1 and 1"},
        {"qrd0 1\nstart 2024-01-01\n", "a.qrd0", 2, 7, "must be a date and time"},
        {"qrd0 1\nstart 2024-02-30 00:00\n", "a.qrd0", 2, 7, "must be a date and time"},
        {"qrd0 1\nstep 0\n", "a.qrd0", 2, 6, "more than 0 seconds"},
        {"qrd0 1\nstep abc\n", "a.qrd0", 2, 6, "must be a finite number"},
        {"qrd0 1\nsteps 0\n", "a.qrd0", 2, 7, "between 1 and"},
        {"qrd0 1\nsteps 2\nsteps 3\n", "a.qrd0", 3, 1, "given twice (first on line 2)"},
        {"qrd0 1\nitems 99999999\n", "a.qrd0", 2, 7, "between 1 and 10000"},
        {"qrd0 1\nitem h 123456\n", "a.qrd0", 2, 8, "unknown unit type \"123456\""},
        {"qrd0 1\nitem h 100084 km\n", "a.qrd0", 2, 15, "\"km\" is not a unit of Wave height"},
        {"qrd0 1\nitem h\n", "a.qrd0", 2, 7, "expected \"item NAME UNITTYPE [UNIT]\""},
        {"qrd0 1\nitem \"h 100084\n", "a.qrd0", 2, 6, "not closed"},
        {"qrd0 1\nitems 1\nitem a 100084\nitem b 100084\n", "a.qrd0", 4, 1,
         "more item lines than \"items\" on line 2 announces (1)"},
        {"qrd0 1\npoints 3\n", "a.qrd0", 2, 1, "belongs to a line series file"},
        {"qrd0 1\nwhatever 3\n", "a.qrd0", 2, 1, "unknown keyword \"whatever\""},
        {"qrd2 1\n", "a.qrd0", 1, 1, "declares a 2D grid (qrd2) but its name ends in the extension of a time series"},
        {"qrdu 1\nnodes 3\nelements 4\n", "a.qrdu", 3, 1, "either on the nodes or on the elements"},
        {"qrd2 1\ngrid 100000 100000\n", "a.qrd2", 2, 13, "more than 1000000000 cells"},
        // Truncated headers and wrong counts, found where the header ends.
        {"qrd0 1\nstart 2024-01-01 00:00\nstep 60\n", "a.qrd0", 4, 1, "without a \"values\" line"},
        {"qrd0 1\nstep 60\nsteps 1\nitems 1\nitem a 100084\nvalues\n", "a.qrd0", 6, 1,
         "no \"start\" line"},
        {"qrd0 1\nstart 2024-01-01 00:00\nstep 60\nsteps 1\nitems 2\nitem a 100084\nvalues\n",
         "a.qrd0", 7, 1, "announces 2 items but 1 item lines follow"},
        {"qrd1 1\nstart 2024-01-01 00:00\nstep 60\nsteps 1\nitems 1\nitem a 100084\nvalues\n",
         "a.qrd1", 7, 1, "no \"points\" line"},
        {"qrd0 1\nstart 2024-01-01 00:00\nstep 60\nsteps 1\nitems 1\nitem a 100084\nvalues 3\n",
         "a.qrd0", 7, 8, "stands alone"},
        // Only the escapes the format defines; no NUL byte in a text, quoted or not.
        {"qrd0 1\ntitle \"a\\qb\"\n", "a.qrd0", 2, 9, "unknown escape \"\\q\""},
        {"qrd0 1\nitem \"h\\\x01\" 100084\n", "a.qrd0", 2, 8, "unknown escape \"\\x01\""},
        {"qrd0 1\nitem \"a\0b\" 100084\n"sv, "a.qrd0", 2, 8, "a NUL byte"},
        {"qrd0 1\nitem a\0b 100084\n"sv, "a.qrd0", 2, 7, "a NUL byte"},
        {"qrd0 1\n\0\n"sv, "a.qrd0", 2, 1, "a NUL byte"},
    };
    for (const Case& c : cases) {
        HeaderResult r = ParseHeader(c.text, c.name);
        ASSERT_TRUE(r.error) << c.text;
        EXPECT_FALSE(r.header);
        EXPECT_EQ(r.error->file, c.name);
        EXPECT_EQ(r.error->line, c.line) << c.text << " -> " << r.error->ToString();
        EXPECT_EQ(r.error->column, c.column) << c.text << " -> " << r.error->ToString();
        EXPECT_NE(r.error->message.find(c.message), std::string::npos)
            << c.text << " -> " << r.error->ToString();
    }
    // What the format defines still reads, and a NUL byte in a comment is no text.
    const HeaderResult r = ParseHeader(base + "title \"q\\\"b\\\\s\\nn\\tt\" # \0\n"s +
                                           "items 1\nitem a 100084\nvalues\n",
                                       "a.qrd0");
    ASSERT_FALSE(r.error) << r.error->ToString();
    EXPECT_EQ(r.header->title, "q\"b\\s\nn\tt");
}

TEST(DataFile, ValuesAreReadForTheItemsAndPointAskedAndCounted) {
    ValuesRequest req;
    req.items = {1, 0};
    datafile::Header h;
    ValuesResult r = ParseValues(kSeries, "mouth.qrd0", req, &h);
    ASSERT_FALSE(r.error) << r.error->ToString();
    EXPECT_EQ(h.items.size(), 2u);
    ASSERT_EQ(r.rows.size(), 3u);
    EXPECT_EQ(r.rows[0], (std::vector<double>{4, 1}));
    EXPECT_EQ(r.rows[2], (std::vector<double>{5, 2}));
    EXPECT_EQ(r.valuesRead, 6);
    EXPECT_EQ(r.minimum, 1);
    EXPECT_EQ(r.maximum, 5);

    // Point 2 of a line series: values are step by step, item by item, point by point.
    const std::string line = Text("qrd1", "points 3\n") + "1 2 3\n4 5 nan\n";
    req.items = {0};
    req.point = 2;
    r = ParseValues(line, "l.qrd1", req);
    ASSERT_FALSE(r.error) << r.error->ToString();
    ASSERT_EQ(r.rows.size(), 2u);
    EXPECT_EQ(r.rows[0][0], 3);
    EXPECT_TRUE(std::isnan(r.rows[1][0]));

    // A field: every point of the first item asked, at one step, the other item between.
    const std::string grid = "qrd2 1\nstart 2024-01-01 00:00\nstep 60\nsteps 2\ngrid 2 1\nitems 2\n"
                             "item a 100084\nitem b 100084\nvalues\n1 2 3 4\n5 6 7 8\n";
    req = {};
    req.items = {1};
    req.point = -1;
    req.fieldStep = 1;
    r = ParseValues(grid, "g.qrd2", req);
    ASSERT_FALSE(r.error) << r.error->ToString();
    EXPECT_EQ(r.field, (std::vector<double>{7, 8}));
    EXPECT_TRUE(r.rows.empty());
}

TEST(DataFile, BadValuesGiveTheirPlace) {
    struct Case {
        std::string text;
        int line, column;
        const char* message;
    };
    const std::string h = Text("qrd0", "", 3);  // 3 values, values on line 8
    const Case cases[] = {
        {h + "1\n2\n", 10, 1, "the file ends after 2 of 3 values (in time step 3, item 1)"},
        {h + "1\n2\n3 4\n", 10, 3, "more values than the header announces (3)"},
        {h + "1\n2x\n3\n", 9, 1, "\"2x\" is not a number"},
        {h + "1\n1e999\n3\n", 9, 1, "out of range"},
        {h + "1 " + std::string(100, '7') + "\n", 8, 3, "is not a number"},
    };
    for (const Case& c : cases) {
        ValuesResult r = ParseValues(c.text, "v.qrd0", {});
        ASSERT_TRUE(r.error) << c.text;
        EXPECT_EQ(r.error->line, c.line) << r.error->ToString();
        EXPECT_EQ(r.error->column, c.column) << r.error->ToString();
        EXPECT_NE(r.error->message.find(c.message), std::string::npos) << r.error->ToString();
    }
}

TEST(DataFile, WrittenFilesReadBackTheSame) {
    datafile::Header h;
    h.kind = Kind::Grid;
    h.title = "Bed \"level\"\nmap";
    h.time.start = *ParseDateTime("2023-12-31 23:30:00");
    h.time.step = 0.1;
    h.time.steps = 2;
    h.columns = 2;
    h.rows = 1;
    h.x0 = 1e6;
    h.dy = 0.25;
    h.items = {{"Elevation", 100280, "cm"}, {"Wind, speed", 100274, "knot"}};
    const std::vector<double> values = {1, 2, 3, 4, 0.1, -1e-300, 7, NAN};
    const std::string text = FormatDataFile(h, values);
    datafile::Header back;
    ValuesRequest req;
    req.items = {0, 1};
    req.point = 1;
    ValuesResult r = ParseValues(text, "g.qrd2", req, &back);
    ASSERT_FALSE(r.error) << r.error->ToString() << "\n" << text;
    EXPECT_EQ(back.title, h.title);
    EXPECT_EQ(back.time.start, h.time.start);
    EXPECT_EQ(back.time.step, 0.1);
    EXPECT_EQ(back.x0, 1e6);
    EXPECT_EQ(back.dy, 0.25);
    ASSERT_EQ(back.items.size(), 2u);
    EXPECT_EQ(back.items[1].name, "Wind, speed");
    EXPECT_EQ(back.items[1].unit, "knot");
    EXPECT_EQ(r.rows[0], (std::vector<double>{2, 4}));
    EXPECT_EQ(r.rows[1][0], -1e-300);
    EXPECT_TRUE(std::isnan(r.rows[1][1]));

    EXPECT_EQ(CheckHeader(h), "");
    h.items[0].unit = "furlong";
    EXPECT_NE(CheckHeader(h).find("not a unit of Elevation"), std::string::npos);
}

TEST(DataFile, DatesReadStrictlyAndWriteBack) {
    EXPECT_EQ(ParseDateTime("1970-01-01 00:00:00"), 0);
    EXPECT_EQ(ParseDateTime("1970-01-02T00:00"), 86400);
    EXPECT_EQ(ParseDateTime("1969-12-31 23:59:59"), -1);
    EXPECT_EQ(ParseDateTime("2024-02-29 12:00:00"), 1709208000);
    for (const char* bad : {"", "2024-02-30 00:00", "2023-02-29 00:00", "2024-1-01 00:00",
                            "2024-01-01 24:00", "2024-01-01 00:60", "2024-01-01 00:00:", "2024-01-01"})
        EXPECT_FALSE(ParseDateTime(bad)) << bad;
    for (const char* t : {"2024-02-29 12:34:56", "1900-03-01 00:00:00", "0001-01-01 00:00:00"})
        EXPECT_EQ(FormatDateTime(*ParseDateTime(t)), t);
}

TEST(DataFile, PointFilesTakeXYZAndAnOptionalName) {
    XyzResult r = ParseXyz("# stations\n1 2 3 Cuxhaven pier\n\n4.5,5.5,-6\r\n", "p.xyz");
    ASSERT_FALSE(r.error) << r.error->ToString();
    ASSERT_EQ(r.points.size(), 2u);
    EXPECT_EQ(r.points[0].name, "Cuxhaven pier");
    EXPECT_EQ(r.points[1].z, -6);
    EXPECT_EQ(r.points[1].name, "");

    r = ParseXyz("1 2 3\n1 2\n", "p.xyz");
    ASSERT_TRUE(r.error);
    EXPECT_EQ(r.error->ToString(), "p.xyz:2:4: expected \"x y z name\" (name optional): the z value is missing");
    EXPECT_TRUE(r.points.empty());
    r = ParseXyz("1 two 3\n", "p.xyz");
    ASSERT_TRUE(r.error);
    EXPECT_EQ(r.error->column, 3);
    r = ParseXyz("1 2 3 pier\n1 2 3 a\0b\n"sv, "p.xyz");
    ASSERT_TRUE(r.error);
    EXPECT_EQ(r.error->ToString(), "p.xyz:2:8: a NUL byte (0x00) in the point's name");
    EXPECT_TRUE(r.points.empty());
}

TEST_F(DataFileDir, FilesOnDiskMissingFoldersAndUnreadable) {
    const std::string good = Write("mouth.qrd0", kSeries);
    EXPECT_FALSE(ReadHeader(good).error);
    ValuesRequest req;
    req.items = {0};
    EXPECT_EQ(ReadValues(good, req).rows.size(), 3u);

    struct Case {
        std::string path;
        const char* message;
    };
    fs::create_directories(dir / "folder.qrd0");
    const std::string locked = Write("locked.qrd0", kSeries);
    fs::permissions(locked, fs::perms::none);
    std::vector<Case> cases = {
        {(dir / "missing.qrd0").string(), "the file does not exist"},
        {(dir / "folder.qrd0").string(), "this is a folder, not a data file"},
    };
    if (geteuid() != 0)  // root reads anything
        cases.push_back({locked, "the file cannot be read: Permission denied"});
    for (const Case& c : cases) {
        for (const auto& error : {ReadHeader(c.path).error, ReadValues(c.path, req).error}) {
            ASSERT_TRUE(error) << c.path;
            EXPECT_EQ(error->ToString(), c.path + ": " + c.message);
        }
    }
}

TEST_F(DataFileDir, WriteReplacesTheFileOnlyWhenTheWholeWriteSucceeds) {
    datafile::Header h;
    h.time.start = 0;
    h.time.step = 60;
    h.time.steps = 2;
    h.items = {{"Level", 100000, "m"}};
    const std::string path = (dir / "w.qrd0").string();
    std::string error;
    ASSERT_TRUE(WriteDataFile(path, h, {1, 2}, &error)) << error;
    EXPECT_FALSE(ReadValues(path, {}).error);

    EXPECT_FALSE(WriteDataFile(path, h, {1, 2, 3}, &error));
    EXPECT_EQ(error, "the header announces 2 values but 3 are given");
    EXPECT_FALSE(WriteDataFile((dir / "no" / "such" / "w.qrd0").string(), h, {1, 2}, &error));
    EXPECT_NE(error.find("No such file or directory"), std::string::npos) << error;
    EXPECT_FALSE(ReadValues(path, {}).error);
    EXPECT_EQ(std::distance(fs::directory_iterator(dir), fs::directory_iterator()), 1);
}

TEST(DataFile, KindsFromWordsAndExtensions) {
    EXPECT_EQ(KindFromExtension("a/B.QRD0"), Kind::TimeSeries);
    EXPECT_EQ(KindFromExtension("x.kx0"), Kind::TimeSeries);
    EXPECT_EQ(KindFromExtension("x.Kx2"), Kind::Grid);
    EXPECT_EQ(KindFromExtension("x.qrdu"), Kind::MeshData);
    EXPECT_EQ(KindFromExtension("x.xyz"), Kind::Points);
    EXPECT_FALSE(KindFromExtension("x.qrd0/readme"));
    EXPECT_FALSE(KindFromExtension("x.txt"));
    EXPECT_FALSE(KindFromWord("QRD0"));
}
