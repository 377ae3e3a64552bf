#include "ForcingsTestSupport.h"
#include "forcings/ForcingsWaveDBAxisKiv.h"
#include "forcings/ForcingsWaveDBFile.h"

#include <cmath>
#include <limits>

using namespace testsupport;
using namespace forcingstest;

namespace {

using Shape = CForcingsWaveDBListKiv::Shape;

void SetAxes(CForcingsWaveDBListKiv* db, int speeds, int directions, int levels) {
    db->WindSpeed()->Count(speeds);
    db->WindDirection()->Count(directions);
    db->WaterLevel()->Count(levels);
    db->ResizeToAxes();
}

// The point subsections of a saved database, in file order.
std::vector<std::string> PointSections(CSetupDocument& doc) {
    auto saved = Saved(doc);
    const paramfile::Section* s =
        Find(*saved, {"MUD_TRANSPORT_MODULE", "FORCINGS", "WAVES", "WAVE_DATABASE"});
    std::vector<std::string> out;
    for (const std::string& e : Entries(*s))
        if (e.starts_with("[Data_Base_Item_"))
            out.push_back(e.substr(1, e.size() - 2));
    return out;
}

std::string DatabaseText(const std::string& body) {
    return "MUD_TRANSPORT_MODULE {\n FORCINGS {\n  WAVES {\n   WAVE_DATABASE {\n" + body +
           "\n   }\n  }\n }\n}\n";
}

}  // namespace

TEST(ForcingsWaveDBListKiv, DefaultsGiveOnePointWrittenBeforeTheAxes) {
    CSetupDocument doc;
    auto saved = Saved(doc);
    const paramfile::Section* s =
        Find(*saved, {"MUD_TRANSPORT_MODULE", "FORCINGS", "WAVES", "WAVE_DATABASE"});
    ASSERT_NE(s, nullptr);
    EXPECT_EQ(Entries(*s),
              (std::vector<std::string>{"ZoSEKivListItemCount", "[Data_Base_Item_1_1_1]",
                                        "[WIND_SPEED]", "[WIND_DIRECTION]", "[WATER_LEVEL]"}));
    EXPECT_EQ(Entries(*s->FindSection("Data_Base_Item_1_1_1")),
              (std::vector<std::string>{"file_name", "item_number_for_wave_height",
                                        "item_number_for_wave_period",
                                        "item_number_for_wave_direction"}));
    struct Axis {
        const char* section;
        const char* prefix;
        const char* countKeyword;
        double start, increment;
    };
    for (const Axis& a : {Axis{"WIND_SPEED", "wind_speed", "number_of_wind_speeds", 5.0, 5.0},
                          Axis{"WIND_DIRECTION", "wind_direction", "number_of_wind_directions", 90.0, 90.0},
                          Axis{"WATER_LEVEL", "water_level", "number_of_water_levels", 0.0, 1.0}}) {
        SCOPED_TRACE(a.section);
        const paramfile::Section* axis = s->FindSection(a.section);
        ASSERT_NE(axis, nullptr);
        const std::string start = std::string("starting_value_of_") + a.prefix;
        const std::string increment = std::string("increment_value_of_") + a.prefix;
        EXPECT_EQ(Entries(*axis), (std::vector<std::string>{start, increment, a.countKeyword}));
        EXPECT_EQ(Double(*axis, start), a.start);
        EXPECT_EQ(Double(*axis, increment), a.increment);
        EXPECT_EQ(Int(*axis, a.countKeyword), 1);
    }
    CForcingsWaveDBListKiv* db = Database(doc);
    EXPECT_EQ(db->GetItemCount(), 1);
    EXPECT_EQ(db->WindSpeed()->Value(0), 5.0);
    EXPECT_EQ(db->WindDirection()->Value(0), 90.0);
    EXPECT_EQ(db->WaterLevel()->Value(0), 0.0);
}

TEST(ForcingsWaveDBListKiv, PointsAreNumberedSpeedSlowestLevelFastest) {
    CSetupDocument doc;
    CForcingsWaveDBListKiv* db = Database(doc);
    SetAxes(db, 3, 4, 2);
    ASSERT_EQ(db->GetItemCount(), 24);
    const Shape shape = db->CurrentShape();
    const auto p8 = CForcingsWaveDBListKiv::PointOf(8, shape);
    EXPECT_EQ(p8.speed, 1);
    EXPECT_EQ(p8.direction, 4);
    EXPECT_EQ(p8.level, 2);
    EXPECT_EQ(CForcingsWaveDBListKiv::PointSectionName(p8), "Data_Base_Item_1_2_4");
    // Every point once, numbered ((s - 1) * D + (d - 1)) * L + l.
    for (int k = 1; k <= 24; ++k) {
        const auto p = CForcingsWaveDBListKiv::PointOf(k, shape);
        EXPECT_EQ(((p.speed - 1) * 4 + (p.direction - 1)) * 2 + p.level, k);
    }
    const std::vector<std::string> names = PointSections(doc);
    ASSERT_EQ(names.size(), 24u);
    EXPECT_EQ(names[0], "Data_Base_Item_1_1_1");
    EXPECT_EQ(names[1], "Data_Base_Item_1_2_1");
    EXPECT_EQ(names[7], "Data_Base_Item_1_2_4");
    EXPECT_EQ(names[23], "Data_Base_Item_3_2_4");
}

TEST(ForcingsWaveDBListKiv, AtMostHundredPointsHaveItems) {
    CSetupDocument doc;
    CForcingsWaveDBListKiv* db = Database(doc);
    SetAxes(db, 10, 12, 1);
    EXPECT_EQ(db->GetItemCount(), 100);
    const std::vector<std::string> names = PointSections(doc);
    ASSERT_EQ(names.size(), 100u);
    EXPECT_EQ(names[99], "Data_Base_Item_9_1_4");  // point 100; 101 to 120 are not written
}

TEST(ForcingsWaveDBListKiv, CountsFromAFileNeitherLoopNorAllocateWithoutBound) {
    struct Case {
        const char* speeds;
        const char* directions;
        const char* levels;
        int items;
    };
    const Case cases[] = {
        {"-5", "3", "2", 0},
        {"2147483647", "1", "1", 100},
        {"2147483647", "2147483647", "2147483647", 100},  // the product would overflow
        {"-2147483648", "-2147483648", "2", 0},
        {"0", "2147483647", "2147483647", 0},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(::testing::Message() << c.speeds << " " << c.directions << " " << c.levels);
        auto doc = Load(DatabaseText(std::string("ZoSEKivListItemCount = 100000\n") +
                                     "WIND_SPEED {\nnumber_of_wind_speeds = " + c.speeds + "\n}\n" +
                                     "WIND_DIRECTION {\nnumber_of_wind_directions = " +
                                     c.directions + "\n}\n" +
                                     "WATER_LEVEL {\nnumber_of_water_levels = " + c.levels + "\n}"));
        EXPECT_EQ(Database(*doc)->GetItemCount(), c.items);
        EXPECT_EQ(PointSections(*doc).size(), static_cast<size_t>(c.items));
    }
}

TEST(ForcingsWaveDBListKiv, StoredCountThatDisagreesWithTheAxesIsReported) {
    CSetupDocument::OpenResult r = CSetupDocument::FromText(
        DatabaseText("ZoSEKivListItemCount = 7\nWIND_SPEED {\nnumber_of_wind_speeds = 2\n}"),
        "test.setup");
    ASSERT_TRUE(r.document);
    EXPECT_EQ(Database(*r.document)->GetItemCount(), 2);
    ASSERT_EQ(r.warnings.size(), 1u);
    EXPECT_EQ(r.warnings[0].pos.line, 5);
    EXPECT_NE(r.warnings[0].message.find("item count 7 does not match the 2 points"),
              std::string::npos);
    // What the module writes reads back without a word.
    CSetupDocument::OpenResult again = CSetupDocument::FromText(r.document->ToText(), "t.setup");
    EXPECT_TRUE(again.warnings.empty());
}

TEST(ForcingsWaveDBListKiv, ZeroIncrementCollapsesAnAxisButKeepsItsCount) {
    auto doc = Load(DatabaseText(R"(
WIND_DIRECTION {
    increment_value_of_wind_direction = 0.0
    number_of_wind_directions = 3
}
WIND_SPEED {
    number_of_wind_speeds = 2
})"));
    CForcingsWaveDBListKiv* db = Database(*doc);
    EXPECT_EQ(db->WindDirection()->Count(), 3);
    EXPECT_EQ(db->WindDirection()->EffectiveCount(), 1);
    EXPECT_EQ(db->GetItemCount(), 2);
    EXPECT_EQ(PointSections(*doc), (std::vector<std::string>{"Data_Base_Item_1_1_1",
                                                             "Data_Base_Item_2_1_1"}));
    const std::string text = doc->ToText();
    EXPECT_NE(text.find("number_of_wind_directions = 3"), std::string::npos);
}

TEST(ForcingsWaveDBListKiv, AxesAcceptWhatTheirQuantityAllows) {
    const double nan = std::numeric_limits<double>::quiet_NaN();
    const double inf = std::numeric_limits<double>::infinity();
    struct Case {
        int axis;  // 0 speed, 1 direction, 2 level
        double start, increment;
        int count;
        bool valid;
    };
    const Case cases[] = {
        {0, 5, 5, 1, true},   {0, 5, 0, 1, false},  {0, 0, 1, 0, true},   {0, -1, 1, 1, false},
        {0, 5, -1, 1, false}, {0, 5, 5, -1, false}, {0, nan, 5, 1, false}, {0, 5, nan, 1, false},
        {0, inf, 5, 1, false},
        {1, 90, 0, 3, true},  {1, -90, 90, 1, false}, {1, 0, -1, 1, false}, {1, 90, 90, -1, false},
        {1, 90, nan, 1, false},
        {2, -2.5, 0.5, 3, true}, {2, 0, 0, 1, true}, {2, 0, -0.5, 1, false}, {2, nan, 1, 1, false},
        {2, 0, 1, -1, false},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(::testing::Message() << c.axis << ": " << c.start << " " << c.increment
                                          << " " << c.count);
        CSetupDocument doc;
        CForcingsWaveDBListKiv* db = Database(doc);
        CForcingsWaveDBAxisKiv* axes[] = {db->WindSpeed(), db->WindDirection(), db->WaterLevel()};
        CForcingsWaveDBAxisKiv* axis = axes[c.axis];
        axis->Start(c.start);
        axis->Increment(c.increment);
        axis->Count(c.count);
        db->ResizeToAxes();
        EXPECT_EQ(axis->IsValid(), c.valid);
        EXPECT_EQ(db->AxesValid(), c.valid);
        doc.ValidateAll();
        if (c.valid) {
            EXPECT_TRUE(doc.Errors().empty());
        } else {
            EXPECT_EQ(Messages(doc),
                      (std::vector<std::string>{"MUD_TRANSPORT_MODULE/FORCINGS/WAVES/WAVE_DATABASE/" +
                                                axis->GetSectionName() + ": Values out of range"}));
        }
    }
}

TEST(ForcingsWaveDBListKiv, PointsReadTheirOwnFilesAndNothingElse) {
    auto doc = Load(DatabaseText(R"(
Data_Base_Item_1_1_1 {
    file_name = 'calm.qrd2'
    item_number_for_wave_height = 4
}
Data_Base_Item_2_1_1 {
    item_number_for_wave_period = 7
}
Data_Base_Item_3_1_1 {
    file_name = 'storm.qrdu'
}
WIND_SPEED {
    number_of_wind_speeds = 3
})"));
    CForcingsWaveDBListKiv* db = Database(*doc);
    ASSERT_EQ(db->GetItemCount(), 3);
    EXPECT_EQ(db->GetItem(1)->File()->FileName(), "calm.qrd2");
    EXPECT_EQ(db->GetItem(1)->File()->ItemNumber(), (std::vector<int>{4, 2, 3}));
    // No file name of its own: it stays empty instead of taking the one read before.
    EXPECT_EQ(db->GetItem(2)->File()->FileName(), "");
    EXPECT_EQ(db->GetItem(2)->File()->ItemNumber(), (std::vector<int>{1, 7, 3}));
    EXPECT_EQ(db->GetItem(3)->File()->FileName(), "storm.qrdu");
    const std::string text = doc->ToText();
    EXPECT_EQ(Load(text)->ToText(), text);
}

TEST(ForcingsWaveDBListKiv, FilesStayWithTheirPointWhenAnAxisChanges) {
    CSetupDocument doc;
    CForcingsWaveDBListKiv* db = Database(doc);
    SetAxes(db, 2, 2, 1);
    auto name = [](int s, int d, int l) { return FormatString("s%d d%d l%d", s, d, l); };
    auto fileOf = [&](int k) { return db->GetItem(k)->File()->FileName(); };
    for (int k = 1; k <= db->GetItemCount(); ++k) {
        const auto p = CForcingsWaveDBListKiv::PointOf(k, db->CurrentShape());
        db->GetItem(k)->File()->FileName(name(p.speed, p.direction, p.level));
    }
    db->GetItem(4)->File()->ItemNumber(std::vector<int>{6, 5, 4});

    SetAxes(db, 2, 3, 2);  // a direction and a level more
    ASSERT_EQ(db->GetItemCount(), 12);
    for (int k = 1; k <= 12; ++k) {
        const auto p = CForcingsWaveDBListKiv::PointOf(k, db->CurrentShape());
        SCOPED_TRACE(k);
        EXPECT_EQ(fileOf(k), p.direction <= 2 && p.level == 1 ? name(p.speed, p.direction, 1) : "");
    }
    EXPECT_EQ(db->GetItem(9)->File()->ItemNumber(), (std::vector<int>{6, 5, 4}));  // s2 d2 l1

    SetAxes(db, 1, 2, 1);  // back to fewer: what is left keeps its files
    ASSERT_EQ(db->GetItemCount(), 2);
    EXPECT_EQ(fileOf(1), name(1, 1, 1));
    EXPECT_EQ(fileOf(2), name(1, 2, 1));
    EXPECT_EQ(PointSections(doc).size(), 2u);

    SetAxes(db, 0, 2, 1);  // nothing left...
    EXPECT_EQ(db->GetItemCount(), 0);
    SetAxes(db, 2, 2, 1);  // ...and the points come back with their files
    for (int k = 1; k <= 4; ++k) {
        const auto p = CForcingsWaveDBListKiv::PointOf(k, db->CurrentShape());
        EXPECT_EQ(fileOf(k), name(p.speed, p.direction, p.level));
    }
    EXPECT_EQ(db->GetItem(4)->File()->ItemNumber(), (std::vector<int>{6, 5, 4}));
}

TEST(ForcingsWaveDBFile, FilesAreCheckedOnlyForTheDatabaseType) {
    DataFolder folder(TestName());
    const std::string grid = folder.Write("calm.qrd2", WaveHeader("qrd2", "grid 2 2\n"));
    const std::string series = folder.Write("calm.qrd0", WaveHeader("qrd0", ""));
    const std::string twoItems =
        folder.Write("two.qrdu", WaveHeader("qrdu", "nodes 3\n", {100084, 100085}));
    struct Case {
        int waveType;
        std::string file;
        bool valid;
    };
    const Case cases[] = {
        {2, grid, true},     {2, series, false}, {2, twoItems, false},
        {2, "", false},      {0, "", true},      {1, series, true},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(::testing::Message() << c.waveType << " " << c.file);
        CSetupDocument doc;
        SetWind(doc, true, 1);
        Waves(doc)->WaveType(c.waveType);
        Database(doc)->GetItem(1)->File()->FileName(c.file);
        doc.ValidateAll();
        std::vector<std::string> messages;
        for (const std::string& m : Messages(doc))
            if (m.find("WAVE_DATABASE") != std::string::npos)
                messages.push_back(m);
        EXPECT_EQ(messages, c.valid ? std::vector<std::string>{}
                                    : std::vector<std::string>{
                                          "MUD_TRANSPORT_MODULE/FORCINGS/WAVES/WAVE_DATABASE/"
                                          "Wave Database Item 1/MT Waves Database file: File is "
                                          "not valid"});
    }
}
