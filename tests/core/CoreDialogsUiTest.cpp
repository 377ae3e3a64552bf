#include "TestSupport.h"
#include "core/MTCountListKiv.h"
#include "core/MTSolutionTechniqueKiv.h"
#include "core/MudTransportModuleKiv.h"
#include "support/UiTestSupport.h"
#include "widgets/ZoNumberEdit.h"

#include <QComboBox>
#include <QGroupBox>
#include <QLabel>
#include <QTest>
#include <QToolButton>

#include <gtest/gtest.h>

using namespace uitest;

namespace {

// A per-fraction or per-layer list standing in for the sections that follow the counts.
struct CountItem : CZoSEKivBase {
    explicit CountItem(CZoSEKivBase* parent) : CZoSEKivBase("Item %d", "ITEM_%d", parent) {}
};
using CountList = CMTCountListKiv<CountItem>;

class ModelDefinitionDialog : public ::testing::Test {
protected:
    void SetUp() override {
        fractionsA = std::make_unique<CountList>("A", "A", doc.Module(), MTCount::Fractions);
        fractionsB = std::make_unique<CountList>("B", "B", doc.Module(), MTCount::Fractions);
        layers = std::make_unique<CountList>("L", "L", doc.Module(), MTCount::Layers);
        model = FindNodeAs<CParameterSelectionKiv>(doc.Module(), {"MODEL_DEFINITION"});
        model->NumberOfFractions(3);
        model->NumberOfLayers(4);
        dialog = OpenDialog(model, host);
        ASSERT_TRUE(dialog);
        fractions = Child<CZoNumberEdit>(dialog.get(), "fractions");
        layersField = Child<CZoNumberEdit>(dialog.get(), "layers");
    }

    CSetupDocument doc;
    std::unique_ptr<CountList> fractionsA, fractionsB, layers;
    CParameterSelectionKiv* model = nullptr;
    CRecordingHost host;
    std::unique_ptr<CZoSEDlgBase> dialog;
    CZoNumberEdit* fractions = nullptr;
    CZoNumberEdit* layersField = nullptr;
};

TEST_F(ModelDefinitionDialog, ShowsItsFrameLabelsAndTheCurrentCounts) {
    EXPECT_EQ(dialog->GetHelpID(), 5046u);
    auto* frame = dialog->findChild<QGroupBox*>();
    ASSERT_TRUE(frame);
    EXPECT_EQ(frame->title(), "Parameter Selection");
    QStringList texts;
    for (QLabel* l : frame->findChildren<QLabel*>())
        texts << l->text();
    for (const char* t : {"Number of Fractions", "(Max 8)", "Number of Layers", "(Max 12)"})
        EXPECT_TRUE(texts.contains(t)) << t;
    EXPECT_EQ(fractions->text(), "3");
    EXPECT_EQ(layersField->text(), "4");
    EXPECT_TRUE(host.hints.empty());
}

TEST_F(ModelDefinitionDialog, EachTypedCountIsStoredAtOnceWithTheHintOfItsDirection) {
    Type(fractions, "5");
    EXPECT_EQ(model->NumberOfFractions(), 5);
    EXPECT_EQ(fractionsA->GetItemCount(), 5);
    EXPECT_EQ(fractionsB->GetItemCount(), 5);
    EXPECT_EQ(layers->GetItemCount(), 4);
    EXPECT_EQ(host.hints, (std::vector<int>{2}));
    // Leaving the field afterwards stores nothing more.
    QTest::keyClick(fractions, Qt::Key_Return);
    EXPECT_EQ(host.hints, (std::vector<int>{2}));

    host.Clear();
    Type(fractions, "2");
    EXPECT_EQ(fractionsA->GetItemCount(), 2);
    EXPECT_EQ(fractionsB->GetItemCount(), 2);
    EXPECT_EQ(host.hints, (std::vector<int>{4}));

    // The same value again still reaches the setter; the lists keep their items.
    host.Clear();
    CZoSEKivBase* kept = fractionsA->GetItem(1);
    Type(fractions, "2");
    EXPECT_EQ(host.hints, (std::vector<int>{1}));
    EXPECT_EQ(fractionsA->GetItem(1), kept);

    host.Clear();
    auto* erosion = FindNodeAs<CZoSEKivListBaseInterface>(doc.Module(), {"BED", "EROSION"});
    ASSERT_TRUE(erosion);
    CZoSEKivBase* thirdLayer = erosion->GetItemNode(3);
    Type(layersField, "12");
    EXPECT_EQ(model->NumberOfLayers(), 12);
    EXPECT_EQ(layers->GetItemCount(), 12);
    EXPECT_EQ(erosion->GetItemCount(), 12);
    EXPECT_EQ(erosion->GetItemNode(3), thirdLayer);
    EXPECT_EQ(host.hints, (std::vector<int>{2}));
}

TEST_F(ModelDefinitionDialog, ACountOnTheWayToALongerOneWaitsAndKeepsTheItems) {
    auto* erosion = FindNodeAs<CZoSEKivListBaseInterface>(doc.Module(), {"BED", "EROSION"});
    ASSERT_TRUE(erosion);
    CZoSEKivBase* thirdLayer = erosion->GetItemNode(3);
    Type(layersField, "1");  // could still become 10, 11 or 12
    EXPECT_EQ(model->NumberOfLayers(), 4);
    EXPECT_TRUE(host.hints.empty());
    QTest::keyClicks(layersField, "1");
    EXPECT_EQ(model->NumberOfLayers(), 11);
    EXPECT_EQ(erosion->GetItemNode(3), thirdLayer);  // 4 to 11, never through 1
    EXPECT_EQ(host.hints, (std::vector<int>{2}));

    // Left as "1", it is stored when the field is left.
    host.Clear();
    Enter(layersField, "1");
    EXPECT_EQ(model->NumberOfLayers(), 1);
    EXPECT_EQ(layers->GetItemCount(), 1);
    EXPECT_EQ(host.hints, (std::vector<int>{4}));
}

TEST_F(ModelDefinitionDialog, OutOfRangeOrNonNumericCountsAreRefusedAndChangeNothing) {
    MessageRecorder messages;
    Type(fractions, "9");
    Type(fractions, "0");
    Type(layersField, "13");
    Type(fractions, "x");
    EXPECT_EQ(model->NumberOfFractions(), 3);
    EXPECT_EQ(model->NumberOfLayers(), 4);
    EXPECT_EQ(fractionsA->GetItemCount(), 3);
    EXPECT_EQ(layers->GetItemCount(), 4);
    EXPECT_TRUE(host.hints.empty());
    EXPECT_EQ(fractions->text(), "3");
    EXPECT_EQ(layersField->text(), "4");
    EXPECT_EQ(messages.Messages(),
              (std::vector<QString>{"Number of Fractions (Parameter Selection): Please enter an integer between 1 and 8.",
                                    "Number of Fractions (Parameter Selection): Please enter an integer between 1 and 8.",
                                    "Number of Layers (Parameter Selection): Please enter an integer between 1 and 12.",
                                    "Number of Fractions (Parameter Selection): Please enter an integer."}));

    // An emptied field waits for more typing; left empty, it is refused.
    Type(fractions, "");
    EXPECT_EQ(messages.Messages().size(), 4u);
    QTest::keyClick(fractions, Qt::Key_Return);
    EXPECT_EQ(messages.Messages().size(), 5u);
    EXPECT_EQ(fractions->text(), "3");
    EXPECT_TRUE(host.hints.empty());
}

TEST_F(ModelDefinitionDialog, SpinButtonsStepWithinTheRange) {
    QToolButton* up = Child<CZoSpinButton>(dialog.get(), "fractionsSpin")->UpButton();
    QTest::mouseClick(up, Qt::LeftButton);
    EXPECT_EQ(model->NumberOfFractions(), 4);
    EXPECT_EQ(fractionsA->GetItemCount(), 4);
    EXPECT_EQ(fractions->text(), "4");
    EXPECT_EQ(host.hints, (std::vector<int>{2}));

    // A step is a whole value: one layer is stored at once, though "1" could begin "12".
    model->NumberOfLayers(2);
    dialog->SetData();
    host.Clear();
    QToolButton* down = Child<CZoSpinButton>(dialog.get(), "layersSpin")->DownButton();
    QTest::mouseClick(down, Qt::LeftButton);
    EXPECT_EQ(model->NumberOfLayers(), 1);
    EXPECT_EQ(layers->GetItemCount(), 1);
    EXPECT_EQ(host.hints, (std::vector<int>{4}));

    host.Clear();
    QTest::mouseClick(down, Qt::LeftButton);
    EXPECT_EQ(model->NumberOfLayers(), 1);
    EXPECT_TRUE(host.hints.empty());
}

TEST_F(ModelDefinitionDialog, RetypingACountThatWaitsForDigitsStillReachesTheSetter) {
    model->NumberOfLayers(1);
    dialog->SetData();
    host.Clear();
    Enter(layersField, "1");
    EXPECT_EQ(model->NumberOfLayers(), 1);
    EXPECT_EQ(host.hints, (std::vector<int>{1}));
    // Leaving it again without typing stores nothing more.
    QTest::keyClick(layersField, Qt::Key_Return);
    EXPECT_EQ(host.hints, (std::vector<int>{1}));
}

TEST_F(ModelDefinitionDialog, ADialogDeletedWhileACountIsTypedDoesNotReachBackIntoIt) {
    dialog->activateWindow();
    ASSERT_TRUE(QTest::qWaitForWindowActive(dialog.get()));
    layersField->setFocus();
    Type(layersField, "1");  // waits for more digits, then the window goes
    ASSERT_TRUE(layersField->hasFocus());
    dialog.reset();
    EXPECT_EQ(model->NumberOfLayers(), 4);
    EXPECT_EQ(layers->GetItemCount(), 4);
    EXPECT_TRUE(host.hints.empty());
}

TEST(CoreDialogs, RootAndGroupPagesCarryTheirHelpTopics) {
    CSetupDocument doc;
    CRecordingHost host;
    struct Expect {
        std::vector<std::string_view> path;
        unsigned long help;
    };
    const Expect pages[] = {{{}, 5001}, {{"WATER_COLUMN"}, 5044}, {{"BED"}, 5011}, {{"FORCINGS"}, 5028}};
    for (const Expect& e : pages) {
        CZoSEKivBase* node = doc.Module();
        for (std::string_view name : e.path)
            node = FindNode(node, {name});
        auto dialog = OpenDialog(node, host);
        ASSERT_TRUE(dialog);
        EXPECT_EQ(dialog->GetHelpID(), e.help);
        QTest::keyClick(dialog.get(), Qt::Key_F1);
    }
    EXPECT_EQ(host.helpIds, (std::vector<unsigned long>{5001, 5044, 5011, 5028}));
    EXPECT_TRUE(host.hints.empty());
}

class SolutionTechniqueDialog : public ::testing::Test {
protected:
    std::vector<int> Saved(CSetupDocument& d) {
        auto saved = testsupport::Saved(d);
        const paramfile::Section* st =
            testsupport::Find(*saved, {"MUD_TRANSPORT_MODULE", "SOLUTION_TECHNIQUE"});
        EXPECT_TRUE(st);
        if (!st)
            return {};
        return {testsupport::Int(*st, "scheme_of_time_integration"),
                testsupport::Int(*st, "scheme_of_space_discretization_horizontal"),
                testsupport::Int(*st, "scheme_of_space_discretization_vertical")};
    }
    CRecordingHost host;
};

TEST_F(SolutionTechniqueDialog, ChoicesAreStoredAtOnceAndTheVerticalSchemeFollows) {
    CSetupDocument doc;
    auto dialog = OpenDialog(FindNode(doc.Module(), {"SOLUTION_TECHNIQUE"}), host);
    ASSERT_TRUE(dialog);
    EXPECT_EQ(dialog->GetHelpID(), 5047u);
    auto* time = Child<QComboBox>(dialog.get(), "timeIntegration");
    auto* space = Child<QComboBox>(dialog.get(), "spaceDiscretization");
    for (QComboBox* box : {time, space}) {
        ASSERT_EQ(box->count(), 2);
        EXPECT_EQ(box->itemText(0), "Low order, fast algorithm");
        EXPECT_EQ(box->itemText(1), "Higher order");
    }
    QStringList labels;
    for (QLabel* l : dialog->findChildren<QLabel*>())
        labels << l->text();
    EXPECT_TRUE(labels.contains("Time integration"));
    EXPECT_TRUE(labels.contains("Space discretization"));
    EXPECT_EQ(time->currentText(), "Higher order");
    EXPECT_EQ(space->currentText(), "Higher order");

    Choose(space, "Low order, fast algorithm");
    EXPECT_EQ(Saved(doc), (std::vector<int>{2, 1, 1}));
    EXPECT_EQ(host.hints, (std::vector<int>{1}));
    Choose(space, "Higher order");
    EXPECT_EQ(Saved(doc), (std::vector<int>{2, 2, 3}));
    Choose(time, "Low order, fast algorithm");
    EXPECT_EQ(Saved(doc), (std::vector<int>{1, 2, 3}));
    EXPECT_EQ(host.hints, (std::vector<int>{1, 1, 1}));
}

TEST_F(SolutionTechniqueDialog, ShowingTheDialogDerivesTheVerticalSchemeOfAFile) {
    auto doc = testsupport::Load(
        "MUD_TRANSPORT_MODULE {\n SOLUTION_TECHNIQUE {\n"
        "  scheme_of_space_discretization_horizontal = 2\n"
        "  scheme_of_space_discretization_vertical = 2\n }\n}\n");
    ASSERT_TRUE(doc);
    EXPECT_EQ(Saved(*doc), (std::vector<int>{2, 2, 2}));
    auto dialog = OpenDialog(FindNode(doc->Module(), {"SOLUTION_TECHNIQUE"}), host);
    EXPECT_EQ(Saved(*doc), (std::vector<int>{2, 2, 3}));
    EXPECT_TRUE(host.hints.empty());
}

TEST_F(SolutionTechniqueDialog, UnknownSchemesShowNoEntryAndStayAsRead) {
    auto doc = testsupport::Load(
        "MUD_TRANSPORT_MODULE {\n SOLUTION_TECHNIQUE {\n"
        "  scheme_of_time_integration = 7\n"
        "  scheme_of_space_discretization_horizontal = 0\n"
        "  scheme_of_space_discretization_vertical = 2\n }\n}\n");
    ASSERT_TRUE(doc);
    auto dialog = OpenDialog(FindNode(doc->Module(), {"SOLUTION_TECHNIQUE"}), host);
    EXPECT_EQ(Child<QComboBox>(dialog.get(), "timeIntegration")->currentIndex(), -1);
    EXPECT_EQ(Child<QComboBox>(dialog.get(), "spaceDiscretization")->currentIndex(), -1);
    EXPECT_EQ(Saved(*doc), (std::vector<int>{7, 0, 2}));
}

}  // namespace

