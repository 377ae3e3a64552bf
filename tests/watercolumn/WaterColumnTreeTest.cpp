#include "WaterColumnTestSupport.h"

#include <algorithm>

using namespace testsupport;
using namespace wctest;

TEST(WaterColumnTree, SectionsSitInFileOrder) {
    auto doc = NewSetup(1);
    auto saved = Saved(*doc);
    const auto* wc = Find(*saved, {"MUD_TRANSPORT_MODULE", "WATER_COLUMN"});
    ASSERT_NE(wc, nullptr);
    EXPECT_EQ(Entries(*wc), (std::vector<std::string>{"[SAND_FRACTIONS]", "[SETTLING_VELOCITY]",
                                                      "[DEPOSITION]", "[DENSITY_AND_VISCOSITY]"}));
    const auto* root = Find(*saved, {"MUD_TRANSPORT_MODULE"});
    const std::vector<std::string> entries = Entries(*root);
    const auto at = [&](const char* name) {
        return std::find(entries.begin(), entries.end(), name) - entries.begin();
    };
    EXPECT_LT(at("[FORCINGS]"), at("[DISPERSION]"));
    EXPECT_LT(at("[DISPERSION]"), at("[MORPHOLOGY]"));
    EXPECT_LT(at("[MORPHOLOGY]"), static_cast<long>(entries.size()));
}

TEST(WaterColumnTree, EveryNodeNamesItsDialogAndTitlesAreThoseShown) {
    auto doc = NewSetup(2);
    const std::pair<std::initializer_list<std::string_view>, const char*> expected[] = {
        {{"WATER_COLUMN", "SAND_FRACTIONS"}, "Sand Fractions"},
        {{"WATER_COLUMN", "SETTLING_VELOCITY"}, "Settling"},
        {{"WATER_COLUMN", "DEPOSITION"}, "Deposition"},
        {{"WATER_COLUMN", "DENSITY_AND_VISCOSITY"}, "Viscosity and Density"},
        {{"DISPERSION", "HORIZONTAL_DISPERSION"}, "Horizontal Dispersion"},
    };
    for (const auto& [path, title] : expected)
        EXPECT_EQ(Node<CZoSEKivBase>(*doc, path)->GetTitle(), title);

    // Groups, sections and the items that have dialogs of their own name them.
    std::vector<CZoSEKivBase*> nodes;
    Collect(Node<CZoSEKivBase>(*doc, {"WATER_COLUMN"}), nodes);
    Collect(Node<CZoSEKivBase>(*doc, {"DISPERSION"}), nodes);
    int named = 0;
    for (CZoSEKivBase* n : nodes)
        named += n->GetDlgRuntimeClass(2555) ? 1 : 0;
    // 2 groups, 4 sections, 2 settling + 2 deposition items, 2 dispersion lists and 4 items.
    EXPECT_EQ(named, 16);
}
