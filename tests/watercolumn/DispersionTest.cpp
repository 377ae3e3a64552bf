#include "WaterColumnTestSupport.h"
#include "fem/DomainKiv.h"
#include "watercolumn/MTDispersionKiv.h"

using namespace testsupport;
using namespace wctest;
using paramfile::ParamType;

namespace {

CMTDispersionKiv* Dispersion(CSetupDocument& doc) {
    return Node<CMTDispersionKiv>(doc, {"DISPERSION"});
}

void ExpectValue(const paramfile::Section* s, const char* constantKeyword, double constant) {
    ASSERT_NE(s, nullptr);
    EXPECT_EQ(Entries(*s), (std::vector<std::string>{"format", constantKeyword, "file_name",
                                                     "item_number", "item_name"}));
    EXPECT_EQ(Int(*s, "format"), 0);
    EXPECT_EQ(TypeOf(*s, constantKeyword), ParamType::Double);
    EXPECT_EQ(Double(*s, constantKeyword), constant);
    EXPECT_EQ(TypeOf(*s, "file_name"), ParamType::FileName);
    EXPECT_EQ(String(*s, "file_name"), "");
    EXPECT_EQ(Int(*s, "item_number"), 1);
    EXPECT_EQ(TypeOf(*s, "item_name"), ParamType::String);
}

std::string DispersionText(const std::string& item) {
    return Module(1, " DISPERSION {\n  HORIZONTAL_DISPERSION {\n   SSC_FRACTION_1 {\n" + item +
                         "   }\n  }\n }\n");
}

}  // namespace

TEST(Dispersion, NewSetupWritesBothListsWithScaledEddyViscosity) {
    auto doc = NewSetup(3);
    auto saved = Saved(*doc);
    const auto* d = Find(*saved, {"MUD_TRANSPORT_MODULE", "DISPERSION"});
    ASSERT_NE(d, nullptr);
    EXPECT_EQ(Entries(*d),
              (std::vector<std::string>{"[HORIZONTAL_DISPERSION]", "[VERTICAL_DISPERSION]"}));
    for (const char* list : {"HORIZONTAL_DISPERSION", "VERTICAL_DISPERSION"}) {
        const auto* l = d->FindSection(list);
        ASSERT_NE(l, nullptr);
        EXPECT_EQ(Entries(*l),
                  (std::vector<std::string>{"ZoSEKivListItemCount", "[SSC_FRACTION_1]",
                                            "[SSC_FRACTION_2]", "[SSC_FRACTION_3]"}));
        const auto* item = l->FindSection("SSC_FRACTION_2");
        ASSERT_NE(item, nullptr);
        EXPECT_EQ(Entries(*item), (std::vector<std::string>{"type", "[SCALED_EDDY_VISCOSITY]",
                                                            "[DISPERSION_COEFFICIENT]"}));
        EXPECT_EQ(Int(*item, "type"), 2);
        ExpectValue(item->FindSection("SCALED_EDDY_VISCOSITY"), "sigma", 1.0);
        ExpectValue(item->FindSection("DISPERSION_COEFFICIENT"), "constant_value", 0.01);
    }
    CMTDispersionKiv* dispersion = Dispersion(*doc);
    EXPECT_EQ(dispersion->GetTitle(), "Dispersion");
    EXPECT_EQ(dispersion->GetHelpID(), 5022u);
    EXPECT_STREQ(dispersion->Horizontal()->GetDlgRuntimeClass(2555), "CMTDispersionListDlg");
    EXPECT_STREQ(dispersion->Vertical()->GetItem(1)->GetDlgRuntimeClass(2555),
                 "CMTDispersionItemDlg");
    EXPECT_EQ(dispersion->Vertical()->GetTitle(), "Vertical Dispersion");
    EXPECT_EQ(dispersion->Horizontal()->GetItem(3)->GetTitle(), "Fraction 3");
    EXPECT_EQ(dispersion->Horizontal()->GetItem(1)->DispersionCoefficient()->ItemType(), 100153);
}

TEST(Dispersion, MissingKeywordsInsideAValueTakeFixedValues) {
    auto doc = Load(DispersionText(
        "    type = 1\n    SCALED_EDDY_VISCOSITY {\n     file_name = 'a.qrd2'\n    }\n"
        "    DISPERSION_COEFFICIENT {\n     item_number = 4\n    }\n"));
    CMTDispersionItemKiv* item = Dispersion(*doc)->Horizontal()->GetItem(1);
    EXPECT_EQ(item->FormulationType(), 1);
    CFemInDataKiv* eddy = item->ScaledEddyViscosity();
    EXPECT_EQ(eddy->Format(), 0);
    EXPECT_EQ(eddy->Constant(), 0.0);  // not the default 1.0
    EXPECT_EQ(eddy->QrdData()->FileName(), "a.qrd2");
    EXPECT_EQ(eddy->QrdData()->ItemNumbers(), std::vector<int>{1});
    CFemInDataKiv* coefficient = item->DispersionCoefficient();
    EXPECT_EQ(coefficient->Format(), 1);
    EXPECT_EQ(coefficient->Constant(), 0.0);
    EXPECT_EQ(coefficient->QrdData()->ItemNumbers(), std::vector<int>{4});
    EXPECT_EQ(coefficient->QrdData()->ItemName(), "");

    // Without "type" and without the value sections everything keeps its default.
    auto bare = Load(DispersionText("    unrelated = 1\n"));
    CMTDispersionItemKiv* fresh = Dispersion(*bare)->Horizontal()->GetItem(1);
    EXPECT_EQ(fresh->FormulationType(), 2);
    EXPECT_EQ(fresh->ScaledEddyViscosity()->Constant(), 1.0);
    EXPECT_EQ(fresh->DispersionCoefficient()->Format(), 0);
    EXPECT_EQ(fresh->DispersionCoefficient()->Constant(), 0.01);
}

TEST(Dispersion, RoundTripKeepsEveryValue) {
    const std::string text = DispersionText(
        "    type = 0\n    SCALED_EDDY_VISCOSITY {\n     format = 3\n     sigma = 0.75\n"
        "     file_name = 'C:\\data\\it''s.qrd2'\n     item_number = 3\n"
        "     item_name = \"Eddy \\\"scale\\\"\"\n    }\n"
        "    DISPERSION_COEFFICIENT {\n     format = 2\n     constant_value = 0.33333334\n"
        "     file_name = 'k.qrd2'\n     item_number = 2\n     item_name = \"K\"\n    }\n");
    auto doc = Load(text);
    CMTDispersionItemKiv* item = Dispersion(*doc)->Horizontal()->GetItem(1);
    EXPECT_EQ(item->ScaledEddyViscosity()->QrdData()->FileName(), "C:\\data\\it's.qrd2");
    EXPECT_EQ(item->ScaledEddyViscosity()->QrdData()->ItemName(), "Eddy \"scale\"");
    auto saved = Saved(*doc);
    const auto* s = Find(*saved, {"MUD_TRANSPORT_MODULE", "DISPERSION", "HORIZONTAL_DISPERSION",
                                  "SSC_FRACTION_1"});
    ASSERT_NE(s, nullptr);
    EXPECT_EQ(Int(*s, "type"), 0);
    const auto* eddy = s->FindSection("SCALED_EDDY_VISCOSITY");
    EXPECT_EQ(Int(*eddy, "format"), 3);
    EXPECT_EQ(Double(*eddy, "sigma"), 0.75);
    EXPECT_EQ(Int(*eddy, "item_number"), 3);
    EXPECT_EQ(String(*eddy, "item_name"), "Eddy \"scale\"");
    const auto* k = s->FindSection("DISPERSION_COEFFICIENT");
    EXPECT_EQ(Double(*k, "constant_value"), 0.33333334);
    EXPECT_EQ(String(*k, "file_name"), "k.qrd2");
    EXPECT_EQ(Load(doc->ToText())->ToText(), doc->ToText());
}

TEST(Dispersion, VerticalListIsUsedOnlyInThreeDimensions) {
    auto doc = NewSetup(2);
    CMTDispersionKiv* dispersion = Dispersion(*doc);
    EXPECT_TRUE(dispersion->Horizontal()->IsDlgUsedInSetup());
    EXPECT_FALSE(dispersion->Vertical()->IsDlgUsedInSetup());
    // Still written in two dimensions.
    auto saved = Saved(*doc);
    EXPECT_NE(Find(*saved, {"MUD_TRANSPORT_MODULE", "DISPERSION", "VERTICAL_DISPERSION",
                            "SSC_FRACTION_2"}),
              nullptr);
    doc->GetDomain()->Is3D(true);
    EXPECT_TRUE(dispersion->Vertical()->IsDlgUsedInSetup());
    EXPECT_TRUE(dispersion->Horizontal()->IsDlgUsedInSetup());
}

TEST(Dispersion, EddyViscosityMayVaryVerticallyInEveryFractionOfAThreeDimensionalSetup) {
    auto doc = Load("DOMAIN {\n three_dimensional = 1\n}\n" + Module(3, ""));
    ASSERT_TRUE(doc->GetDomain()->Is3D());
    CMTDispersionKiv* dispersion = Dispersion(*doc);
    for (CMTDispersionListKiv* list : {dispersion->Horizontal(), dispersion->Vertical()})
        for (int i = 1; i <= 3; ++i) {
            EXPECT_EQ(list->GetItem(i)->ScaledEddyViscosity()->FormatCode(), 3) << i;
            EXPECT_EQ(list->GetItem(i)->DispersionCoefficient()->FormatCode(), 2) << i;
        }
    doc->GetDomain()->Is3D(false);
    EXPECT_EQ(dispersion->Horizontal()->GetItem(1)->ScaledEddyViscosity()->FormatCode(), 2);
}

TEST(Dispersion, ResizingAppendsToBothListsAndKeepsValues) {
    auto doc = NewSetup(2);
    CMTDispersionKiv* dispersion = Dispersion(*doc);
    dispersion->Vertical()->GetItem(2)->FormulationType(1);
    dispersion->Vertical()->GetItem(2)->DispersionCoefficient()->Constant(0.5);
    ModelDefinition(doc->Module())->NumberOfFractions(3);
    for (CMTDispersionListKiv* list : {dispersion->Horizontal(), dispersion->Vertical()}) {
        ASSERT_EQ(list->GetItemCount(), 3);
        EXPECT_EQ(list->GetItem(3)->GetTitle(), "Fraction 3");
        EXPECT_EQ(list->GetItem(3)->FormulationType(), 2);
    }
    EXPECT_EQ(dispersion->Vertical()->GetItem(2)->FormulationType(), 1);
    EXPECT_EQ(dispersion->Vertical()->GetItem(2)->DispersionCoefficient()->Constant(), 0.5);
    ModelDefinition(doc->Module())->NumberOfFractions(1);
    EXPECT_EQ(dispersion->Horizontal()->GetItemCount(), 1);
    EXPECT_EQ(dispersion->Vertical()->GetItemCount(), 1);

    // Titles follow positions, also for an item put in front.
    dispersion->Horizontal()->Insert(1, 1);
    EXPECT_EQ(dispersion->Horizontal()->GetItem(1)->GetTitle(), "Fraction 1");
    EXPECT_EQ(dispersion->Horizontal()->GetItem(2)->GetTitle(), "Fraction 2");
}

TEST(Dispersion, FormulationTextsAndValidation) {
    EXPECT_EQ(CMTDispersionItemKiv::FormulationText(0), "No dispersion");
    EXPECT_EQ(CMTDispersionItemKiv::FormulationText(1), "Dispersion coefficient formulation");
    EXPECT_EQ(CMTDispersionItemKiv::FormulationText(2), "Scaled eddy viscosity formulation");
    EXPECT_EQ(CMTDispersionItemKiv::FormulationText(3), "");
    EXPECT_EQ(CMTDispersionItemKiv::FormulationText(-1), "");

    auto doc = NewSetup(1);
    CMTDispersionKiv* dispersion = Dispersion(*doc);
    CMTDispersionItemKiv* h = dispersion->Horizontal()->GetItem(1);
    CMTDispersionItemKiv* v = dispersion->Vertical()->GetItem(1);
    // Both values of both items want a data file that is not given.
    for (CMTDispersionItemKiv* item : {h, v}) {
        item->ScaledEddyViscosity()->Format(2);
        item->DispersionCoefficient()->Format(2);
    }
    EXPECT_EQ(doc->ValidateAll(), 0);
    ASSERT_EQ(Messages(*doc).size(), 1u);  // the vertical list is not used in two dimensions
    EXPECT_EQ(Messages(*doc)[0].rfind("MUD_TRANSPORT_MODULE/DISPERSION/HORIZONTAL_DISPERSION/"
                                      "SSC_FRACTION_1/SCALED_EDDY_VISCOSITY: ",
                                      0),
              0u);
    EXPECT_FALSE(h->ScaledEddyViscosity()->IsDisabled());
    EXPECT_TRUE(h->DispersionCoefficient()->IsDisabled());

    h->FormulationType(1);
    EXPECT_EQ(doc->ValidateAll(), 0);
    ASSERT_EQ(Messages(*doc).size(), 1u);
    EXPECT_NE(Messages(*doc)[0].find("DISPERSION_COEFFICIENT"), std::string::npos);

    h->FormulationType(0);
    EXPECT_EQ(doc->ValidateAll(), 1);
    EXPECT_TRUE(h->ScaledEddyViscosity()->IsDisabled());
    EXPECT_TRUE(h->DispersionCoefficient()->IsDisabled());

    doc->GetDomain()->Is3D(true);
    EXPECT_EQ(doc->ValidateAll(), 0);
    EXPECT_EQ(Messages(*doc).size(), 1u);
}

TEST(Dispersion, UnknownTypeIsKeptWithAWarning) {
    auto r = CSetupDocument::FromText(DispersionText("    type = 7\n"), "t.setup");
    ASSERT_TRUE(r.document);
    EXPECT_EQ(WarningTexts(r).size(), 1u);
    CMTDispersionItemKiv* item = Dispersion(*r.document)->Horizontal()->GetItem(1);
    EXPECT_EQ(item->FormulationType(), 7);
    EXPECT_EQ(item->FormulationText(), "");
}

TEST(Dispersion, ItemNumbersAndNamesStayInStep) {
    // A new setup writes the numbers as the name; reading that back is no name.
    auto fresh = NewSetup(1);
    auto reread = Load(fresh->ToText());
    CFemInDataFile* file =
        Dispersion(*reread)->Horizontal()->GetItem(1)->DispersionCoefficient()->QrdData();
    EXPECT_EQ(file->ItemName(), "");

    // Every number the form accepts is written and read back, the name follows them.
    file->ItemNumbers({3, 5});
    auto saved = Saved(*reread);
    const auto* k = Find(*saved, {"MUD_TRANSPORT_MODULE", "DISPERSION", "HORIZONTAL_DISPERSION",
                                  "SSC_FRACTION_1", "DISPERSION_COEFFICIENT"});
    ASSERT_NE(k, nullptr);
    EXPECT_EQ(Int(*k, "item_number", 0), 3);
    EXPECT_EQ(Int(*k, "item_number", 1), 5);
    EXPECT_EQ(String(*k, "item_name"), "3, 5");
    auto again = Load(reread->ToText());
    const CFemInDataFile* back =
        Dispersion(*again)->Horizontal()->GetItem(1)->DispersionCoefficient()->QrdData();
    EXPECT_EQ(back->ItemNumbers(), (std::vector<int>{3, 5}));
    EXPECT_EQ(back->ItemName(), "");

    // A real name stays.
    auto named = Load(DispersionText("    DISPERSION_COEFFICIENT {\n     item_number = 2\n"
                                     "     item_name = \"K\"\n    }\n"));
    EXPECT_EQ(Dispersion(*named)->Horizontal()->GetItem(1)->DispersionCoefficient()->QrdData()->ItemName(),
              "K");
}
