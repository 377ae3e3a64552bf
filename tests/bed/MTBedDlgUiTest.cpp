#include "BedUiTestSupport.h"
#include "bed/MTBedRoughnessKiv.h"
#include "bed/MTDensityGrid.h"
#include "bed/MTDensityListKiv.h"
#include "bed/MTMorphologyKiv.h"
#include "bed/MTTransitionListKiv.h"
#include "widgets/FemInDataDlg.h"
#include "widgets/ZoNumberEdit.h"

#include <QCheckBox>
#include <QLabel>

using namespace bedtest;
using namespace uitest;

TEST(BedDialogs, EveryBedNodeOpensItsDialogWithItsHelpTopic) {
    auto doc = NewSetup(2);
    const struct {
        std::initializer_list<std::string_view> path;
        unsigned long helpId;
    } nodes[] = {
        {{"BED"}, 5011},
        {{"BED", "EROSION"}, 5027},
        {{"BED", "EROSION", "LAYER_2"}, 5026},
        {{"BED", "BED_DENSITY"}, 5018},
        {{"BED", "BED_DENSITY", "LAYER_1"}, 5017},
        {{"BED", "ROUGHNESS"}, 5012},
        {{"BED", "TRANSITION"}, 5043},
        {{"BED", "TRANSITION", "LAYER_1"}, 5042},
        {{"MORPHOLOGY"}, 5029},
    };
    for (const auto& n : nodes) {
        CRecordingHost host;
        auto dlg = OpenDialog(FindNode(doc->Module(), n.path), host);
        ASSERT_NE(dlg, nullptr);
        dlg->ShowHelp();
        EXPECT_EQ(host.helpIds, (std::vector<unsigned long>{n.helpId})) << n.helpId;
        EXPECT_TRUE(host.hints.empty()) << "opening a dialog changes nothing";
    }
}

TEST(BedDialogs, ValueDialogsStoreIntoTheirOwnValue) {
    auto doc = NewSetup(3);
    auto* roughness = Node<CMTBedRoughnessKiv>(*doc, {"BED", "ROUGHNESS"});
    auto* density = Node<CMTDensityListKiv>(*doc, {"BED", "BED_DENSITY"});
    auto* transition = Node<CMTTransitionListKiv>(*doc, {"BED", "TRANSITION"});
    const struct {
        CZoSEKivBase* node;
        CFemInDataKiv* value;
        const char* shown; // the default, as the form shows it
    } cases[] = {
        {roughness, roughness->Roughness(), "0.001"},
        {density->GetItem(2), density->GetItem(2)->Density(), "300"},
        {transition->GetItem(2), transition->GetItem(2)->Transition(), "0.001"},
    };
    for (const auto& c : cases) {
        CRecordingHost host;
        auto dlg = OpenDialog(c.node, host);
        auto* forms = Child<CSubFormCollection>(dlg.get(), "subForms");
        ASSERT_TRUE(forms && forms->Count() == 1);
        CZoNumberEdit* constant = forms->SubForm(0)->ConstantEdit();
        EXPECT_TRUE(constant->isVisible());
        EXPECT_EQ(constant->text(), c.shown);
        Enter(constant, "0.02");
        EXPECT_EQ(c.value->Constant(), 0.02) << c.node->GetTitle();
        EXPECT_EQ(host.hints, (std::vector<int>{1}));
    }
    // Only the value edited changed.
    EXPECT_EQ(density->GetItem(1)->Density()->Constant(), 180.0);
    EXPECT_EQ(transition->GetItem(1)->Transition()->Constant(), 0.001);
}

TEST(MTDensityListDlg, GridShowsEachLayersFormatAndLinksToIt) {
    auto doc = NewSetup(3);
    auto* list = Node<CMTDensityListKiv>(*doc, {"BED", "BED_DENSITY"});
    list->GetItem(2)->Density()->Format(2);
    list->GetItem(2)->Density()->QrdData()->FileName("bed.qrd2");
    CRecordingHost host;
    auto dlg = OpenDialog(list, host);
    auto* grid = Child<CMTDensityGrid>(dlg.get(), "grid");
    ASSERT_NE(grid, nullptr);
    EXPECT_EQ(RowTexts(grid, 0), (std::vector<std::string>{"Layer", "Format", "Edit"}));
    EXPECT_EQ(RowTexts(grid, 1), (std::vector<std::string>{"Layer 1", "Constant 180 kg/m^3", "Go to..."}));
    EXPECT_EQ(RowTexts(grid, 2),
              (std::vector<std::string>{"Layer 2", "Varying in domain: bed.qrd2", "Go to..."}));
    EXPECT_TRUE(grid->CellStyle(2, 1).readOnly);

    ClickCell(grid, 2, 2);
    EXPECT_EQ(host.selected, (std::vector<CZoSEKivBase*>{list->GetItem(2)}));
    EXPECT_TRUE(host.hints.empty());
}

namespace {

struct MorphologyControls {
    QCheckBox* include;
    QCheckBox* speedup;
    QLabel* label;
    CZoNumberEdit* factor;
};

MorphologyControls Controls(QWidget* dlg) {
    return {Child<QCheckBox>(dlg, "includeMorphologicalUpdate"),
            Child<QCheckBox>(dlg, "applySpeedup"), Child<QLabel>(dlg, "speedupFactorLabel"),
            Child<CZoNumberEdit>(dlg, "speedupFactor")};
}

} // namespace

TEST(MTMorphologyDlg, SpeedupIsEnabledOnlyWithTheMorphologicalUpdate) {
    auto doc = NewSetup(1);
    auto* morphology = Node<CMTMorphologyKiv>(*doc, {"MORPHOLOGY"});
    CRecordingHost host;
    auto dlg = OpenDialog(morphology, host);
    const MorphologyControls c = Controls(dlg.get());
    EXPECT_FALSE(c.include->isChecked());
    EXPECT_FALSE(c.speedup->isEnabled());
    EXPECT_FALSE(c.label->isEnabled());
    EXPECT_FALSE(c.factor->isEnabled());

    ClickButton(c.include);
    EXPECT_TRUE(morphology->IncludeMorphologicalUpdate());
    EXPECT_TRUE(c.speedup->isEnabled());
    EXPECT_FALSE(c.factor->isEnabled());

    ClickButton(c.speedup);
    EXPECT_TRUE(morphology->IncludeSpeedup());
    EXPECT_TRUE(c.label->isEnabled());
    EXPECT_TRUE(c.factor->isEnabled());
    Enter(c.factor, "2.5");
    EXPECT_EQ(morphology->SpeedupFactor(), 2.5);
    EXPECT_EQ(host.hints, (std::vector<int>{1, 1, 1}));

    // Switching the update off greys the speed-up but keeps its values.
    ClickButton(c.include);
    EXPECT_FALSE(morphology->IncludeMorphologicalUpdate());
    EXPECT_TRUE(morphology->IncludeSpeedup());
    EXPECT_EQ(morphology->SpeedupFactor(), 2.5);
    EXPECT_TRUE(c.speedup->isChecked());
    EXPECT_FALSE(c.speedup->isEnabled());
    EXPECT_FALSE(c.label->isEnabled());
    EXPECT_FALSE(c.factor->isEnabled());
    EXPECT_EQ(c.factor->text(), "2.5");
}

TEST(MTMorphologyDlg, StoredSpeedupWithoutUpdateStaysDisabled) {
    auto doc = testsupport::Load(R"(
MUD_TRANSPORT_MODULE {
    MORPHOLOGY {
        include_morphological_update = false
        include_speedup = true
        speedup_factor = 10.0
    }
}
)");
    CRecordingHost host;
    auto dlg = OpenDialog(Node<CMTMorphologyKiv>(*doc, {"MORPHOLOGY"}), host);
    const MorphologyControls c = Controls(dlg.get());
    EXPECT_TRUE(c.speedup->isChecked());
    EXPECT_FALSE(c.speedup->isEnabled());
    EXPECT_FALSE(c.factor->isEnabled());
    EXPECT_EQ(c.factor->text(), "10");

    // Including the update brings the stored speed-up back into force.
    ClickButton(c.include);
    EXPECT_TRUE(c.speedup->isEnabled());
    EXPECT_TRUE(c.factor->isEnabled());
}
