#include "WaterColumnTestSupport.h"
#include "fem/UnitUtil.h"
#include "watercolumn/MTSandFractionListKiv.h"

using namespace testsupport;
using namespace wctest;
using paramfile::ParamType;

namespace {

CMTSandFractionListKiv* Sand(CSetupDocument& doc) {
    return Node<CMTSandFractionListKiv>(doc, {"WATER_COLUMN", "SAND_FRACTIONS"});
}

// mm/s: a thousandth of the file's m/s.
int MillimetresPerSecond() {
    for (const UnitInfo& u : CUnitUtil::FindQuantity(100128)->units)
        if (CString(u.name) == "mm/s")
            return u.id;
    ADD_FAILURE() << "no mm/s";
    return 0;
}

class SandFractionUnits : public ::testing::Test {
protected:
    void SetUp() override { ASSERT_TRUE(CUnitUtil::SetUserUnit(100128, MillimetresPerSecond())); }
    void TearDown() override { CUnitUtil::ResetUserUnits(); }
};

}  // namespace

TEST(SandFractions, NewSetupWritesSwitchOffAndEveryFractionSand) {
    auto doc = NewSetup(3);
    auto saved = Saved(*doc);
    const auto* s = Find(*saved, {"MUD_TRANSPORT_MODULE", "WATER_COLUMN", "SAND_FRACTIONS"});
    ASSERT_NE(s, nullptr);
    EXPECT_EQ(Entries(*s),
              (std::vector<std::string>{"ZoSEKivListItemCount", "sand_fraction_description",
                                        "[FRACTION_1]", "[FRACTION_2]", "[FRACTION_3]"}));
    EXPECT_EQ(Int(*s, "ZoSEKivListItemCount"), 3);
    EXPECT_EQ(TypeOf(*s, "sand_fraction_description"), ParamType::Integer);
    EXPECT_EQ(Int(*s, "sand_fraction_description"), 0);
    for (const char* name : {"FRACTION_1", "FRACTION_2", "FRACTION_3"}) {
        const auto* item = s->FindSection(name);
        ASSERT_NE(item, nullptr);
        EXPECT_EQ(Entries(*item),
                  (std::vector<std::string>{"include_sand", "mean_settling_velocity"}));
        EXPECT_EQ(TypeOf(*item, "include_sand"), ParamType::Boolean);
        EXPECT_TRUE(Bool(*item, "include_sand"));
        EXPECT_EQ(Double(*item, "mean_settling_velocity"), 0.001);
    }
    CMTSandFractionListKiv* sand = Sand(*doc);
    EXPECT_FALSE(sand->IsSand(1));
    EXPECT_EQ(doc->GetImportantNode("MT Sand Fractions"), sand);
    EXPECT_STREQ(sand->GetDlgRuntimeClass(2555), "CMTSandFractionListDlg");
    EXPECT_FALSE(sand->GetItem(1)->IsDlgUsedInSetup());
    EXPECT_EQ(sand->GetItem(2)->GetTitle(), "Fraction 2");
}

TEST(SandFractions, RoundTripKeepsValuesAndTheVelocityIsAFloat) {
    const std::string text = Module(2,
        " WATER_COLUMN {\n  SAND_FRACTIONS {\n   sand_fraction_description = 1\n"
        "   FRACTION_1 {\n    include_sand = false\n    mean_settling_velocity = 0.0125\n   }\n"
        "   FRACTION_2 {\n    include_sand = true\n    mean_settling_velocity = 0.33333334\n   }\n"
        "  }\n }\n");
    auto doc = Load(text);
    CMTSandFractionListKiv* sand = Sand(*doc);
    EXPECT_TRUE(sand->IncludeSandFractions());
    EXPECT_FALSE(sand->IsSand(1));
    EXPECT_TRUE(sand->IsSand(2));
    EXPECT_FALSE(sand->IsSand(3));

    // A velocity typed with more digits than a float holds is written as the float.
    sand->GetItem(1)->StoredMeanSettlingVelocity(1.0 / 3.0);
    auto saved = Saved(*doc);
    const auto* s = Find(*saved, {"MUD_TRANSPORT_MODULE", "WATER_COLUMN", "SAND_FRACTIONS"});
    ASSERT_NE(s, nullptr);
    EXPECT_EQ(Int(*s, "sand_fraction_description"), 1);
    EXPECT_FALSE(Bool(*s->FindSection("FRACTION_1"), "include_sand"));
    EXPECT_EQ(Double(*s->FindSection("FRACTION_1"), "mean_settling_velocity"), 0.33333334);
    EXPECT_EQ(Double(*s->FindSection("FRACTION_2"), "mean_settling_velocity"), 0.33333334);
    EXPECT_NE(doc->ToText().find("mean_settling_velocity = 0.33333334\n"), std::string::npos);
}

TEST(SandFractions, SwitchOtherThanOneReadsAsOffWithAWarning) {
    auto r = CSetupDocument::FromText(
        Module(1, " WATER_COLUMN {\n  SAND_FRACTIONS {\n   sand_fraction_description = 5\n  }\n }\n"),
        "t.setup");
    ASSERT_TRUE(r.document);
    EXPECT_FALSE(Sand(*r.document)->IncludeSandFractions());
    ASSERT_EQ(WarningTexts(r).size(), 1u);
    EXPECT_NE(WarningTexts(r)[0].find("sand_fraction_description = 5"), std::string::npos);

    auto missing = Load(Module(1, " WATER_COLUMN {\n  SAND_FRACTIONS {\n  }\n }\n"));
    EXPECT_FALSE(Sand(*missing)->IncludeSandFractions());

    // A switch of the wrong type keeps the default and is reported once.
    auto typed = CSetupDocument::FromText(
        Module(1, " WATER_COLUMN {\n  SAND_FRACTIONS {\n   sand_fraction_description = true\n"
                  "  }\n }\n"),
        "t.setup");
    ASSERT_TRUE(typed.document);
    EXPECT_FALSE(Sand(*typed.document)->IncludeSandFractions());
    EXPECT_EQ(WarningTexts(typed).size(), 1u);
}

TEST(SandFractions, ResizingKeepsTheRemainingItems) {
    auto doc = NewSetup(3);
    CMTSandFractionListKiv* sand = Sand(*doc);
    sand->GetItem(1)->IncludeSand(false);
    sand->GetItem(2)->StoredMeanSettlingVelocity(0.02);
    ModelDefinition(doc->Module())->NumberOfFractions(2);
    ASSERT_EQ(sand->GetItemCount(), 2);
    EXPECT_FALSE(sand->GetItem(1)->IncludeSand());
    EXPECT_EQ(sand->GetItem(2)->StoredMeanSettlingVelocity(), 0.02);
    ModelDefinition(doc->Module())->NumberOfFractions(4);
    ASSERT_EQ(sand->GetItemCount(), 4);
    EXPECT_TRUE(sand->GetItem(4)->IncludeSand());
    EXPECT_EQ(sand->GetItem(4)->StoredMeanSettlingVelocity(), 0.001);
    EXPECT_FALSE(sand->GetItem(1)->IncludeSand());
    EXPECT_TRUE(sand->IsDlgUsedInSetup());
    ModelDefinition(doc->Module())->NumberOfFractions(-2);
    EXPECT_EQ(sand->GetItemCount(), 0);
    EXPECT_FALSE(sand->IsDlgUsedInSetup());
}

TEST_F(SandFractionUnits, FileValueIsShownInTheUserUnitAndWrittenBackUnchanged) {
    auto doc = Load(Module(1,
        " WATER_COLUMN {\n  SAND_FRACTIONS {\n"
        "   FRACTION_1 {\n    include_sand = true\n    mean_settling_velocity = 0.001\n   }\n"
        "  }\n }\n"));
    CMTSandFractionItemKiv* item = Sand(*doc)->GetItem(1);
    EXPECT_DOUBLE_EQ(item->MeanSettlingVelocity(), 1.0);
    auto saved = Saved(*doc);
    const auto* f1 = Find(*saved, {"MUD_TRANSPORT_MODULE", "WATER_COLUMN", "SAND_FRACTIONS",
                                   "FRACTION_1"});
    ASSERT_NE(f1, nullptr);
    EXPECT_EQ(Double(*f1, "mean_settling_velocity"), 0.001);

    // Entered as 2.5 mm/s, stored as 0.0025 m/s.
    item->MeanSettlingVelocity(2.5);
    saved = Saved(*doc);
    f1 = Find(*saved, {"MUD_TRANSPORT_MODULE", "WATER_COLUMN", "SAND_FRACTIONS", "FRACTION_1"});
    EXPECT_EQ(Double(*f1, "mean_settling_velocity"), 0.0025);

    // The user changes the unit while the setup is open: only the display changes.
    CUnitUtil::ResetUserUnits();
    EXPECT_DOUBLE_EQ(item->MeanSettlingVelocity(), 0.0025);
    saved = Saved(*doc);
    f1 = Find(*saved, {"MUD_TRANSPORT_MODULE", "WATER_COLUMN", "SAND_FRACTIONS", "FRACTION_1"});
    EXPECT_EQ(Double(*f1, "mean_settling_velocity"), 0.0025);
}

TEST_F(SandFractionUnits, NewAndMissingVelocitiesAreTheDefaultInTheFileUnit) {
    auto doc = Load(Module(2,
        " WATER_COLUMN {\n  SAND_FRACTIONS {\n   FRACTION_1 {\n    include_sand = false\n"
        "   }\n  }\n }\n"));
    CMTSandFractionListKiv* sand = Sand(*doc);
    EXPECT_DOUBLE_EQ(sand->GetItem(1)->MeanSettlingVelocity(), 1.0);
    EXPECT_DOUBLE_EQ(sand->GetItem(2)->MeanSettlingVelocity(), 1.0);
    auto saved = Saved(*doc);
    const auto* s = Find(*saved, {"MUD_TRANSPORT_MODULE", "WATER_COLUMN", "SAND_FRACTIONS"});
    ASSERT_NE(s, nullptr);
    EXPECT_EQ(Double(*s->FindSection("FRACTION_1"), "mean_settling_velocity"), 0.001);
    EXPECT_EQ(Double(*s->FindSection("FRACTION_2"), "mean_settling_velocity"), 0.001);
}
