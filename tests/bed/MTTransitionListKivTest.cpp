#include "BedTestSupport.h"
#include "bed/MTTransitionListKiv.h"

using namespace testsupport;
using namespace bedtest;
using paramfile::ParamType;

namespace {

CMTTransitionListKiv* Transition(CSetupDocument& doc) {
    return Node<CMTTransitionListKiv>(doc, {"BED", "TRANSITION"});
}

std::vector<std::string> Titles(CMTTransitionListKiv* list) {
    std::vector<std::string> out;
    for (int i = 1; i <= list->GetItemCount(); ++i)
        out.push_back(list->GetItem(i)->GetTitle());
    return out;
}

}  // namespace

TEST(MTTransitionListKiv, OneTransitionPerPairOfNeighbouringLayers) {
    auto doc = NewSetup(1);
    CMTTransitionListKiv* list = Transition(*doc);
    EXPECT_EQ(list->GetItemCount(), 0);
    EXPECT_FALSE(list->IsDlgUsedInSetup());

    SetLayers(*doc, 3);
    EXPECT_EQ(Titles(list),
              (std::vector<std::string>{"Between layer 1 and 2", "Between layer 2 and 3"}));
    EXPECT_TRUE(list->IsDlgUsedInSetup());
    list->GetItem(1)->Transition()->Constant(0.5);

    SetLayers(*doc, 5);
    EXPECT_EQ(Titles(list).back(), "Between layer 4 and 5");
    EXPECT_EQ(list->GetItem(4)->Transition()->Constant(), 0.001);

    SetLayers(*doc, 2);
    EXPECT_EQ(Titles(list), (std::vector<std::string>{"Between layer 1 and 2"}));
    EXPECT_EQ(list->GetItem(1)->Transition()->Constant(), 0.5);

    SetLayers(*doc, 0);
    EXPECT_EQ(list->GetItemCount(), 0);
    SetLayers(*doc, -4);
    EXPECT_EQ(list->GetItemCount(), 0);
}

TEST(MTTransitionListKiv, NewSetupWritesTheFlagAndLayersMinusOneItems) {
    auto doc = NewSetup(3);
    auto saved = Saved(*doc);
    const paramfile::Section* transition =
        Find(*saved, {"MUD_TRANSPORT_MODULE", "BED", "TRANSITION"});
    ASSERT_NE(transition, nullptr);
    EXPECT_EQ(Entries(*transition),
              (std::vector<std::string>{"ZoSEKivListItemCount", "include_transition", "[LAYER_1]",
                                        "[LAYER_2]"}));
    EXPECT_EQ(Int(*transition, "ZoSEKivListItemCount"), 2);
    EXPECT_EQ(TypeOf(*transition, "include_transition"), ParamType::Boolean);
    EXPECT_FALSE(Bool(*transition, "include_transition"));
    ExpectConstant(transition->FindSection("LAYER_1"), 0.001);
    ExpectConstant(transition->FindSection("LAYER_2"), 0.001);

    auto single = Saved(*NewSetup(1));
    transition = Find(*single, {"MUD_TRANSPORT_MODULE", "BED", "TRANSITION"});
    ASSERT_NE(transition, nullptr);
    EXPECT_EQ(Entries(*transition),
              (std::vector<std::string>{"ZoSEKivListItemCount", "include_transition"}));
    EXPECT_EQ(Int(*transition, "ZoSEKivListItemCount"), 0);
}

TEST(MTTransitionListKiv, ExcludedTransitionsAreStillWrittenAndRead) {
    auto doc = NewSetup(3);
    CMTTransitionListKiv* list = Transition(*doc);
    EXPECT_FALSE(list->GetItem(1)->IsDlgUsedInSetup());
    list->GetItem(2)->Transition()->Constant(0.25);

    const std::string excluded = doc->ToText();
    auto again = Load(excluded);
    EXPECT_EQ(again->ToText(), excluded);
    EXPECT_FALSE(Transition(*again)->IncludeTransition());
    EXPECT_EQ(Transition(*again)->GetItem(2)->Transition()->Constant(), 0.25);

    list->IncludeTransition(true);
    EXPECT_TRUE(list->GetItem(1)->IsDlgUsedInSetup());
    const std::string included = doc->ToText();
    auto third = Load(included);
    EXPECT_EQ(third->ToText(), included);
    EXPECT_TRUE(Transition(*third)->IncludeTransition());
    EXPECT_TRUE(Transition(*third)->GetItem(2)->IsDlgUsedInSetup());
}
