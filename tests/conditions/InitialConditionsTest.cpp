#include "ConditionsTestSupport.h"

using namespace testsupport;
using namespace condtest;

namespace {
std::vector<float> Shares(const CInitialConditionsFractionDistributionItemKiv* layer) {
    std::vector<float> out;
    for (int i = 1; i <= layer->GetItemCount(); ++i)
        out.push_back(layer->Share(i));
    return out;
}
CInitialConditionsFractionDistributionItemKiv* Layer(CSetupDocument& doc, int layer) {
    return InitialConditions(doc.Module())->FractionDistribution()->GetItem(layer);
}
}  // namespace

TEST(InitialConditions, NewSetupWritesConcentrationsThicknessesAndDistributionsInOrder) {
    auto doc = NewSetup(3, 2);
    auto saved = Saved(*doc);
    const auto* s = Find(*saved, {"MUD_TRANSPORT_MODULE", "INITIAL_CONDITIONS"});
    ASSERT_NE(s, nullptr);
    EXPECT_EQ(Entries(*s), (std::vector<std::string>{
                               "[SSC_FRACTION_1]", "[SSC_FRACTION_2]", "[SSC_FRACTION_3]",
                               "[BED_THICKNESS_LAYER_1]", "[BED_THICKNESS_LAYER_2]",
                               "[BED_DISTRIBUTION_LAYER_1]", "[BED_DISTRIBUTION_LAYER_2]"}));
    const auto* layer = s->FindSection("BED_DISTRIBUTION_LAYER_2");
    EXPECT_EQ(Entries(*layer), (std::vector<std::string>{
                                   "ZoSEKivListItemCount", "format",
                                   "[BED_DISTRIBUTION_FRACTION_1]", "[BED_DISTRIBUTION_FRACTION_2]",
                                   "[BED_DISTRIBUTION_FRACTION_3]"}));
    const auto* element = layer->FindSection("BED_DISTRIBUTION_FRACTION_3");
    EXPECT_EQ(Entries(*element),
              (std::vector<std::string>{"constant_value", "file_name", "item_number"}));
    EXPECT_EQ(Double(*element, "constant_value"), 34.0);
    EXPECT_EQ(Int(*element, "item_number"), 1);
    EXPECT_EQ(Double(*s->FindSection("SSC_FRACTION_2"), "constant_value"), 0.0);

    // The section order of the module: sources, initial and boundary conditions after
    // dispersion, before morphology.
    const auto* module = Find(*saved, {"MUD_TRANSPORT_MODULE"});
    std::vector<std::string> order;
    for (const std::string& e : Entries(*module))
        if (e == "[DISPERSION]" || e == "[SOURCES]" || e == "[INITIAL_CONDITIONS]" ||
            e == "[BOUNDARY_CONDITIONS]" || e == "[MORPHOLOGY]")
            order.push_back(e);
    EXPECT_EQ(order, (std::vector<std::string>{"[DISPERSION]", "[SOURCES]", "[INITIAL_CONDITIONS]",
                                               "[BOUNDARY_CONDITIONS]", "[MORPHOLOGY]"}));

    CInitialConditionsKiv* ic = InitialConditions(doc->Module());
    ASSERT_NE(ic, nullptr);
    EXPECT_EQ(ic->GetTitle(), "Initial Conditions");
    EXPECT_EQ(ic->Fractions()->GetItem(2)->GetTitle(), "Fraction 2");
    EXPECT_EQ(ic->Layers()->GetItem(2)->GetTitle(), "Layer 2");
    EXPECT_EQ(ic->Fractions()->GetItem(1)->Value()->ItemType(), 100403);
    EXPECT_EQ(ic->Fractions()->GetItem(1)->Value()->FormatCode(), 10);
    EXPECT_EQ(ic->Layers()->GetItem(1)->Value()->ItemType(), 100272);
    EXPECT_EQ(ic->Layers()->GetItem(1)->Value()->FormatCode(), 8);
    EXPECT_EQ(ic->Layers()->GetItem(1)->Value()->FurtherItemTypes(), (std::vector<long>{100324}));
    EXPECT_STREQ(ic->Fractions()->GetDlgRuntimeClass(2555), "CInitialConditionsFractionsDlg");
    EXPECT_STREQ(ic->Layers()->GetDlgRuntimeClass(2555), "CInitialConditionsLayersDlg");
    EXPECT_STREQ(ic->FractionDistribution()->GetDlgRuntimeClass(2555),
                 "CInitialConditionsFractionDistributionDlg");
    EXPECT_STREQ(ic->Fractions()->GetItem(1)->GetDlgRuntimeClass(2555),
                 "CInitialConditionsFractionsItemDlg");
    EXPECT_STREQ(ic->Layers()->GetItem(1)->GetDlgRuntimeClass(2555),
                 "CInitialConditionsLayersItemDlg");
    EXPECT_EQ(Layer(*doc, 1)->GetDlgRuntimeClass(2555), nullptr);
    EXPECT_EQ(Layer(*doc, 1)->GetDlgRuntimeClass(1), nullptr);
}

TEST(InitialConditions, EvenSplitAddsUpToExactlyOneHundred) {
    struct Case {
        int fractions;
        std::vector<float> shares;
    };
    const Case cases[] = {
        {1, {100}},
        {2, {50, 50}},
        {3, {33, 33, 34}},
        {6, {16, 16, 16, 16, 16, 20}},
        {7, {14, 14, 14, 14, 14, 14, 16}},
        {8, {12, 12, 12, 12, 12, 12, 12, 16}},
    };
    for (const Case& c : cases) {
        auto doc = NewSetup(c.fractions, 2);
        for (int layer = 1; layer <= 2; ++layer)
            EXPECT_EQ(Shares(Layer(*doc, layer)), c.shares) << c.fractions << " fractions";
        EXPECT_EQ(doc->ValidateAll(), 1) << ::testing::PrintToString(Messages(*doc));
    }
}

TEST(InitialConditions, ANewNumberOfFractionsSplitsEveryLayerAgainAndNewLayersStartEven) {
    auto doc = NewSetup(2, 3);
    for (int layer = 1; layer <= 3; ++layer)
        EXPECT_EQ(Shares(Layer(*doc, layer)), (std::vector<float>{50, 50}));
    Layer(*doc, 1)->GetItem(1)->ConstantValue(70);
    Layer(*doc, 1)->GetItem(2)->ConstantValue(30);
    CParameterSelectionKiv* model = ModelDefinition(doc->Module());

    // Setting the same number again keeps what was edited.
    model->NumberOfFractions(2);
    EXPECT_EQ(Shares(Layer(*doc, 1)), (std::vector<float>{70, 30}));
    // A new layer is split evenly; the others keep their shares.
    model->NumberOfLayers(4);
    EXPECT_EQ(Shares(Layer(*doc, 1)), (std::vector<float>{70, 30}));
    EXPECT_EQ(Shares(Layer(*doc, 4)), (std::vector<float>{50, 50}));
    // A new number of fractions discards the edited shares in every layer.
    model->NumberOfFractions(3);
    for (int layer = 1; layer <= 4; ++layer)
        EXPECT_EQ(Shares(Layer(*doc, layer)), (std::vector<float>{33, 33, 34}));
    EXPECT_EQ(InitialConditions(doc->Module())->Fractions()->GetItemCount(), 3);
    EXPECT_EQ(InitialConditions(doc->Module())->Layers()->GetItemCount(), 4);
}

TEST(InitialConditions, ValidationMessagesOnTheirNodes) {
    struct Case {
        const char* what;
        std::vector<float> shares;  // layer 1
        double concentration;       // fraction 1
        int concentrationFormat;
        double thickness;           // layer 2
        std::vector<std::string> messages;
    };
    const std::string layer1 =
        "MUD_TRANSPORT_MODULE/INITIAL_CONDITIONS/Fraction Distribution/BED_DISTRIBUTION_LAYER_1: ";
    const std::string sum = "The sum of fraction distributions in a layer must be 100";
    const std::string negative = "Constant value must be larger than or equal to 0.0";
    const Case cases[] = {
        {"even split", {33, 33, 34}, 0.0, 0, 0.0, {}},
        {"a row of 99.99", {33, 33, 33.99f}, 0.0, 0, 0.0, {layer1 + sum}},
        {"a row over 100", {50, 50.01f, 0}, 0.0, 0, 0.0, {layer1 + sum}},
        {"shares with fractions", {12.5f, 37.5f, 50}, 0.0, 0, 0.0, {}},
        {"negative concentration", {33, 33, 34}, -0.001, 0, 0.0,
         {"MUD_TRANSPORT_MODULE/INITIAL_CONDITIONS/Fraction Concentration/SSC_FRACTION_1: " +
          negative}},
        {"negative constant under a data file", {33, 33, 34}, -1.0, 2, 0.0,
         {"MUD_TRANSPORT_MODULE/INITIAL_CONDITIONS/Fraction Concentration/SSC_FRACTION_1: " +
          negative}},
        {"negative thickness", {33, 33, 34}, 0.0, 0, -0.5,
         {"MUD_TRANSPORT_MODULE/INITIAL_CONDITIONS/Layer Thickness/BED_THICKNESS_LAYER_2: " +
          negative}},
    };
    for (const Case& c : cases) {
        auto doc = NewSetup(3, 2);
        CInitialConditionsKiv* ic = InitialConditions(doc->Module());
        for (int i = 0; i < 3; ++i)
            Layer(*doc, 1)->GetItem(i + 1)->ConstantValue(c.shares[static_cast<size_t>(i)]);
        CFemInDataKiv* concentration = ic->Fractions()->GetItem(1)->Value();
        concentration->Constant(c.concentration);
        concentration->Format(c.concentrationFormat);
        // A grid file that is valid for the value, so that only the constant is at fault.
        concentration->QrdData()->FileName(MUD_SOURCE_DIR "/examples/data/initial_ssc.qrd2");
        ic->Layers()->GetItem(2)->Value()->Constant(c.thickness);
        EXPECT_EQ(doc->ValidateAll(), c.messages.empty() ? 1 : 0) << c.what;
        EXPECT_EQ(Messages(*doc), c.messages) << c.what;
    }
    // No tolerance: 50 and 49.99 fail.
    auto doc = NewSetup(2, 1);
    Layer(*doc, 1)->GetItem(2)->ConstantValue(49.99f);
    EXPECT_EQ(doc->ValidateAll(), 0);
}

TEST(InitialConditions, ALayerWithoutFractionsFailsItsSum) {
    auto doc = NewSetup(1, 2);
    ModelDefinition(doc->Module())->NumberOfFractions(0);
    EXPECT_EQ(Layer(*doc, 1)->GetItemCount(), 0);
    doc->ValidateAll();
    int sums = 0;
    for (const std::string& m : Messages(*doc))
        sums += m.find("The sum of fraction distributions") != std::string::npos;
    EXPECT_EQ(sums, 2);
}

TEST(InitialConditions, ValuesReadBackUndisturbedByTheSplit) {
    const std::string body =
        " INITIAL_CONDITIONS {\n"
        "  SSC_FRACTION_2 {\n   format = 2\n   constant_value = 0.05\n"
        "   file_name = 'data\\initial ssc.qrd1'\n   item_numbers = 3\n  }\n"
        "  BED_THICKNESS_LAYER_1 {\n   constant_value = 0.25\n  }\n"
        "  BED_DISTRIBUTION_LAYER_2 {\n   ZoSEKivListItemCount = 3\n   format = 1\n"
        "   BED_DISTRIBUTION_FRACTION_1 {\n    constant_value = 60.0\n"
        "    file_name = 'bed.qrd1'\n    item_number = 4\n   }\n"
        "   BED_DISTRIBUTION_FRACTION_2 {\n    constant_value = 30.0\n   }\n"
        "   BED_DISTRIBUTION_FRACTION_3 {\n    constant_value = 10.0\n   }\n  }\n }\n";
    CSetupDocument::OpenResult r = CSetupDocument::FromText(ModuleText(3, 2, body), "t.setup");
    ASSERT_TRUE(r.document);
    EXPECT_TRUE(r.warnings.empty()) << ::testing::PrintToString(WarningTexts(r));
    CSetupDocument& doc = *r.document;
    CInitialConditionsKiv* ic = InitialConditions(doc.Module());
    const CFemInDataKiv* ssc = ic->Fractions()->GetItem(2)->Value();
    EXPECT_EQ(ssc->Format(), 2);
    EXPECT_EQ(ssc->Constant(), 0.05);
    EXPECT_EQ(ssc->QrdData()->FileName(), "data\\initial ssc.qrd1");
    EXPECT_EQ(ssc->QrdData()->ItemNumbers(), (std::vector<int>{3}));
    EXPECT_EQ(ic->Layers()->GetItem(1)->Value()->Constant(), 0.25);
    EXPECT_EQ(Shares(Layer(doc, 1)), (std::vector<float>{33, 33, 34}));
    EXPECT_EQ(Shares(Layer(doc, 2)), (std::vector<float>{60, 30, 10}));
    EXPECT_EQ(Layer(doc, 2)->Format(), 1);
    EXPECT_EQ(Layer(doc, 2)->GetItem(1)->FileName(), "bed.qrd1");
    EXPECT_EQ(Layer(doc, 2)->GetItem(1)->ItemNumber(), 4);
    // The shares read add up; only the data file, which is not there, is reported.
    EXPECT_EQ(doc.ValidateAll(), 0);
    ASSERT_EQ(Messages(doc).size(), 1u) << ::testing::PrintToString(Messages(doc));
    EXPECT_NE(Messages(doc)[0].find("SSC_FRACTION_2: The data file"), std::string::npos);
    EXPECT_EQ(Load(doc.ToText())->ToText(), doc.ToText());
}

TEST(InitialConditions, ADistributionCountOtherThanTheFractionsIsReportedAndNotTaken) {
    const std::string body =
        " INITIAL_CONDITIONS {\n"
        "  BED_DISTRIBUTION_LAYER_1 {\n   ZoSEKivListItemCount = 5\n"
        "   BED_DISTRIBUTION_FRACTION_1 {\n    constant_value = 20.0\n   }\n"
        "   BED_DISTRIBUTION_FRACTION_2 {\n    constant_value = 80.0\n   }\n"
        "   BED_DISTRIBUTION_FRACTION_5 {\n    constant_value = 1.0\n   }\n  }\n"
        "  BED_DISTRIBUTION_LAYER_2 {\n   ZoSEKivListItemCount = 1\n  }\n }\n";
    CSetupDocument::OpenResult r = CSetupDocument::FromText(ModuleText(2, 2, body), "t.setup");
    ASSERT_TRUE(r.document);
    // The fraction beyond is reported as content no section reads, the fractions a layer
    // lacks once for the layer.
    ASSERT_EQ(r.warnings.size(), 4u) << ::testing::PrintToString(WarningTexts(r));
    EXPECT_EQ(r.warnings[3].message,
              "2 of 2 sections are missing (BED_DISTRIBUTION_FRACTION_1, "
              "BED_DISTRIBUTION_FRACTION_2); those items take their defaults");
    EXPECT_EQ(r.warnings[1].message,
              "unknown section 'BED_DISTRIBUTION_FRACTION_5' in "
              "MUD_TRANSPORT_MODULE/INITIAL_CONDITIONS/BED_DISTRIBUTION_LAYER_1: not read, "
              "dropped on saving");
    EXPECT_EQ(r.warnings[0].message,
              "ZoSEKivListItemCount = 5, but the setup has 2 fractions; the list follows them");
    EXPECT_EQ(r.warnings[0].pos.line, 8);
    EXPECT_EQ(Shares(Layer(*r.document, 1)), (std::vector<float>{20, 80}));
    EXPECT_EQ(Shares(Layer(*r.document, 2)), (std::vector<float>{50, 50}));
}

TEST(InitialConditions, RegisteredWhileItLives) {
    auto doc = NewSetup(1, 1);
    CZoSEKivBase* ic = doc->GetImportantNode("MT Initial Conditions");
    ASSERT_NE(ic, nullptr);
    EXPECT_EQ(ic->GetSectionName(), "INITIAL_CONDITIONS");
    EXPECT_STREQ(ic->GetDlgRuntimeClass(2555), "CMTGroupDlg");
    EXPECT_TRUE(ic->IsDlgUsedInSetup());
}
