#include "BedTestSupport.h"
#include "bed/MTDensityListKiv.h"

using namespace testsupport;
using namespace bedtest;

namespace {

CMTDensityListKiv* Density(CSetupDocument& doc) {
    return Node<CMTDensityListKiv>(doc, {"BED", "BED_DENSITY"});
}

std::vector<double> Densities(CMTDensityListKiv* list) {
    std::vector<double> out;
    for (int i = 1; i <= list->GetItemCount(); ++i)
        out.push_back(list->GetItem(i)->Density()->Constant());
    return out;
}

}  // namespace

TEST(MTDensityListKiv, NewSetupWritesOneDensityPerLayerStraightIntoTheLayerSection) {
    auto doc = NewSetup(3);
    auto saved = Saved(*doc);
    const paramfile::Section* density =
        Find(*saved, {"MUD_TRANSPORT_MODULE", "BED", "BED_DENSITY"});
    ASSERT_NE(density, nullptr);
    EXPECT_EQ(Entries(*density), (std::vector<std::string>{"ZoSEKivListItemCount", "[LAYER_1]",
                                                           "[LAYER_2]", "[LAYER_3]"}));
    EXPECT_EQ(Int(*density, "ZoSEKivListItemCount"), 3);
    ExpectConstant(density->FindSection("LAYER_1"), 180.0);
    ExpectConstant(density->FindSection("LAYER_2"), 300.0);
    ExpectConstant(density->FindSection("LAYER_3"), 450.0);
}

TEST(MTDensityListKiv, LayerDefaultsFollowTheNumberOfLayers) {
    auto doc = NewSetup(4);
    CMTDensityListKiv* list = Density(*doc);
    EXPECT_EQ(Densities(list), (std::vector<double>{180.0, 300.0, 450.0, 600.0}));
    EXPECT_EQ(list->GetItem(4)->GetTitle(), "Layer 4");

    list->GetItem(2)->Density()->Constant(333.0);
    SetLayers(*doc, 5);
    EXPECT_EQ(Densities(list), (std::vector<double>{180.0, 333.0, 450.0, 600.0, 600.0}));
    SetLayers(*doc, 2);
    EXPECT_EQ(Densities(list), (std::vector<double>{180.0, 333.0}));
    SetLayers(*doc, 3);
    EXPECT_EQ(Densities(list), (std::vector<double>{180.0, 333.0, 450.0}));

    auto one = NewSetup(1);
    SetLayers(*one, 5);
    EXPECT_EQ(Densities(Density(*one)),
              (std::vector<double>{180.0, 300.0, 450.0, 600.0, 600.0}));
}

TEST(MTDensityListKiv, ValuesAndDataFilesSurviveSaveAndLoad) {
    auto doc = NewSetup(2);
    CMTDensityListKiv* list = Density(*doc);
    list->GetItem(1)->Density()->Constant(1234.5);
    CFemInDataKiv* second = list->GetItem(2)->Density();
    second->Format(2);
    second->QrdData()->FileName("bed\\density.qrd2");
    second->QrdData()->ItemNumbers({3});
    EXPECT_EQ(list->GetItem(1)->FormatText(), "Constant 1234.5 kg/m^3");

    const std::string text = doc->ToText();
    auto again = Load(text);
    EXPECT_EQ(again->ToText(), text);
    CMTDensityListKiv* read = Density(*again);
    EXPECT_EQ(read->GetItem(1)->Density()->Constant(), 1234.5);
    EXPECT_EQ(read->GetItem(2)->Density()->Format(), 2);
    EXPECT_EQ(read->GetItem(2)->Density()->QrdData()->FileName(), "bed\\density.qrd2");
    EXPECT_EQ(read->GetItem(2)->FormatText(), second->FormatText());
}
