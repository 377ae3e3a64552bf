#include "ConditionsTestSupport.h"

using namespace testsupport;
using namespace condtest;

namespace {
CMTSourceKiv* Sources(CSetupDocument& doc) { return MTSources(doc.Module()); }

void Tag(CSetupDocument& doc) {
    CMTSourceKiv* sources = Sources(doc);
    for (int i = 1; i <= sources->GetItemCount(); ++i)
        sources->GetItem(i)->GetItem(1)->Value()->Constant(i);
}
std::vector<double> Tags(CSetupDocument& doc) {
    std::vector<double> out;
    CMTSourceKiv* sources = Sources(doc);
    for (int i = 1; i <= sources->GetItemCount(); ++i)
        out.push_back(sources->GetItem(i)->GetItem(1)->Value()->Constant());
    return out;
}
}  // namespace

TEST(Sources, OneItemPerHydrodynamicSourceWithOneComponentPerFraction) {
    auto doc = NewSetup(2, 1, 0, 2);
    CMTSourceKiv* sources = Sources(*doc);
    ASSERT_EQ(sources->GetItemCount(), 2);
    EXPECT_EQ(testsupport::Titles(sources), (std::vector<CString>{"S1", "S2"}));
    EXPECT_STREQ(sources->GetDlgRuntimeClass(2555), "CHDSourceGisPropSheet");
    EXPECT_STREQ(sources->GetItem(1)->GetDlgRuntimeClass(2555), "CMTSourceItemDlg");
    EXPECT_EQ(sources->GetHelpID(0), 5037u);
    EXPECT_EQ(sources->GetHelpID(1), 5038u);
    EXPECT_EQ(doc->GetImportantNode("MTSource"), sources);
    CMTSourceItemSubKiv* component = sources->GetItem(2)->GetItem(2);
    EXPECT_STREQ(component->GetDlgRuntimeClass(2555), "CMTSourceItemSubDlg");
    EXPECT_EQ(component->GetTitle(), "Fraction 2");
    EXPECT_EQ(component->TypeOfComponent(), 0);
    EXPECT_EQ(component->Value()->Constant(), 0.0);
    EXPECT_EQ(component->Value()->FormatCode(), 1);
    EXPECT_EQ(component->Value()->ItemType(), 100403);
    EXPECT_EQ(component->Value()->GetTitle(), "Fraction 2");

    auto saved = Saved(*doc);
    const auto* s = Find(*saved, {"MUD_TRANSPORT_MODULE", "SOURCES"});
    ASSERT_NE(s, nullptr);
    EXPECT_EQ(Entries(*s), (std::vector<std::string>{"ZoSEKivListItemCount", "[SOURCE_1]",
                                                     "[SOURCE_2]"}));
    const auto* source = s->FindSection("SOURCE_2");
    EXPECT_EQ(Entries(*source), (std::vector<std::string>{"ZoSEKivListItemCount", "name",
                                                          "[SSC_FRACTION_1]",
                                                          "[SSC_FRACTION_2]"}));
    EXPECT_EQ(String(*source, "name"), "S2");
    EXPECT_EQ(Entries(*source->FindSection("SSC_FRACTION_1"))[0], "type_of_component");
}

TEST(Sources, ItemsFollowEveryChangeOfTheHydrodynamicSources) {
    struct Case {
        const char* what;
        void (*change)(CHDSourcesKiv*);
        std::vector<double> tags;  // 0: a new item
    };
    const Case cases[] = {
        {"insert in the middle", [](CHDSourcesKiv* s) { s->Insert(2, 1); }, {1, 0, 2, 3}},
        {"append", [](CHDSourcesKiv* s) { s->Append(); }, {1, 2, 3, 0}},
        {"delete", [](CHDSourcesKiv* s) { s->Delete(3, 1); }, {1, 2}},
        {"move down", [](CHDSourcesKiv* s) { s->MoveDown(2, 1); }, {1, 3, 2}},
        {"move the last down", [](CHDSourcesKiv* s) { s->MoveDown(3, 1); }, {1, 2, 3}},
        {"empty", [](CHDSourcesKiv* s) { s->SetItemCount(0, 1); }, {}},
    };
    for (const Case& c : cases) {
        auto doc = NewSetup(2, 1, 0, 3);
        Tag(*doc);
        c.change(doc->GetSources());
        EXPECT_EQ(Tags(*doc), c.tags) << c.what;
        CMTSourceKiv* sources = Sources(*doc);
        for (int i = 1; i <= sources->GetItemCount(); ++i) {
            EXPECT_EQ(sources->GetItem(i)->GetTitle(), doc->GetSources()->GetItem(i)->Name());
            ASSERT_EQ(sources->GetItem(i)->GetItemCount(), 2) << c.what;
            EXPECT_EQ(sources->GetItem(i)->GetItem(2)->GetTitle(), "Fraction 2");
        }
        EXPECT_EQ(Load(doc->ToText())->ToText(), doc->ToText()) << c.what;
    }
}

TEST(Sources, RenamingAndExcludingAreTheHydrodynamicSourcesOwn) {
    auto doc = NewSetup(1, 1, 0, 2);
    CHDSourceItemKiv* hd = doc->GetSources()->GetItem(2);
    hd->Name("Harbour outfall");
    hd->Include(false);
    CMTSourceItemKiv* item = Sources(*doc)->GetItem(2);
    EXPECT_EQ(item->GetTitle(), "Harbour outfall");
    EXPECT_FALSE(item->IsDlgUsedInSetup());
    EXPECT_TRUE(Sources(*doc)->GetItem(1)->IsDlgUsedInSetup());
    auto saved = Saved(*doc);
    EXPECT_EQ(String(*Find(*saved, {"MUD_TRANSPORT_MODULE", "SOURCES", "SOURCE_2"}), "name"),
              "Harbour outfall");
    // The stored name is not read back: the title is always the hydrodynamic source's.
    auto reloaded = Load(doc->ToText());
    reloaded->GetSources()->GetItem(2)->Name("Renamed");
    EXPECT_EQ(Sources(*reloaded)->GetItem(2)->GetTitle(), "Renamed");
}

TEST(Sources, TheTypeOfComponentGoesWithTheValue) {
    auto doc = NewSetup(2, 1, 0, 1);
    CMTSourceItemSubKiv* component = Sources(*doc)->GetItem(1)->GetItem(2);
    component->TypeOfComponent(CMTSourceItemSubKiv::kExcessConcentration);
    component->Value()->Constant(0.3);
    auto saved = Saved(*doc);
    const auto* s = Find(*saved, {"MUD_TRANSPORT_MODULE", "SOURCES", "SOURCE_1", "SSC_FRACTION_2"});
    ASSERT_NE(s, nullptr);
    EXPECT_EQ(Int(*s, "type_of_component"), 1);
    EXPECT_EQ(Double(*s, "constant_value"), 0.3);
    EXPECT_EQ(component->Value()->Type(), 2);
    EXPECT_EQ(Sources(*doc)->GetItem(1)->GetItem(1)->Value()->Type(), 1);
    auto reloaded = Load(doc->ToText());
    EXPECT_EQ(Sources(*reloaded)->GetItem(1)->GetItem(2)->TypeOfComponent(), 1);
    EXPECT_EQ(CMTSourceItemSubKiv::TypeText(0), "Specified concentration");
    EXPECT_EQ(CMTSourceItemSubKiv::TypeText(1), "Excess concentration");
}

TEST(Sources, EverySourceFollowsTheNumberOfFractions) {
    auto doc = NewSetup(2, 1, 0, 2);
    CParameterSelectionKiv* model = ModelDefinition(doc->Module());
    model->NumberOfFractions(3);
    for (int i = 1; i <= 2; ++i) {
        ASSERT_EQ(Sources(*doc)->GetItem(i)->GetItemCount(), 3);
        EXPECT_EQ(Sources(*doc)->GetItem(i)->GetItem(3)->GetTitle(), "Fraction 3");
        EXPECT_EQ(Sources(*doc)->GetItem(i)->GetItem(3)->TypeOfComponent(), 0);
    }
    model->NumberOfFractions(1);
    EXPECT_EQ(Sources(*doc)->GetItem(2)->GetItemCount(), 1);
    model->NumberOfFractions(2);
    EXPECT_EQ(Sources(*doc)->GetItem(2)->GetItem(2)->GetTitle(), "Fraction 2");
}

TEST(Sources, CountsAndChoicesInTheFileThatCannotBeUsedAreReported) {
    const std::string body =
        " SOURCES {\n  ZoSEKivListItemCount = 3\n"
        "  SOURCE_1 {\n   ZoSEKivListItemCount = 9\n   name = \"stale\"\n"
        "   SSC_FRACTION_1 {\n    type_of_component = 4\n    constant_value = 0.2\n   }\n  }\n }\n";
    CSetupDocument::OpenResult r =
        CSetupDocument::FromText(HostText(0, 1) + ModuleText(1, 1, body), "t.setup");
    ASSERT_TRUE(r.document);
    EXPECT_EQ(WarningTexts(r),
              (std::vector<std::string>{
                  "ZoSEKivListItemCount = 3, but the setup has 1 source; the list follows them",
                  "ZoSEKivListItemCount = 9, but the setup has 1 fraction; the list follows them",
                  "type_of_component = 4 is not a known choice (0 to 1); kept as read"}));
    CMTSourceKiv* sources = Sources(*r.document);
    ASSERT_EQ(sources->GetItemCount(), 1);
    EXPECT_EQ(sources->GetItem(1)->GetItemCount(), 1);
    EXPECT_EQ(sources->GetItem(1)->GetTitle(), "S1");
    EXPECT_EQ(sources->GetItem(1)->GetItem(1)->TypeOfComponent(), 4);
    EXPECT_EQ(sources->GetItem(1)->GetItem(1)->Value()->Constant(), 0.2);
}
