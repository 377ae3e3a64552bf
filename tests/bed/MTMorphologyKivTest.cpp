#include "BedTestSupport.h"
#include "bed/MTMorphologyKiv.h"

#include <algorithm>

using namespace testsupport;
using namespace bedtest;
using paramfile::ParamType;

namespace {

CMTMorphologyKiv* Morphology(CSetupDocument& doc) {
    return Node<CMTMorphologyKiv>(doc, {"MORPHOLOGY"});
}

}  // namespace

TEST(MTMorphologyKiv, NewSetupWritesThreeKeywordsAfterTheBedAndForcings) {
    CSetupDocument doc;
    auto saved = Saved(doc);
    const paramfile::Section* root = Find(*saved, {"MUD_TRANSPORT_MODULE"});
    ASSERT_NE(root, nullptr);
    const std::vector<std::string> entries = Entries(*root);
    auto at = [&](const char* name) {
        return std::find(entries.begin(), entries.end(), name) - entries.begin();
    };
    EXPECT_LT(at("[BED]"), at("[FORCINGS]"));
    EXPECT_LT(at("[FORCINGS]"), at("[MORPHOLOGY]"));
    EXPECT_LT(at("[MORPHOLOGY]"), static_cast<long>(entries.size()));
    if (at("[OUTPUTS]") < static_cast<long>(entries.size())) {
        EXPECT_LT(at("[MORPHOLOGY]"), at("[OUTPUTS]"));
    }

    const paramfile::Section* morphology = root->FindSection("MORPHOLOGY");
    ASSERT_NE(morphology, nullptr);
    EXPECT_EQ(Entries(*morphology),
              (std::vector<std::string>{"include_morphological_update", "include_speedup",
                                        "speedup_factor"}));
    EXPECT_EQ(TypeOf(*morphology, "include_morphological_update"), ParamType::Boolean);
    EXPECT_EQ(TypeOf(*morphology, "include_speedup"), ParamType::Boolean);
    EXPECT_EQ(TypeOf(*morphology, "speedup_factor"), ParamType::Double);
    EXPECT_FALSE(Bool(*morphology, "include_morphological_update"));
    EXPECT_FALSE(Bool(*morphology, "include_speedup"));
    EXPECT_EQ(Double(*morphology, "speedup_factor"), 1.0);
}

TEST(MTMorphologyKiv, FlagsLoadAsStoredEvenWhenTheyContradictEachOther) {
    auto doc = Load(R"(
MUD_TRANSPORT_MODULE {
    MORPHOLOGY {
        include_morphological_update = false
        include_speedup = true
    }
}
)");
    CMTMorphologyKiv* m = Morphology(*doc);
    EXPECT_FALSE(m->IncludeMorphologicalUpdate());
    EXPECT_TRUE(m->IncludeSpeedup());
    EXPECT_EQ(m->SpeedupFactor(), 1.0);  // missing: the default stays
    auto saved = Saved(*doc);
    const paramfile::Section* s = Find(*saved, {"MUD_TRANSPORT_MODULE", "MORPHOLOGY"});
    ASSERT_NE(s, nullptr);
    EXPECT_FALSE(Bool(*s, "include_morphological_update"));
    EXPECT_TRUE(Bool(*s, "include_speedup"));
}

TEST(MTMorphologyKiv, AnyFactorIsAcceptedAndKept) {
    for (double factor : {0.0, -2.5}) {
        SCOPED_TRACE(factor);
        CSetupDocument doc;
        CMTMorphologyKiv* m = Morphology(doc);
        m->IncludeMorphologicalUpdate(true);
        m->IncludeSpeedup(true);
        m->SpeedupFactor(factor);
        EXPECT_EQ(m->Validate(), 1);
        EXPECT_TRUE(doc.Errors().empty());

        const std::string text = doc.ToText();
        auto again = Load(text);
        EXPECT_EQ(again->ToText(), text);
        EXPECT_EQ(Morphology(*again)->SpeedupFactor(), factor);
        EXPECT_TRUE(Morphology(*again)->IncludeSpeedup());
        EXPECT_TRUE(Morphology(*again)->IncludeMorphologicalUpdate());
    }
}

TEST(MTMorphologyKiv, FactorIsWrittenAsAFloat) {
    CSetupDocument doc;
    Morphology(doc)->SpeedupFactor(1.0 / 3.0);
    auto saved = Saved(doc);
    const paramfile::Section* s = Find(*saved, {"MUD_TRANSPORT_MODULE", "MORPHOLOGY"});
    ASSERT_NE(s, nullptr);
    EXPECT_EQ(Double(*s, "speedup_factor"), 0.33333334);
    EXPECT_EQ(Morphology(doc)->SpeedupFactor(), 1.0 / 3.0);  // the model is not narrowed
}
