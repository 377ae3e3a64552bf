#include "TestSupport.h"
#include "core/MTSolutionTechniqueKiv.h"
#include "core/MudTransportModuleKiv.h"

#include <gtest/gtest.h>

using namespace testsupport;

namespace {

const std::vector<std::string> kKeywords = {
    "scheme_of_time_integration",         "scheme_of_space_discretization_horizontal",
    "scheme_of_space_discretization_vertical", "method_of_space_discretization_horizontal",
    "integration_method",                 "update_frequency"};

std::vector<int> SavedSchemes(CSetupDocument& doc) {
    auto saved = Saved(doc);
    const paramfile::Section* st = Find(*saved, {"MUD_TRANSPORT_MODULE", "SOLUTION_TECHNIQUE"});
    EXPECT_TRUE(st);
    std::vector<int> values;
    if (st)
        for (const std::string& kw : kKeywords)
            values.push_back(Int(*st, kw));
    return values;
}

TEST(SolutionTechnique, NewSetupWritesSixIntegersInOrderWithTheirDefaults) {
    CSetupDocument doc;
    auto saved = Saved(doc);
    const paramfile::Section* st = Find(*saved, {"MUD_TRANSPORT_MODULE", "SOLUTION_TECHNIQUE"});
    ASSERT_TRUE(st);
    EXPECT_EQ(Entries(*st), kKeywords);
    EXPECT_EQ(SavedSchemes(doc), (std::vector<int>{2, 2, 3, 0, 1, 1}));
}

TEST(SolutionTechnique, ValuesReadAreWrittenBackUnchangedAndMissingOnesKeepDefaults) {
    auto doc = Load(
        "MUD_TRANSPORT_MODULE {\n SOLUTION_TECHNIQUE {\n"
        "  scheme_of_time_integration = 1\n"
        "  scheme_of_space_discretization_vertical = 2\n"
        "  method_of_space_discretization_horizontal = 7\n"
        "  update_frequency = 5\n }\n}\n");
    ASSERT_TRUE(doc);
    // Without the dialog nobody re-derives the vertical scheme: 2 stays 2.
    EXPECT_EQ(SavedSchemes(*doc), (std::vector<int>{1, 2, 2, 7, 1, 5}));
}

TEST(SolutionTechnique, VerticalSchemeFollowsOnlyTheTwoKnownHorizontalSchemes) {
    CSetupDocument doc;
    CMTSolutionTechniqueKiv* st = nullptr;
    POSITION pos = 0;
    for (CZoSEKivBase* c = doc.Module()->GetFirstChild(pos); c && !st; c = doc.Module()->GetNextChild(pos))
        st = dynamic_cast<CMTSolutionTechniqueKiv*>(c);
    ASSERT_TRUE(st);
    st->SpaceVertical(2);
    st->SpaceHorizontal(1);
    st->SyncVerticalScheme();
    EXPECT_EQ(st->SpaceVertical(), 1);
    st->SpaceHorizontal(2);
    st->SyncVerticalScheme();
    EXPECT_EQ(st->SpaceVertical(), 3);
    st->SpaceHorizontal(5);
    st->SpaceVertical(4);
    st->SyncVerticalScheme();
    EXPECT_EQ(st->SpaceVertical(), 4);
    EXPECT_STREQ(st->GetDlgRuntimeClass(kDlgRuntimeClassRequest), "CMTSolutionTechniqueDlg");
    EXPECT_EQ(st->GetDlgRuntimeClass(2556), nullptr);
}

}  // namespace
