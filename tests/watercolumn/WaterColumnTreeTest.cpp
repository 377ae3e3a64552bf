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
