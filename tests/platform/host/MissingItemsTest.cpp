// Items that a list's count promises but the file lacks: one warning per count, at the count,
// however many are missing; nothing is dropped.
#include "TestSupport.h"

#include <gtest/gtest.h>

#include <string>

using namespace testsupport;

namespace {

std::string Module(const std::string& inside, int fractions = 2, int layers = 2) {
    return "MUD_TRANSPORT_MODULE {\n    MODEL_DEFINITION {\n        number_of_fractions = " +
           std::to_string(fractions) + "\n        number_of_layers = " + std::to_string(layers) +
           "\n    }\n" + inside + "}\n";
}

std::string Boundaries(int count, const std::string& present) {
    return "DOMAIN {\n    BOUNDARY_NAMES {\n        ZoSEKivListItemCount = " + std::to_string(count) +
           "\n" + present + "    }\n}\n";
}

struct Case {
    const char* name;
    std::string text;
    int line;               // of the count that the warning points to; 0: no warning
    const char* warning;
};

TEST(MissingItems, OneWarningPerCountAtTheCount) {
    const Case cases[] = {
        {"per fraction",
         Module("    WATER_COLUMN {\n        SETTLING_VELOCITY {\n            ZoSEKivListItemCount = 2\n"
                "            FRACTION_2 {\n            }\n        }\n    }\n"),
         8, "1 of 2 sections is missing (FRACTION_1); those items take their defaults"},
        {"per layer, none present",
         Module("    BED {\n        BED_DENSITY {\n            ZoSEKivListItemCount = 2\n        }\n    }\n"),
         8, "2 of 2 sections are missing (LAYER_1, LAYER_2)"},
        {"a section gives no count", Module("    BED {\n        BED_DENSITY {\n        }\n    }\n"), 0,
         nullptr},
        {"all present",
         Module("    BED {\n        BED_DENSITY {\n            ZoSEKivListItemCount = 1\n"
                "            LAYER_1 {\n            }\n        }\n    }\n",
                2, 1),
         0, nullptr},
        // The list's own count has the last word, and the warning stands at it.
        {"dredgers",
         Module("    DREDGING {\n        ZoSEKivListItemCount = 3\n        number_of_dredgers = 3\n"
                "        DREDGER_2 {\n            weights_fraction = 50.0, 50.0\n        }\n    }\n"),
         8, "2 of 3 sections are missing (DREDGER_1, DREDGER_3)"},
        {"boundary values of the module",
         Boundaries(1, "        BOUNDARY_1 {\n        }\n") +
             Module("    BOUNDARY_CONDITIONS {\n        ZoSEKivListItemCount = 1\n        BOUNDARY_1 {\n"
                    "            ZoSEKivListItemCount = 2\n            SSC_FRACTION_2 {\n            }\n"
                    "        }\n    }\n"),
         16, "1 of 2 sections is missing (SSC_FRACTION_1)"},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.name);
        CSetupDocument::OpenResult r = CSetupDocument::FromText(c.text, "case.setup");
        ASSERT_TRUE(r.document);
        if (!c.warning) {
            EXPECT_TRUE(r.warnings.empty()) << r.warnings.front().ToString();
            continue;
        }
        ASSERT_EQ(r.warnings.size(), 1u) << r.warnings.front().ToString();
        EXPECT_EQ(r.warnings[0].pos.line, c.line) << r.warnings[0].ToString();
        EXPECT_NE(r.warnings[0].message.find(c.warning), std::string::npos) << r.warnings[0].message;
        // Nothing was dropped: the missing items are there with their defaults.
        EXPECT_TRUE(r.document->DroppedOnSave().empty());
    }
}

}  // namespace
