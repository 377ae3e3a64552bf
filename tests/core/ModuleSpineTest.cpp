#include "TestSupport.h"
#include "core/MTCountListKiv.h"
#include "core/MudTransportModuleKiv.h"
#include "core/ParameterSelectionKiv.h"
#include "host/ModuleSelection.h"

#include <gtest/gtest.h>

#include <algorithm>

using namespace testsupport;

namespace {

const char* const kFixedSections[] = {"mode", "[EQUATION]", "[TIME]", "[SPACE]",
                                      "[MODEL_DEFINITION]", "[SOLUTION_TECHNIQUE]",
                                      "[WATER_COLUMN]", "[BED]", "[FORCINGS]"};

TEST(ModuleRoot, FreshSetupWritesModeFixedSectionsThenChildrenInTableOrder) {
    CSetupDocument doc;
    auto saved = Saved(doc);
    const paramfile::Section* module = Find(*saved, {"MUD_TRANSPORT_MODULE"});
    ASSERT_TRUE(module);
    const std::vector<std::string> entries = Entries(*module);
    // Sections still to come may stand between these, but never out of this order.
    auto at = entries.begin();
    for (const char* expected : kFixedSections) {
        at = std::find(at, entries.end(), expected);
        ASSERT_NE(at, entries.end()) << expected << " missing or out of order";
    }
    EXPECT_EQ(entries[0], "mode");
    EXPECT_EQ(entries[1], "[EQUATION]");
    EXPECT_EQ(Int(*module, "mode"), 2);

    EXPECT_EQ(Int(*module->FindSection("EQUATION"), "formulation"), 4);
    const paramfile::Section& time = *module->FindSection("TIME");
    EXPECT_EQ(Entries(time), (std::vector<std::string>{"start_time_step", "time_step_factor"}));
    EXPECT_EQ(Int(time, "start_time_step"), 0);
    EXPECT_EQ(Int(time, "time_step_factor"), 1);
    const paramfile::Section& space = *module->FindSection("SPACE");
    EXPECT_EQ(Entries(space),
              (std::vector<std::string>{"number_of_2D_mesh_geometry", "number_of_2D_mesh_velocity",
                                        "number_of_2D_mesh_concentration",
                                        "number_of_3D_mesh_geometry", "number_of_3D_mesh_velocity",
                                        "number_of_3D_mesh_concentration"}));
    for (int i = 0; i < 3; ++i)
        EXPECT_EQ(Int(space, Entries(space)[i]), 1);
    for (int i = 3; i < 6; ++i)
        EXPECT_EQ(Int(space, Entries(space)[i]), 2);

    const paramfile::Section& model = *module->FindSection("MODEL_DEFINITION");
    EXPECT_EQ(Entries(model), (std::vector<std::string>{"number_of_fractions", "number_of_layers"}));
    const paramfile::Section& st = *module->FindSection("SOLUTION_TECHNIQUE");
    EXPECT_EQ(Int(st, "scheme_of_time_integration"), 2);
    EXPECT_EQ(Int(st, "scheme_of_space_discretization_vertical"), 3);
}

TEST(ModuleRoot, ModeIsReadIntoTheHostAndMissingModeKeepsTheHostsValue) {
    auto doc = Load("MODULE_SELECTION {\n mud_transport_mode = 3\n}\nMUD_TRANSPORT_MODULE {\n}\n");
    EXPECT_EQ(ModuleSelection(doc->Module())->Mode(), 3);
    EXPECT_FALSE(doc->Module()->IsDlgUsedInSetup());

    for (int mode : {0, 1, 2, 3}) {
        auto d = Load("MUD_TRANSPORT_MODULE {\n mode = " + std::to_string(mode) + "\n}\n");
        EXPECT_EQ(d->Module()->IsDlgUsedInSetup(), mode == 2) << mode;
    }
}

TEST(ModuleRoot, FixedSectionsAreWrittenWhateverTheFileHeld) {
    auto doc = Load("MUD_TRANSPORT_MODULE {\n EQUATION {\n formulation = 9\n }\n"
                    " SPACE {\n number_of_3D_mesh_geometry = 7\n }\n}\n");
    auto saved = Saved(*doc);
    EXPECT_EQ(Int(*Find(*saved, {"MUD_TRANSPORT_MODULE", "EQUATION"}), "formulation"), 4);
    EXPECT_EQ(Int(*Find(*saved, {"MUD_TRANSPORT_MODULE", "SPACE"}), "number_of_3D_mesh_geometry"), 2);
}

TEST(ModelDefinition, OutOfRangeCountsGiveExactlyOneMessage) {
    struct Case {
        int fractions, layers;
        bool valid;
    };
    for (Case c : {Case{9, 13, false}, Case{0, 1, false}, Case{1, 0, false}, Case{8, 12, true},
                   Case{1, 1, true}, Case{3, 13, false}}) {
        auto doc = Load("MUD_TRANSPORT_MODULE {\n mode = 2\n MODEL_DEFINITION {\n number_of_fractions = " +
                        std::to_string(c.fractions) + "\n number_of_layers = " +
                        std::to_string(c.layers) + "\n }\n}\n");
        doc->ValidateAll();
        std::vector<std::string> out;
        for (const std::string& m : Messages(*doc))
            if (m.find("MODEL_DEFINITION") != std::string::npos)
                out.push_back(m);
        if (c.valid)
            EXPECT_TRUE(out.empty()) << c.fractions << " " << c.layers;
        else
            EXPECT_EQ(out, (std::vector<std::string>{
                               "MUD_TRANSPORT_MODULE/MODEL_DEFINITION: Values out of range"}))
                << c.fractions << " " << c.layers;
    }
}

TEST(ModelDefinition, MissingSectionKeepsOneAndOne) {
    auto doc = Load("MUD_TRANSPORT_MODULE {\n mode = 2\n}\n");
    EXPECT_EQ(ModelDefinition(doc->Module())->NumberOfFractions(), 1);
    EXPECT_EQ(ModelDefinition(doc->Module())->NumberOfLayers(), 1);
}

TEST(ModelDefinition, HugeCountsAreRefusedWithAWarningAndTheOldCountKept) {
    CSetupDocument::OpenResult r = CSetupDocument::FromText(
        "MUD_TRANSPORT_MODULE {\n MODEL_DEFINITION {\n  number_of_fractions = 2000000000\n"
        "  number_of_layers = -5\n }\n}\n",
        "huge.setup");
    ASSERT_TRUE(r.document);
    EXPECT_EQ(ModelDefinition(r.document->Module())->NumberOfFractions(), 1);
    EXPECT_EQ(ModelDefinition(r.document->Module())->NumberOfLayers(), 1);
    ASSERT_EQ(r.warnings.size(), 2u);
    EXPECT_EQ(r.warnings[0].pos.line, 3);
    EXPECT_EQ(r.warnings[1].pos.line, 4);
}

// Per-fraction and per-layer lists follow the model definition.
class Item : public CZoSEKivBase {
public:
    explicit Item(CZoSEKivBase* parent) : CZoSEKivBase("Fraction %d", "FRACTION_%d", parent) {}
    double value = 1.5;
};

TEST(CountLists, FollowFractionsLayersAndLayerPairs) {
    CSetupDocument doc;
    CParameterSelectionKiv* model = ModelDefinition(doc.Module());
    model->NumberOfFractions(3);
    model->NumberOfLayers(4);
    CMTCountListKiv<Item> fractions("F", "F", doc.Module(), MTCount::Fractions);
    CMTCountListKiv<Item> layers("L", "L", doc.Module(), MTCount::Layers);
    CMTCountListKiv<Item> pairs("P", "P", doc.Module(), MTCount::LayerPairs);
    EXPECT_EQ(fractions.GetItemCount(), 3);
    EXPECT_EQ(layers.GetItemCount(), 4);
    EXPECT_EQ(pairs.GetItemCount(), 3);

    fractions.GetItem(2)->value = 42;
    model->NumberOfFractions(2);
    model->NumberOfLayers(1);
    EXPECT_EQ(fractions.GetItemCount(), 2);
    EXPECT_EQ(fractions.GetItem(2)->value, 42);
    EXPECT_EQ(layers.GetItemCount(), 1);
    EXPECT_EQ(pairs.GetItemCount(), 0);
    model->NumberOfLayers(0);
    EXPECT_EQ(pairs.GetItemCount(), 0);
}

TEST(CountLists, ListenersMayOutliveOrPrecedeTheModelDefinition) {
    // Destroying the document destroys the model definition before later siblings; a list
    // that is still listening must not reach back into it.
    auto doc = std::make_unique<CSetupDocument>();
    auto* list = new CMTCountListKiv<Item>("F", "F", doc->Module(), MTCount::Fractions);
    doc->Module()->AddChild(list);
    ModelDefinition(doc->Module())->NumberOfFractions(2);
    EXPECT_EQ(list->GetItemCount(), 2);
    doc.reset();
}

}  // namespace
