#include "ConditionsTestSupport.h"
#include "fem/SimulationPeriodKiv.h"

#include <filesystem>
#include <fstream>

namespace fs = std::filesystem;

#include <fstream>
#include <sstream>

using namespace testsupport;
using namespace condtest;

namespace {
CMTBoundaryConditionsKiv* Conditions(CSetupDocument& doc) { return MTBoundaryConditions(doc.Module()); }

// Each component's first value carries its boundary's original number as a constant, so
// that the components can be followed through the host's changes.
void Tag(CSetupDocument& doc) {
    CMTBoundaryConditionsKiv* bc = Conditions(doc);
    for (int i = 1; i <= bc->GetItemCount(); ++i)
        bc->GetItem(i)->GetItem(1)->Constant(i);
}
std::vector<double> Tags(CSetupDocument& doc) {
    std::vector<double> out;
    CMTBoundaryConditionsKiv* bc = Conditions(doc);
    for (int i = 1; i <= bc->GetItemCount(); ++i)
        out.push_back(bc->GetItem(i)->GetItemCount() ? bc->GetItem(i)->GetItem(1)->Constant() : -1);
    return out;
}
std::vector<CString> Titles(CSetupDocument& doc) { return testsupport::Titles(Conditions(doc)); }
}  // namespace

TEST(BoundaryConditions, OneComponentPerBoundaryAndOneZeroGradientPerFraction) {
    auto doc = NewSetup(2, 1, 3);
    CMTBoundaryConditionsKiv* bc = Conditions(*doc);
    ASSERT_EQ(bc->GetItemCount(), 3);
    EXPECT_EQ(Titles(*doc), (std::vector<CString>{"B1", "B2", "B3"}));
    EXPECT_EQ(bc->GetItem(2)->BoundaryCode(), 3);
    EXPECT_TRUE(bc->IsDlgUsedInSetup());
    EXPECT_STREQ(bc->GetDlgRuntimeClass(2555), "CMTBoundaryConditionsPropertySheet");
    EXPECT_STREQ(bc->GetItem(1)->GetDlgRuntimeClass(2555), "CMTBoundaryConditionsComponentDlg");
    const CMTBoundaryConditionsComponentItemKiv* item = bc->GetItem(3)->GetItem(2);
    ASSERT_NE(item, nullptr);
    EXPECT_STREQ(const_cast<CMTBoundaryConditionsComponentItemKiv*>(item)->GetDlgRuntimeClass(2555),
                 "CMTBoundaryConditionsComponentItemDlg");
    EXPECT_EQ(item->GetTitle(), "Fraction 2");
    EXPECT_EQ(item->GetAbbreviatedTitle(), "Fraction 2");
    EXPECT_EQ(item->Type(), 2);
    EXPECT_EQ(item->TypeText(), "Zero gradient");
    EXPECT_EQ(item->TypeTextArr(),
              (std::vector<CString>{"Land", "Specified values", "Zero gradient"}));
    EXPECT_EQ(item->Format(), 0);
    EXPECT_EQ(item->Constant(), 0.0);
    EXPECT_EQ(item->SoftTime(), 0.0);
    EXPECT_EQ(item->RefSoft(), 0.0);
    EXPECT_EQ(item->TypeSoft(), 2);
    EXPECT_EQ(item->TypeTI(), 1);
    EXPECT_EQ(item->TypeSI(), 1);
    EXPECT_EQ(item->OvuType(), 100403);
    EXPECT_NE(doc->GetImportantNode("MudTransportBoundaryConditions"), nullptr);

    // Written: the count, CODE_1 first whatever the boundaries are called, then one
    // section per boundary named like the boundary's.
    auto saved = Saved(*doc);
    const auto* s = Find(*saved, {"MUD_TRANSPORT_MODULE", "BOUNDARY_CONDITIONS"});
    ASSERT_NE(s, nullptr);
    EXPECT_EQ(Entries(*s), (std::vector<std::string>{"ZoSEKivListItemCount", "[CODE_1]",
                                                     "[BOUNDARY_1]", "[BOUNDARY_2]",
                                                     "[BOUNDARY_3]"}));
    EXPECT_EQ(Int(*s, "ZoSEKivListItemCount"), 3);
    EXPECT_EQ(s->FindSection("CODE_1")->EntryCount(), 0);
    const auto* component = s->FindSection("BOUNDARY_2");
    EXPECT_EQ(Entries(*component), (std::vector<std::string>{"ZoSEKivListItemCount",
                                                             "[SSC_FRACTION_1]",
                                                             "[SSC_FRACTION_2]"}));
    const auto* value = component->FindSection("SSC_FRACTION_2");
    EXPECT_EQ(Int(*value, "type"), 2);
    EXPECT_EQ(Int(*value, "soft_start_type"), 2);
    EXPECT_EQ(Int(*value, "time_interpolation"), 1);
    EXPECT_EQ(Int(*value, "space_interpolation"), 1);
}

TEST(BoundaryConditions, NoOpenBoundaryMeansNotUsed) {
    auto doc = NewSetup(2, 1);
    EXPECT_EQ(Conditions(*doc)->GetItemCount(), 0);
    EXPECT_FALSE(Conditions(*doc)->IsDlgUsedInSetup());
    EXPECT_EQ(doc->ValidateAll(), 1);
}

TEST(BoundaryConditions, ComponentsFollowEveryChangeOfTheBoundaryList) {
    struct Case {
        const char* what;
        void (*change)(CBoundaryNamesKiv*);
        std::vector<double> tags;  // 0: a new component
    };
    const Case cases[] = {
        {"insert in the middle", [](CBoundaryNamesKiv* b) { b->Insert(2, 1); }, {1, 0, 2, 3, 4}},
        {"insert past the end", [](CBoundaryNamesKiv* b) { b->Insert(9, 1); }, {1, 2, 3, 4}},
        {"append", [](CBoundaryNamesKiv* b) { b->Append(); }, {1, 2, 3, 4, 0}},
        {"delete", [](CBoundaryNamesKiv* b) { b->Delete(1, 1); }, {2, 3, 4}},
        {"delete past the end", [](CBoundaryNamesKiv* b) { b->Delete(7, 1); }, {1, 2, 3, 4}},
        {"move up", [](CBoundaryNamesKiv* b) { b->MoveUp(3, 1); }, {1, 3, 2, 4}},
        {"move down", [](CBoundaryNamesKiv* b) { b->MoveDown(1, 1); }, {2, 1, 3, 4}},
        {"move the first up", [](CBoundaryNamesKiv* b) { b->MoveUp(1, 1); }, {1, 2, 3, 4}},
        {"shrink", [](CBoundaryNamesKiv* b) { b->SetItemCount(2, 1); }, {1, 2}},
        {"negative count", [](CBoundaryNamesKiv* b) { b->SetItemCount(-3, 1); }, {}},
    };
    for (const Case& c : cases) {
        auto doc = NewSetup(3, 1, 4);
        Tag(*doc);
        c.change(doc->GetBoundaryNames());
        EXPECT_EQ(Tags(*doc), c.tags) << c.what;
        // Titles, codes and every component's fractions follow as well.
        CBoundaryNamesKiv* names = doc->GetBoundaryNames();
        CMTBoundaryConditionsKiv* bc = Conditions(*doc);
        for (int i = 1; i <= bc->GetItemCount(); ++i) {
            EXPECT_EQ(bc->GetItem(i)->GetTitle(), names->GetItem(i)->Identifier()) << c.what;
            EXPECT_EQ(bc->GetItem(i)->BoundaryCode(), names->GetItem(i)->BoundaryCode()) << c.what;
            EXPECT_EQ(bc->GetItem(i)->GetItemCount(), 3) << c.what;
        }
        // A new component is unnamed until the next save, then named like its boundary.
        EXPECT_EQ(Load(doc->ToText())->ToText(), doc->ToText()) << c.what;
        for (int i = 1; i <= bc->GetItemCount(); ++i)
            EXPECT_EQ(bc->GetItem(i)->GetSectionName(), names->GetItem(i)->GetSectionName());
    }
}

TEST(BoundaryConditions, ValuesTravelWithTheirBoundaryThroughAMoveAndASave) {
    auto doc = NewSetup(2, 1, 2);
    CMTBoundaryConditionsKiv* bc = Conditions(*doc);
    bc->GetItem(1)->GetItem(2)->Type(1);
    bc->GetItem(1)->GetItem(2)->Constant(0.04);
    bc->GetItem(2)->GetItem(1)->Type(0);
    doc->GetBoundaryNames()->MoveDown(1, 1);
    auto reloaded = Load(doc->ToText());
    CMTBoundaryConditionsKiv* again = Conditions(*reloaded);
    EXPECT_EQ(testsupport::Titles(again), (std::vector<CString>{"B2", "B1"}));
    EXPECT_EQ(again->GetItem(1)->GetItem(1)->TypeText(), "Land");
    EXPECT_EQ(again->GetItem(2)->GetItem(2)->TypeText(), "Specified values");
    EXPECT_EQ(again->GetItem(2)->GetItem(2)->Constant(), 0.04);
    EXPECT_EQ(reloaded->ToText(), doc->ToText());
}

TEST(BoundaryConditions, EveryComponentFollowsTheNumberOfFractions) {
    auto doc = NewSetup(2, 1, 3);
    CMTBoundaryConditionsKiv* bc = Conditions(*doc);
    bc->GetItem(2)->GetItem(1)->Type(1);
    CParameterSelectionKiv* model = ModelDefinition(doc->Module());
    model->NumberOfFractions(3);
    for (int i = 1; i <= 3; ++i) {
        ASSERT_EQ(bc->GetItem(i)->GetItemCount(), 3);
        EXPECT_EQ(bc->GetItem(i)->GetItem(3)->TypeText(), "Zero gradient");
        EXPECT_EQ(bc->GetItem(i)->GetItem(3)->GetSectionName(), "SSC_FRACTION_3");
    }
    EXPECT_EQ(bc->GetItem(2)->GetItem(1)->Type(), 1);
    model->NumberOfFractions(1);
    for (int i = 1; i <= 3; ++i)
        EXPECT_EQ(bc->GetItem(i)->GetItemCount(), 1);
    EXPECT_EQ(bc->GetItem(2)->GetItem(1)->Type(), 1);
    // A boundary added now starts with the current number of fractions.
    doc->GetBoundaryNames()->Insert(1, 1);
    EXPECT_EQ(bc->GetItem(1)->GetItemCount(), 1);
}

TEST(BoundaryConditions, CountsInTheFileThatDisagreeAreReportedAndTheHostIsFollowed) {
    const std::string body =
        " BOUNDARY_CONDITIONS {\n  ZoSEKivListItemCount = 5\n  CODE_1 {\n  }\n"
        "  BOUNDARY_1 {\n   ZoSEKivListItemCount = 4\n"
        "   SSC_FRACTION_2 {\n    type = 1\n    constant_value = 0.5\n   }\n"
        "   SSC_FRACTION_4 {\n    type = 1\n   }\n  }\n"
        "  BOUNDARY_5 {\n   ZoSEKivListItemCount = 2\n  }\n }\n";
    CSetupDocument::OpenResult r =
        CSetupDocument::FromText(HostText(2, 0) + ModuleText(2, 1, body), "t.setup");
    ASSERT_TRUE(r.document);
    EXPECT_EQ(WarningTexts(r),
              (std::vector<std::string>{
                  "ZoSEKivListItemCount = 5, but the setup has 2 boundaries; the list follows "
                  "them",
                  "1 of 2 sections is missing (BOUNDARY_2); those items take their defaults",
                  "ZoSEKivListItemCount = 4, but the setup has 2 fractions; the list follows "
                  "them",
                  "1 of 2 sections is missing (SSC_FRACTION_1); those items take their defaults",
                  // What lies beyond the counts is reported as content no section reads.
                  "unknown section 'SSC_FRACTION_4' in "
                  "MUD_TRANSPORT_MODULE/BOUNDARY_CONDITIONS/BOUNDARY_1: not read, dropped on saving",
                  "unknown section 'BOUNDARY_5' in MUD_TRANSPORT_MODULE/BOUNDARY_CONDITIONS: not "
                  "read, dropped on saving"}));
    CMTBoundaryConditionsKiv* bc = Conditions(*r.document);
    ASSERT_EQ(bc->GetItemCount(), 2);
    EXPECT_EQ(bc->GetItem(1)->GetItemCount(), 2);
    EXPECT_EQ(bc->GetItem(1)->GetItem(2)->Constant(), 0.5);
    EXPECT_EQ(bc->GetItem(2)->GetItemCount(), 2);
    // Saving and validating stay within the lists.
    EXPECT_EQ(r.document->ValidateAll(), 1);
    EXPECT_NE(r.document->ToText().find("BOUNDARY_2 {"), std::string::npos);
}

TEST(BoundaryConditions, ValidationOfValuesNamesTheBoundaryAsItIsNow) {
    struct Case {
        const char* what;
        int type;
        int format;
        double constant;
        const char* file;
        double softTime;
        std::vector<int> items;
        int softType;
        const char* message;  // null: valid
    };
    const Case cases[] = {
        {"zero gradient ignores its constant", 2, 0, -1.0, "", 0.0, {1}, 2, nullptr},
        {"land", 0, 0, 0.0, "", 0.0, {1}, 2, nullptr},
        {"zero gradient ignores its soft start", 2, 0, 0.0, "", -1.0, {1}, 7, nullptr},
        {"specified constant", 1, 0, 0.02, "", 0.0, {1}, 2, nullptr},
        {"negative concentration", 1, 0, -0.02, "", 0.0, {1}, 2,
         "Constant value must be larger than or equal to 0.0"},
        {"time series without a file", 1, 1, 0.0, "", 0.0, {1}, 2,
         "No data file is given for the boundary values"},
        {"time series with a file that is not there", 1, 1, 0.0, "ssc.qrd0", 0.0, {1}, 2,
         "File is not valid"},
        {"no item chosen", 1, 3, 0.0, "ssc.qrd0", 0.0, {}, 2,
         "No item of the data file is chosen for the boundary values"},
        {"item number below 1", 1, 2, 0.0, "ssc.qrd0", 0.0, {2, 0}, 2,
         "Item number 0 of the data file is not valid"},
        {"unknown format", 1, 7, 0.0, "", 0.0, {1}, 2, "Format 7 is not known"},
        {"unknown type", 5, 0, 0.0, "", 0.0, {1}, 2, "Boundary type 5 is not known"},
        {"negative soft start", 1, 0, 0.0, "", -10.0, {1}, 2,
         "The soft-start interval must not be negative"},
        {"unknown soft-start type", 1, 0, 0.0, "", 0.0, {1}, 3, "Values out of range"},
    };
    // docs/conditions.md states every check, with N for the number in the message.
    // Words joined by single spaces, a number standing alone as N.
    auto words = [](std::istream&& in) {
        std::string out, word;
        while (in >> word)
            out += (out.empty() ? "" : " ") +
                   (word.find_first_not_of("-0123456789") == std::string::npos ? std::string("N") : word);
        return out;
    };
    const std::string documented = words(std::ifstream(MUD_SOURCE_DIR "/docs/conditions.md"));
    for (const Case& c : cases) {
        auto doc = NewSetup(1, 1, 2);
        CMTBoundaryConditionsComponentItemKiv* item = Conditions(*doc)->GetItem(2)->GetItem(1);
        item->Type(c.type);
        item->Format(c.format);
        item->Constant(c.constant);
        item->QrdData()->FileName(c.file);
        item->QrdData()->ItemNumbers(c.items);
        item->SoftTime(c.softTime);
        item->TypeSoft(c.softType);
        // A boundary inserted ahead since the last save: the message names the boundary's
        // place now.
        doc->GetBoundaryNames()->Insert(1, 1);
        EXPECT_EQ(doc->ValidateAll(), c.message ? 0 : 1) << c.what;
        std::vector<std::string> expected;
        if (c.message)
            expected.push_back(
                std::string("MUD_TRANSPORT_MODULE/BOUNDARY_CONDITIONS/BOUNDARY_3/SSC_FRACTION_1: ") +
                c.message);
        EXPECT_EQ(Messages(*doc), expected) << c.what;
        if (c.message) {
            const std::string general = words(std::istringstream(c.message));
            EXPECT_NE(documented.find('"' + general + '"'), std::string::npos) << general;
        }
    }
}

TEST(BoundaryConditions, ReInitializeRestoresTheModulesDefaults) {
    auto doc = NewSetup(1, 1, 1);
    CMTBoundaryConditionsComponentKiv* component = Conditions(*doc)->GetItem(1);
    component->GetItem(1)->Type(1);
    component->GetItem(1)->TypeSI(0);
    component->GetItem(1)->QrdData()->FileName("x.qrd0");
    component->ReInitialize(1, true);
    EXPECT_EQ(component->GetItem(1)->Type(), 2);
    EXPECT_EQ(component->GetItem(1)->TypeSI(), 1);
    EXPECT_EQ(component->GetItem(1)->QrdData()->FileName(), "");
}

TEST(BoundaryConditions, ValuesDroppedWithAFractionComeBackAsNew) {
    // Items that fewer fractions drop are kept for reuse; they must come back exactly as new
    // ones would, in boundary conditions and in sources alike.
    auto edited = NewSetup(3, 1, 2, 2);
    auto fresh = NewSetup(3, 1, 2, 2);
    CMTBoundaryConditionsComponentItemKiv* item = Conditions(*edited)->GetItem(1)->GetItem(3);
    item->Type(1);
    item->Format(1);
    item->QrdData()->FileName("sea.qrd0");
    item->TypeSoft(0);
    item->SetHasBeenTouched(true);
    CMTSourceItemSubKiv* component = MTSources(edited->Module())->GetItem(2)->GetItem(3);
    component->TypeOfComponent(1);
    component->Value()->Format(1);
    component->Value()->QrdData()->FileName("outfall.qrd0");
    component->SetHasBeenTouched(true);
    (void)edited->ToText();  // leaves the value's type set from the component's
    CParameterSelectionKiv* model = ModelDefinition(edited->Module());
    model->NumberOfFractions(1);
    model->NumberOfFractions(3);
    EXPECT_FALSE(Conditions(*edited)->GetItem(1)->GetItem(3)->GetHasBeenTouched());
    CMTSourceItemSubKiv* again = MTSources(edited->Module())->GetItem(2)->GetItem(3);
    EXPECT_EQ(again->GetTitle(), "Fraction 3");
    EXPECT_EQ(again->Value()->GetTitle(), "Fraction 3");
    EXPECT_EQ(again->Value()->Type(), 0);
    EXPECT_FALSE(again->GetHasBeenTouched());
    EXPECT_EQ(edited->ToText(), fresh->ToText());
}

// A value read from a data file passes only with a file that will do, and the message says
// what is wrong with it.
TEST(BoundaryConditions, AValuesDataFileIsCheckedAndTheReasonGiven) {
    const fs::path dir = fs::temp_directory_path() / "mudsetup-boundary-files";
    fs::remove_all(dir);
    fs::create_directories(dir / "folder.qrd0");
    auto write = [&](const char* name, const std::string& text) {
        std::ofstream(dir / name, std::ios::binary) << text;
    };
    // Hourly over a day from 2024-01-01.
    auto header = [](const char* kind, long unitType, const char* layout, int steps = 25) {
        return std::string(kind) + " 1\nstart 2024-01-01 00:00:00\nstep 3600\nsteps " +
               std::to_string(steps) + "\n" + layout + "items 1\nitem \"ssc\" " +
               std::to_string(unitType) + "\nvalues\n";
    };
    write("ssc.qrd0", header("qrd0", 100403, ""));
    write("short.qrd0", header("qrd0", 100403, "", 3));
    write("height.qrd0", header("qrd0", 100084, ""));
    write("line.qrd1", header("qrd1", 100403, "points 4\n"));
    write("stations.xyz", "1 2 3 a\n");
    struct Case {
        int format;
        const char* file;
        const char* reason;  // part of the detail; null: valid
    };
    const Case cases[] = {
        {1, "ssc.qrd0", nullptr},
        {1, "none.qrd0", "none.qrd0: the file does not exist"},
        {1, "folder.qrd0", "is a folder"},
        {1, "stations.xyz", "stations.xyz"},
        {1, "line.qrd1", "a line series file, where a time series file is needed"},
        {1, "height.qrd0", "is a Wave height"},
        {1, "short.qrd0", "does not cover the simulation period"},
        {2, "line.qrd1", nullptr},
        {3, "line.qrd1", nullptr},
        {2, "ssc.qrd0", "a time series file, where a line series file is needed"},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(::testing::Message() << c.format << " " << c.file);
        auto doc = NewSetup(1, 1, 1);
        doc->GetPeriod()->StartTime("2024-01-01 00:00:00");
        doc->GetPeriod()->TimeStepInterval(3600);
        doc->GetPeriod()->TimeStepCount(24);
        CMTBoundaryConditionsComponentItemKiv* item = Conditions(*doc)->GetItem(1)->GetItem(1);
        item->Type(1);
        item->Format(c.format);
        item->QrdData()->FileName((dir / c.file).string());
        item->QrdData()->ItemNumbers({1});
        doc->ValidateAll();
        std::vector<const CZoSEKivGlobalBase::ErrorEntry*> errors;
        for (const auto& e : doc->Errors())
            if (e.node == item)
                errors.push_back(&e);
        CString why;
        EXPECT_EQ(item->CheckFile(&why), c.reason == nullptr) << why;
        if (!c.reason) {
            EXPECT_TRUE(errors.empty()) << errors.front()->Text();
            continue;
        }
        ASSERT_EQ(errors.size(), 1u);
        EXPECT_EQ(errors[0]->message, "File is not valid");
        EXPECT_NE(errors[0]->detail.find(c.reason), std::string::npos) << errors[0]->detail;
        EXPECT_EQ(errors[0]->Text(), "File is not valid: " + errors[0]->detail);
    }
    fs::remove_all(dir);
}
