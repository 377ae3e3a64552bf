#include "BedTestSupport.h"
#include "bed/MTErosionListKiv.h"

using namespace testsupport;
using namespace bedtest;
using paramfile::ParamType;

namespace {

CMTErosionListKiv* Erosion(CSetupDocument& doc) {
    return Node<CMTErosionListKiv>(doc, {"BED", "EROSION"});
}

struct LayerExpectation {
    const char* title;
    bool soft;
    double shearStress;
    double power;
};

void ExpectLayers(CMTErosionListKiv* list, const std::vector<LayerExpectation>& layers) {
    ASSERT_EQ(list->GetItemCount(), static_cast<int>(layers.size()));
    for (size_t i = 0; i < layers.size(); ++i) {
        SCOPED_TRACE(layers[i].title);
        CMTErosionItemKiv* item = list->GetItem(static_cast<int>(i + 1));
        EXPECT_EQ(item->GetTitle(), layers[i].title);
        EXPECT_EQ(item->SoftMud(), layers[i].soft);
        EXPECT_EQ(item->DescriptionText(), layers[i].soft ? "Soft mud" : "Hard mud");
        EXPECT_EQ(item->CriticalShearStress()->Constant(), layers[i].shearStress);
        EXPECT_EQ(item->PowerOfErosion(), layers[i].power);
    }
}

const char* const kTwoLayers = R"(
MUD_TRANSPORT_MODULE {
    MODEL_DEFINITION {
        number_of_layers = 2
    }
    BED {
        EROSION {
            ZoSEKivListItemCount = 2
            max_concentration_due_to_erosion = 75.5
            LAYER_1 {
                description = 1
                POWER_OF_EROSION {
                    constant_value = 5.0
                }
            }
            LAYER_2 {
                description = 2
            }
        }
    }
}
)";

}  // namespace

TEST(MTErosionListKiv, NewSetupWritesEveryLayerWithItsDefaults) {
    auto doc = NewSetup(3);
    auto saved = Saved(*doc);
    const paramfile::Section* erosion = Find(*saved, {"MUD_TRANSPORT_MODULE", "BED", "EROSION"});
    ASSERT_NE(erosion, nullptr);
    EXPECT_EQ(Entries(*erosion),
              (std::vector<std::string>{"ZoSEKivListItemCount", "max_concentration_due_to_erosion",
                                        "[LAYER_1]", "[LAYER_2]", "[LAYER_3]"}));
    EXPECT_EQ(Int(*erosion, "ZoSEKivListItemCount"), 3);
    EXPECT_EQ(TypeOf(*erosion, "max_concentration_due_to_erosion"), ParamType::Double);
    EXPECT_EQ(Double(*erosion, "max_concentration_due_to_erosion"), 50.0);

    const struct {
        int description;
        double shearStress;
        double power;
    } expected[] = {{1, 0.1, 8.3}, {0, 0.25, 1.0}, {0, 0.4, 1.0}};
    for (int n = 1; n <= 3; ++n) {
        SCOPED_TRACE(n);
        const paramfile::Section* layer = erosion->FindSection("LAYER_" + std::to_string(n));
        ASSERT_NE(layer, nullptr);
        EXPECT_EQ(Entries(*layer),
                  (std::vector<std::string>{"description", "[EROSION_COEFFICIENT]",
                                            "[CRITICAL_SHEARSTRESS_FOR_EROSION]",
                                            "[POWER_OF_EROSION]"}));
        EXPECT_EQ(TypeOf(*layer, "description"), ParamType::Integer);
        EXPECT_EQ(Int(*layer, "description"), expected[n - 1].description);
        ExpectConstant(layer->FindSection("EROSION_COEFFICIENT"), 0.00005);
        ExpectConstant(layer->FindSection("CRITICAL_SHEARSTRESS_FOR_EROSION"),
                       expected[n - 1].shearStress);
        ExpectConstant(layer->FindSection("POWER_OF_EROSION"), expected[n - 1].power);
    }
}

TEST(MTErosionListKiv, GrowingTakesTheDefaultsOfTheNewLayersAndKeepsTheOldOnes) {
    auto doc = NewSetup(1);
    CMTErosionListKiv* list = Erosion(*doc);
    list->GetItem(1)->CriticalShearStress()->Constant(0.7);
    list->GetItem(1)->PowerOfErosion(6.0);

    SetLayers(*doc, 3);
    ExpectLayers(list, {{"Layer 1", true, 0.7, 6.0},
                        {"Layer 2", false, 0.25, 1.0},
                        {"Layer 3", false, 0.4, 1.0}});

    SetLayers(*doc, 5);
    ExpectLayers(list, {{"Layer 1", true, 0.7, 6.0},
                        {"Layer 2", false, 0.25, 1.0},
                        {"Layer 3", false, 0.4, 1.0},
                        {"Layer 4", false, 0.4, 1.0},
                        {"Layer 5", false, 0.4, 1.0}});
    for (int i = 1; i <= 5; ++i)
        EXPECT_EQ(list->GetItem(i)->ErosionCoefficient()->Constant(), 0.00005);

    // Shrinking drops layers from the end; growing again creates them afresh.
    list->GetItem(2)->SoftMud(true);
    SetLayers(*doc, 2);
    ASSERT_EQ(list->GetItemCount(), 2);
    EXPECT_TRUE(list->GetItem(2)->SoftMud());
    SetLayers(*doc, 3);
    EXPECT_EQ(list->GetItem(3)->GetTitle(), "Layer 3");
    EXPECT_FALSE(list->GetItem(3)->SoftMud());

    // Resetting gives every item the defaults of its own layer.
    list->ReInitialize(1, true);
    ExpectLayers(list, {{"Layer 1", true, 0.1, 8.3},
                        {"Layer 2", false, 0.25, 1.0},
                        {"Layer 3", false, 0.4, 1.0}});
}

TEST(MTErosionListKiv, MudTypeSwitchReplacesThePowerButLoadingKeepsIt) {
    auto doc = Load(kTwoLayers);
    CMTErosionListKiv* list = Erosion(*doc);
    ASSERT_EQ(list->GetItemCount(), 2);
    EXPECT_EQ(list->MaxConcentration(), 75.5);

    CMTErosionItemKiv* soft = list->GetItem(1);
    EXPECT_TRUE(soft->SoftMud());
    EXPECT_EQ(soft->PowerOfErosion(), 5.0);  // stored power, not the soft-mud 8.3

    // "description" 2 is not 1: hard mud, written back as 0.
    CMTErosionItemKiv* hard = list->GetItem(2);
    EXPECT_FALSE(hard->SoftMud());
    auto saved = Saved(*doc);
    const paramfile::Section* erosion = Find(*saved, {"MUD_TRANSPORT_MODULE", "BED", "EROSION"});
    ASSERT_NE(erosion, nullptr);
    EXPECT_EQ(Int(*erosion->FindSection("LAYER_2"), "description"), 0);
    EXPECT_EQ(Double(*erosion->FindSection("LAYER_1")->FindSection("POWER_OF_EROSION"),
                     "constant_value"),
              5.0);

    // Choosing the type already set leaves a typed power alone; a real switch replaces it.
    soft->SoftMud(true);
    EXPECT_EQ(soft->PowerOfErosion(), 5.0);
    hard->PowerOfErosion(3.0);
    hard->SoftMud(true);
    EXPECT_EQ(hard->PowerOfErosion(), 8.3);
    hard->PowerOfErosion(4.0);
    hard->SoftMud(false);
    EXPECT_EQ(hard->PowerOfErosion(), 1.0);
}

TEST(MTErosionListKiv, MissingKeywordsKeepTheLayerDefaults) {
    auto doc = Load(R"(
MUD_TRANSPORT_MODULE {
    MODEL_DEFINITION {
        number_of_layers = 2
    }
    BED {
        EROSION {
            LAYER_2 {
                EROSION_COEFFICIENT {
                    constant_value = 0.002
                }
            }
        }
    }
}
)");
    CMTErosionListKiv* list = Erosion(*doc);
    EXPECT_EQ(list->MaxConcentration(), 50.0);
    ExpectLayers(list, {{"Layer 1", true, 0.1, 8.3}, {"Layer 2", false, 0.25, 1.0}});
    EXPECT_EQ(list->GetItem(2)->ErosionCoefficient()->Constant(), 0.002);
}

TEST(MTErosionListKiv, ZeroLayersLeaveEveryLayerListEmpty) {
    auto doc = Load("MUD_TRANSPORT_MODULE {\n MODEL_DEFINITION {\n number_of_layers = 0\n }\n}\n");
    EXPECT_EQ(Erosion(*doc)->GetItemCount(), 0);
    auto saved = Saved(*doc);
    const paramfile::Section* bed = Find(*saved, {"MUD_TRANSPORT_MODULE", "BED"});
    ASSERT_NE(bed, nullptr);
    const struct {
        const char* section;
        std::vector<std::string> entries;
    } expected[] = {
        {"EROSION", {"ZoSEKivListItemCount", "max_concentration_due_to_erosion"}},
        {"BED_DENSITY", {"ZoSEKivListItemCount"}},
        {"TRANSITION", {"ZoSEKivListItemCount", "include_transition"}},
    };
    for (const auto& e : expected) {
        SCOPED_TRACE(e.section);
        const paramfile::Section* s = bed->FindSection(e.section);
        ASSERT_NE(s, nullptr);
        EXPECT_EQ(Entries(*s), e.entries);
        EXPECT_EQ(Int(*s, "ZoSEKivListItemCount"), 0);
    }
}

TEST(MTErosionListKiv, EveryEditedValueSurvivesSaveAndLoad) {
    auto doc = NewSetup(3);
    CMTErosionListKiv* list = Erosion(*doc);
    list->MaxConcentration(12.25);
    list->GetItem(1)->SoftMud(false);
    list->GetItem(1)->PowerOfErosion(2.5);
    list->GetItem(2)->SoftMud(true);
    list->GetItem(2)->PowerOfErosion(-0.33);
    CFemInDataKiv* coefficient = list->GetItem(3)->ErosionCoefficient();
    coefficient->Format(2);
    coefficient->Constant(1e-7);
    coefficient->QrdData()->FileName("data\\erosion 'coef'.qrd2");
    coefficient->QrdData()->ItemNumbers({2, 4});
    coefficient->QrdData()->ItemName("coefficient");
    list->GetItem(3)->CriticalShearStress()->Constant(0.1 + 0.2);

    const std::string text = doc->ToText();
    auto again = Load(text);
    EXPECT_EQ(again->ToText(), text);

    CMTErosionListKiv* read = Erosion(*again);
    EXPECT_EQ(read->MaxConcentration(), 12.25);
    // The limit is written as a float.
    list->MaxConcentration(1.0 / 3.0);
    auto saved = Saved(*doc);
    const paramfile::Section* erosion = Find(*saved, {"MUD_TRANSPORT_MODULE", "BED", "EROSION"});
    ASSERT_NE(erosion, nullptr);
    EXPECT_EQ(Double(*erosion, "max_concentration_due_to_erosion"), 0.33333334);
    EXPECT_FALSE(read->GetItem(1)->SoftMud());
    EXPECT_EQ(read->GetItem(1)->PowerOfErosion(), 2.5);
    EXPECT_TRUE(read->GetItem(2)->SoftMud());
    EXPECT_EQ(read->GetItem(2)->PowerOfErosion(), -0.33);
    EXPECT_EQ(read->GetItem(3)->CriticalShearStress()->Constant(), 0.1 + 0.2);
    const CFemInDataKiv* c = read->GetItem(3)->ErosionCoefficient();
    EXPECT_EQ(c->Format(), 2);
    EXPECT_EQ(c->QrdData()->FileName(), "data\\erosion 'coef'.qrd2");
    EXPECT_EQ(c->QrdData()->ItemNumbers(), (std::vector<int>{2, 4}));
}

TEST(MTErosionListKiv, ValuesOutOfPhysicalRangeAreAccepted) {
    auto doc = NewSetup(2);
    CMTErosionListKiv* list = Erosion(*doc);
    list->MaxConcentration(-1.0);
    list->GetItem(2)->PowerOfErosion(-8.0);
    list->GetItem(2)->CriticalShearStress()->Constant(-0.5);
    EXPECT_EQ(list->Validate(), 1);
    EXPECT_TRUE(doc->Errors().empty());
}
