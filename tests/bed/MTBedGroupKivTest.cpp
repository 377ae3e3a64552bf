#include "BedTestSupport.h"
#include "bed/MTBedGroupKiv.h"
#include "bed/MTBedRoughnessKiv.h"
#include "bed/MTDensityListKiv.h"
#include "bed/MTErosionListKiv.h"
#include "bed/MTTransitionListKiv.h"

#include <limits>

using namespace testsupport;
using namespace bedtest;

namespace {

CMTBedRoughnessKiv* Roughness(CSetupDocument& doc) {
    return Node<CMTBedRoughnessKiv>(doc, {"BED", "ROUGHNESS"});
}

const char* const kRoughnessMessage =
    "MUD_TRANSPORT_MODULE/BED/ROUGHNESS: Constant value must be larger than or equal to 0.0";

}  // namespace

TEST(MTBedGroupKiv, HoldsItsFourSectionsInFileOrder) {
    auto doc = NewSetup(3);
    CMTBedGroupKiv* bed = Node<CMTBedGroupKiv>(*doc, {"BED"});
    EXPECT_EQ(bed->GetTitle(), "Bed Parameters");
    EXPECT_EQ(bed->GetHelpID(), 5011u);
    EXPECT_TRUE(bed->IsDlgUsedInSetup());
    ASSERT_EQ(bed->GetChildCount(), 4);
    EXPECT_EQ(bed->GetChild(0), bed->Erosion());
    EXPECT_EQ(bed->GetChild(1), bed->Density());
    EXPECT_EQ(bed->GetChild(2), bed->Roughness());
    EXPECT_EQ(bed->GetChild(3), bed->Transition());

    auto saved = Saved(*doc);
    const paramfile::Section* s = Find(*saved, {"MUD_TRANSPORT_MODULE", "BED"});
    ASSERT_NE(s, nullptr);
    EXPECT_EQ(Entries(*s), (std::vector<std::string>{"[EROSION]", "[BED_DENSITY]", "[ROUGHNESS]",
                                                     "[TRANSITION]"}));
    const paramfile::Section* roughness = s->FindSection("ROUGHNESS");
    ExpectConstant(roughness, 0.001);
}

TEST(MTBedGroupKiv, SectionsReadInAnyOrderAreWrittenInFileOrder) {
    auto doc = Load(R"(
MUD_TRANSPORT_MODULE {
    MODEL_DEFINITION {
        number_of_layers = 2
    }
    BED {
        TRANSITION {
            ZoSEKivListItemCount = 1
            include_transition = true
            LAYER_1 {
                constant_value = 0.02
            }
        }
        ROUGHNESS {
            format = 2
            constant_value = 0.05
            file_name = 'rough.qrd2'
            item_numbers = 1
        }
        BED_DENSITY {
            LAYER_2 {
                constant_value = 900.0
            }
        }
        EROSION {
            max_concentration_due_to_erosion = 10.0
        }
    }
}
)");
    CMTBedGroupKiv* bed = Node<CMTBedGroupKiv>(*doc, {"BED"});
    EXPECT_TRUE(bed->Transition()->IncludeTransition());
    EXPECT_EQ(bed->Transition()->GetItem(1)->Transition()->Constant(), 0.02);
    EXPECT_EQ(bed->Roughness()->Roughness()->Format(), 2);
    EXPECT_EQ(bed->Roughness()->Roughness()->Constant(), 0.05);
    EXPECT_EQ(bed->Roughness()->Roughness()->QrdData()->FileName(), "rough.qrd2");
    EXPECT_EQ(bed->Density()->GetItem(2)->Density()->Constant(), 900.0);
    EXPECT_EQ(bed->Erosion()->MaxConcentration(), 10.0);

    auto saved = Saved(*doc);
    const paramfile::Section* s = Find(*saved, {"MUD_TRANSPORT_MODULE", "BED"});
    ASSERT_NE(s, nullptr);
    EXPECT_EQ(Entries(*s), (std::vector<std::string>{"[EROSION]", "[BED_DENSITY]", "[ROUGHNESS]",
                                                     "[TRANSITION]"}));
    const std::string text = doc->ToText();
    EXPECT_EQ(Load(text)->ToText(), text);
}

TEST(MTBedRoughnessKiv, NegativeConstantFailsWhateverTheFormat) {
    auto doc = NewSetup(1);
    CMTBedRoughnessKiv* roughness = Roughness(*doc);

    roughness->Roughness()->Constant(0.0);
    EXPECT_EQ(doc->ValidateAll(), 1);
    EXPECT_TRUE(MessagesUnder(*doc, "MUD_TRANSPORT_MODULE/BED").empty());

    roughness->Roughness()->Constant(-0.001);
    EXPECT_EQ(doc->ValidateAll(), 0);
    EXPECT_EQ(MessagesUnder(*doc, "MUD_TRANSPORT_MODULE/BED"),
              (std::vector<std::string>{kRoughnessMessage}));
    EXPECT_EQ(roughness->Roughness()->Constant(), -0.001);  // left as entered

    // A data file in use does not excuse the constant (and a file that is not there is
    // reported besides).
    roughness->Roughness()->Format(2);
    roughness->Roughness()->QrdData()->FileName("roughness.qrd2");
    EXPECT_EQ(doc->ValidateAll(), 0);
    EXPECT_EQ(MessagesUnder(*doc, "MUD_TRANSPORT_MODULE/BED"),
              (std::vector<std::string>{kRoughnessMessage,
                                        "MUD_TRANSPORT_MODULE/BED/ROUGHNESS: The data file for the "
                                        "value is not valid: roughness.qrd2: the file does not exist"}));
}

TEST(MTBedRoughnessKiv, ConstantThatIsNotANumberFails) {
    auto doc = Load(R"(
MUD_TRANSPORT_MODULE {
    BED {
        ROUGHNESS {
            constant_value = nan
        }
    }
}
)");
    EXPECT_EQ(doc->ValidateAll(), 0);
    EXPECT_EQ(MessagesUnder(*doc, "MUD_TRANSPORT_MODULE/BED"),
              (std::vector<std::string>{kRoughnessMessage}));
    Roughness(*doc)->Roughness()->Constant(std::numeric_limits<double>::infinity());
    EXPECT_EQ(doc->ValidateAll(), 1);
}

TEST(MTBedGroupKiv, EveryNodeNamesItsDialog) {
    auto doc = NewSetup(2);
    CMTBedGroupKiv* bed = Node<CMTBedGroupKiv>(*doc, {"BED"});
    const struct {
        CZoSEKivBase* node;
        const char* title;
        const char* dialog;
    } expected[] = {
        {bed->Erosion(), "Erosion", "CMTErosionListDlg"},
        {bed->Erosion()->GetItem(2), "Layer 2", "CMTErosionItemDlg"},
        {bed->Density(), "Density of Bed Layer", "CMTDensityListDlg"},
        {bed->Density()->GetItem(2), "Layer 2", "CMTDensityItemDlg"},
        {bed->Roughness(), "Bed Roughness", "CMTBedRoughnessDlg"},
        {bed->Transition(), "Transition Between Layers", "CMTTransitionListDlg"},
        {bed->Transition()->GetItem(1), "Between layer 1 and 2", "CMTTransitionItemDlg"},
        {Node<CZoSEKivBase>(*doc, {"MORPHOLOGY"}), "Morphology", "CMTMorphologyDlg"},
    };
    for (const auto& e : expected) {
        SCOPED_TRACE(e.dialog);
        EXPECT_EQ(e.node->GetTitle(), e.title);
        ASSERT_NE(e.node->GetDlgRuntimeClass(2555), nullptr);
        EXPECT_STREQ(e.node->GetDlgRuntimeClass(2555), e.dialog);
        EXPECT_EQ(e.node->GetDlgRuntimeClass(2554), nullptr);
    }
}

TEST(MTBedGroupKiv, NewSetupValidatesWithoutBedMessages) {
    for (int layers : {1, 3, 12}) {
        SCOPED_TRACE(layers);
        auto doc = NewSetup(layers);
        doc->ValidateAll();
        EXPECT_TRUE(MessagesUnder(*doc, "MUD_TRANSPORT_MODULE/BED").empty());
        EXPECT_TRUE(MessagesUnder(*doc, "MUD_TRANSPORT_MODULE/MORPHOLOGY").empty());
    }
}
