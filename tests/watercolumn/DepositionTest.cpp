#include "WaterColumnTestSupport.h"
#include "watercolumn/MTDepositionKiv.h"
#include "watercolumn/MTSandFractionListKiv.h"

using namespace testsupport;
using namespace wctest;
using paramfile::ParamType;

namespace {
CMTDepositionKiv* Deposition(CSetupDocument& doc) {
    return Node<CMTDepositionKiv>(doc, {"WATER_COLUMN", "DEPOSITION"});
}
}  // namespace

TEST(Deposition, NewSetupWritesProfileCentroidAndOneShearStressPerFraction) {
    auto doc = NewSetup(3);
    auto saved = Saved(*doc);
    const auto* s = Find(*saved, {"MUD_TRANSPORT_MODULE", "WATER_COLUMN", "DEPOSITION"});
    ASSERT_NE(s, nullptr);
    EXPECT_EQ(Entries(*s), (std::vector<std::string>{"ZoSEKivListItemCount",
                                                     "concentration_profile", "centroid_height",
                                                     "[FRACTION_1]", "[FRACTION_2]",
                                                     "[FRACTION_3]"}));
    EXPECT_EQ(Int(*s, "concentration_profile"), 1);
    EXPECT_EQ(TypeOf(*s, "centroid_height"), ParamType::Double);
    EXPECT_EQ(Double(*s, "centroid_height"), 0.3);
    for (const char* name : {"FRACTION_1", "FRACTION_2", "FRACTION_3"}) {
        const auto* item = s->FindSection(name);
        ASSERT_NE(item, nullptr);
        EXPECT_EQ(Entries(*item),
                  (std::vector<std::string>{"[CRITICAL_SHEARSTRESS_FOR_DEPOSITION]"}));
        const auto* stress = item->FindSection("CRITICAL_SHEARSTRESS_FOR_DEPOSITION");
        EXPECT_EQ(Int(*stress, "format"), 0);
        EXPECT_EQ(Double(*stress, "constant_value"), 0.07);
    }
    CMTDepositionKiv* deposition = Deposition(*doc);
    EXPECT_STREQ(deposition->GetDlgRuntimeClass(2555), "CMTDepositionDlg");
    EXPECT_STREQ(deposition->GetItem(1)->GetDlgRuntimeClass(2555), "CMTDepositionItemDlg");
    EXPECT_EQ(deposition->GetItem(1)->CriticalShearStress()->ItemType(), 100152);
}

TEST(Deposition, RoundTripAndSandFractionsStayInUse) {
    auto doc = Load(Module(4,
        " WATER_COLUMN {\n  SAND_FRACTIONS {\n   sand_fraction_description = 1\n  }\n"
        "  DEPOSITION {\n   concentration_profile = 0\n   centroid_height = 0.45\n"
        "   FRACTION_4 {\n    CRITICAL_SHEARSTRESS_FOR_DEPOSITION {\n     constant_value = 0.1\n"
        "    }\n   }\n  }\n }\n"));
    CMTDepositionKiv* deposition = Deposition(*doc);
    EXPECT_EQ(deposition->ConcentrationProfile(), 0);
    EXPECT_EQ(deposition->CentroidHeight(), 0.45);
    EXPECT_EQ(deposition->GetItem(4)->CriticalShearStress()->Constant(), 0.1);
    EXPECT_EQ(deposition->GetItem(3)->CriticalShearStress()->Constant(), 0.07);
    // Every fraction is sand here; deposition still applies to all of them.
    EXPECT_TRUE(Node<CMTSandFractionListKiv>(*doc, {"WATER_COLUMN", "SAND_FRACTIONS"})->IsSand(1));
    for (int i = 1; i <= 4; ++i)
        EXPECT_TRUE(deposition->GetItem(i)->IsDlgUsedInSetup());
    EXPECT_EQ(Load(doc->ToText())->ToText(), doc->ToText());

    // The centroid height is written with the Teeter profile as well.
    deposition->ConcentrationProfile(1);
    auto saved = Saved(*doc);
    const auto* s = Find(*saved, {"MUD_TRANSPORT_MODULE", "WATER_COLUMN", "DEPOSITION"});
    EXPECT_EQ(Double(*s, "centroid_height"), 0.45);
}
