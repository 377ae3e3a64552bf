#include "WaterColumnTestSupport.h"
#include "watercolumn/MTSandFractionListKiv.h"
#include "watercolumn/MTSettlingKiv.h"

using namespace testsupport;
using namespace wctest;
using paramfile::ParamType;

namespace {

CMTSettlingKiv* Settling(CSetupDocument& doc) {
    return Node<CMTSettlingKiv>(doc, {"WATER_COLUMN", "SETTLING_VELOCITY"});
}

CMTSandFractionListKiv* Sand(CSetupDocument& doc) {
    return Node<CMTSandFractionListKiv>(doc, {"WATER_COLUMN", "SAND_FRACTIONS"});
}

}  // namespace

TEST(Settling, NewSetupWritesKeywordsInOrderWithDefaults) {
    auto doc = NewSetup(3);
    auto saved = Saved(*doc);
    const auto* s = Find(*saved, {"MUD_TRANSPORT_MODULE", "WATER_COLUMN", "SETTLING_VELOCITY"});
    ASSERT_NE(s, nullptr);
    EXPECT_EQ(Entries(*s),
              (std::vector<std::string>{"ZoSEKivListItemCount", "flocculation_description",
                                        "hindered_settling_description", "rho_sediment", "cfloc",
                                        "cgel", "chinder", "c1_salt", "c2_salt", "[FRACTION_1]",
                                        "[FRACTION_2]", "[FRACTION_3]"}));
    EXPECT_EQ(Int(*s, "flocculation_description"), 1);
    EXPECT_EQ(Int(*s, "hindered_settling_description"), 0);
    const std::pair<const char*, double> reals[] = {{"rho_sediment", 2650.0}, {"cfloc", 0.01},
                                                    {"cgel", 50.0},           {"chinder", 10.0},
                                                    {"c1_salt", 0.5},         {"c2_salt", -0.33}};
    for (const auto& [kw, value] : reals) {
        EXPECT_EQ(TypeOf(*s, kw), ParamType::Double) << kw;
        EXPECT_EQ(Double(*s, kw), value) << kw;
    }
    const auto* item = s->FindSection("FRACTION_3");
    ASSERT_NE(item, nullptr);
    EXPECT_EQ(Entries(*item),
              (std::vector<std::string>{"gamma", "wsn", "[CONSTANT_SETTLING_VELOCITY]",
                                        "[SETTLING_VELOCITY_COEFFICIENT]"}));
    EXPECT_EQ(TypeOf(*item, "gamma"), ParamType::Double);
    EXPECT_EQ(Double(*item, "gamma"), 1.0);
    EXPECT_EQ(Double(*item, "wsn"), 1.0);
    EXPECT_EQ(Double(*item->FindSection("CONSTANT_SETTLING_VELOCITY"), "constant_value"), 0.0005);
    EXPECT_EQ(Double(*item->FindSection("SETTLING_VELOCITY_COEFFICIENT"), "constant_value"),
              0.0005);

    CMTSettlingKiv* settling = Settling(*doc);
    EXPECT_STREQ(settling->GetDlgRuntimeClass(2555), "CMTSettlingDlg");
    EXPECT_STREQ(settling->GetItem(1)->GetDlgRuntimeClass(2555), "CMTSettlingItemDlg");
    EXPECT_EQ(settling->GetItem(1)->ConstantSettlingVelocity()->ItemType(), 100128);
    EXPECT_EQ(settling->GetItem(1)->SettlingVelocityCoefficient()->ItemType(), 100428);
}

TEST(Settling, RoundTripKeepsEveryValue) {
    const std::string text = Module(2,
        " WATER_COLUMN {\n  SETTLING_VELOCITY {\n"
        "   flocculation_description = 0\n   hindered_settling_description = 2\n"
        "   rho_sediment = 2600.5\n   cfloc = 0.3333333333333333\n   cgel = 40.0\n"
        "   chinder = 8.0\n   c1_salt = 0.25\n   c2_salt = -0.5\n"
        "   FRACTION_2 {\n    gamma = 1.5\n    wsn = 2.0\n"
        "    CONSTANT_SETTLING_VELOCITY {\n     format = 2\n     constant_value = 0.002\n"
        "     file_name = 'data\\ws.qrd2'\n     item_numbers = 2\n     item_name = \"ws\"\n    }\n"
        "   }\n  }\n }\n");
    auto doc = Load(text);
    CMTSettlingKiv* settling = Settling(*doc);
    EXPECT_EQ(settling->Flocculation(), 0);
    EXPECT_EQ(settling->HinderedSettling(), 2);
    EXPECT_EQ(settling->Cfloc(), 1.0 / 3.0);
    EXPECT_EQ(settling->GetItem(2)->Gamma(), 1.5);
    EXPECT_EQ(settling->GetItem(2)->ConstantSettlingVelocity()->QrdData()->FileName(),
              "data\\ws.qrd2");

    auto first = Saved(*doc);
    auto again = Load(doc->ToText());
    EXPECT_EQ(again->ToText(), doc->ToText());
    const auto* s = Find(*first, {"MUD_TRANSPORT_MODULE", "WATER_COLUMN", "SETTLING_VELOCITY"});
    ASSERT_NE(s, nullptr);
    EXPECT_EQ(Double(*s, "cfloc"), 1.0 / 3.0);
    EXPECT_EQ(Double(*s, "c2_salt"), -0.5);
    EXPECT_EQ(Double(*s->FindSection("FRACTION_2"), "wsn"), 2.0);
}

TEST(Settling, UnknownChoicesAreKeptWithAWarning) {
    auto r = CSetupDocument::FromText(
        Module(1, " WATER_COLUMN {\n  SETTLING_VELOCITY {\n   flocculation_description = 3\n"
                  "   hindered_settling_description = -1\n  }\n }\n"),
        "t.setup");
    ASSERT_TRUE(r.document);
    EXPECT_EQ(WarningTexts(r).size(), 2u);
    EXPECT_EQ(Settling(*r.document)->Flocculation(), 3);
    auto saved = Saved(*r.document);
    const auto* s = Find(*saved, {"MUD_TRANSPORT_MODULE", "WATER_COLUMN", "SETTLING_VELOCITY"});
    EXPECT_EQ(Int(*s, "hindered_settling_description"), -1);
}

TEST(Settling, SandFractionsAreSkipped) {
    auto doc = NewSetup(3);
    CMTSettlingKiv* settling = Settling(*doc);
    CMTSandFractionListKiv* sand = Sand(*doc);
    // New sand items are marked as sand, but the switch is off.
    EXPECT_EQ(settling->ItemInUseCount(), 3);

    sand->IncludeSandFractions(true);
    EXPECT_FALSE(settling->IsDlgUsedInSetup());  // every fraction sand
    EXPECT_EQ(settling->GetItemInUse(1), nullptr);

    sand->GetItem(1)->IncludeSand(false);
    sand->GetItem(3)->IncludeSand(false);
    EXPECT_TRUE(settling->GetItem(1)->IsDlgUsedInSetup());
    EXPECT_FALSE(settling->GetItem(2)->IsDlgUsedInSetup());
    EXPECT_TRUE(settling->GetItem(3)->IsDlgUsedInSetup());
    EXPECT_TRUE(settling->IsDlgUsedInSetup());
    ASSERT_EQ(settling->ItemInUseCount(), 2);
    EXPECT_EQ(settling->GetItemInUse(1), settling->GetItem(1));
    EXPECT_EQ(settling->GetItemInUse(2), settling->GetItem(3));
    EXPECT_EQ(settling->GetItemInUse(2)->GetTitle(), "Fraction 3");
    EXPECT_EQ(settling->GetItemInUse(3), nullptr);
    EXPECT_EQ(settling->GetItemInUse(0), nullptr);
}

TEST(Settling, ValidationUsesOnlyTheValueOfTheChosenFormulation) {
    auto doc = NewSetup(2);
    CMTSettlingKiv* settling = Settling(*doc);
    // Both values refer to a data file that is not given.
    for (int i = 1; i <= 2; ++i) {
        settling->GetItem(i)->ConstantSettlingVelocity()->Format(2);
        settling->GetItem(i)->SettlingVelocityCoefficient()->Format(2);
    }
    EXPECT_EQ(doc->ValidateAll(), 0);
    const auto withFlocculation = Messages(*doc);
    ASSERT_EQ(withFlocculation.size(), 2u);
    EXPECT_NE(withFlocculation[0].find("FRACTION_1/SETTLING_VELOCITY_COEFFICIENT"),
              std::string::npos);
    EXPECT_TRUE(settling->GetItem(1)->ConstantSettlingVelocity()->IsDisabled());
    EXPECT_FALSE(settling->GetItem(1)->SettlingVelocityCoefficient()->IsDisabled());

    settling->Flocculation(0);
    EXPECT_EQ(doc->ValidateAll(), 0);
    const auto constant = Messages(*doc);
    ASSERT_EQ(constant.size(), 2u);
    EXPECT_NE(constant[1].find("FRACTION_2/CONSTANT_SETTLING_VELOCITY"), std::string::npos);
    EXPECT_FALSE(settling->GetItem(2)->ConstantSettlingVelocity()->IsDisabled());
    EXPECT_TRUE(settling->GetItem(2)->SettlingVelocityCoefficient()->IsDisabled());
}
