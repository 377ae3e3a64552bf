// The host's own data: domain with its boundaries, simulation period, sources, density,
// wind forcing, and the lists of other modules that follow the boundaries and sources.
#include "TestSupport.h"
#include "support/SyncedFollower.h"

#include "fem/BoundaryNamesKiv.h"
#include "fem/DomainKiv.h"
#include "fem/SimulationPeriodKiv.h"
#include "host/ModuleSelection.h"
#include "hydro/HDBoundaryConditionsKiv.h"
#include "hydro/HDDensityKiv.h"
#include "hydro/HDSourcesKiv.h"
#include "hydro/HDWindForcingKiv.h"

#include <algorithm>

using namespace testsupport;

namespace {

// Counts domain messages by code.
class DomainSpy : public CFemListener {
public:
    void Notify(CFemNotifier*, ENotifyMessage m) override { messages.push_back(m); }
    std::vector<ENotifyMessage> messages;
};

void Fill(CSetupDocument& doc) {
    CDomainKiv* d = doc.GetDomain();
    d->MeshFile("mesh\\estuary.2dm");
    d->SetMeshInfo({470000.5, 560000.25, 5920000, 5980000, -35.5, 2.0});
    d->Projection("UTM-32");
    d->ThreeD(true);
    d->VerticalKind(2);
    d->LayerCount1(10);
    d->LayerCount2(5);
    CBoundaryNamesKiv* b = doc.GetBoundaryNames();
    b->Append()->Identifier("Sea boundary");
    b->Append()->Identifier("River \"Elbe\"");
    b->GetItem(2)->BoundaryCode(7);
    doc.GetPeriod()->StartTime("2021-06-01 00:00:00");
    doc.GetPeriod()->TimeStepCount(8640);
    doc.GetPeriod()->TimeStepInterval(30.0);
    doc.GetDensity()->DensityMode(3);
    CHDSourcesKiv* s = doc.GetSources();
    CHDSourceItemKiv* first = s->Append();
    first->Name("Brunsbüttel outfall");
    first->X(512345.125);
    first->Y(5951234.5);
    s->Append()->Include(false);
    doc.GetWind()->Include(true);
    doc.GetWind()->WindType(2);
    doc.GetModuleSelection()->SpectralWaveMode(1);
}

}  // namespace

TEST(HostData, EveryValueSurvivesSaveAndLoad) {
    CSetupDocument doc;
    Fill(doc);
    const std::string text = doc.ToText();
    std::unique_ptr<CSetupDocument> back = Load(text);
    ASSERT_TRUE(back);

    const CDomainKiv* d = back->GetDomain();
    EXPECT_TRUE(d->MeshExist());
    EXPECT_EQ(d->MeshFile(), "mesh\\estuary.2dm");
    const MeshInfo box = d->GetMeshInfo();
    EXPECT_EQ(box.xMin, 470000.5);
    EXPECT_EQ(box.xMax, 560000.25);
    EXPECT_EQ(box.zMin, -35.5);
    EXPECT_TRUE(d->ThreeD());
    EXPECT_EQ(d->VerticalKind(), 2);
    EXPECT_EQ(d->LayerTotNum(), 15);

    EXPECT_EQ(Titles(back->GetBoundaryNames()),
              (std::vector<CString>{"Sea boundary", "River \"Elbe\""}));
    EXPECT_EQ(back->GetBoundaryNames()->GetItem(1)->BoundaryCode(), 2);
    EXPECT_EQ(back->GetBoundaryNames()->GetItem(2)->BoundaryCode(), 7);
    EXPECT_EQ(back->GetBoundaryNames()->GetItem(2)->GetSectionName(), "BOUNDARY_2");

    EXPECT_EQ(back->GetPeriod()->StartTime(), "2021-06-01 00:00:00");
    EXPECT_EQ(back->GetPeriod()->TimeStepCount(), 8640);
    EXPECT_EQ(back->GetDensity()->DensityMode(), 3);

    ASSERT_EQ(back->GetSources()->GetItemCount(), 2);
    const CHDSourceItemKiv* s1 = back->GetSources()->GetItem(1);
    EXPECT_EQ(s1->Name(), "Brunsbüttel outfall");
    EXPECT_EQ(s1->X(), 512345.125);
    EXPECT_EQ(s1->Y(), 5951234.5);
    EXPECT_EQ(s1->Include(), 1);
    EXPECT_EQ(back->GetSources()->GetItem(2)->Include(), 0);
    EXPECT_EQ(back->GetSources()->GetItem(2)->Name(), "Source 2");
    // A source added with a mesh starts in its middle.
    EXPECT_EQ(back->GetSources()->GetItem(2)->X(), (470000.5 + 560000.25) / 2);

    EXPECT_EQ(back->GetWind()->Include(), 1);
    EXPECT_EQ(back->GetWind()->WindType(), 2);
    EXPECT_EQ(back->GetModuleSelection()->SpectralWaveMode(), 1);

    EXPECT_EQ(back->ToText(), text);
    // Valid but for the mesh, which is named and not there.
    EXPECT_EQ(back->ValidateAll(), 0);
    const std::vector<std::string> messages = Messages(*back);
    ASSERT_EQ(messages.size(), 1u) << ::testing::PrintToString(messages);
    EXPECT_EQ(messages[0].rfind("DOMAIN: The mesh cannot be read: ", 0), 0u) << messages[0];
}

TEST(HostData, HostSectionsComeFirstAndBoundariesLiveInTheDomain) {
    CSetupDocument doc;
    Fill(doc);
    std::unique_ptr<paramfile::Document> saved = Saved(doc);
    ASSERT_TRUE(saved);
    std::vector<std::string> top = Entries(saved->Root());
    EXPECT_EQ(top, (std::vector<std::string>{"[MODULE_SELECTION]", "[DOMAIN]",
                                             "[SIMULATION_PERIOD]", "[HYDRODYNAMIC_DENSITY]",
                                             "[HYDRODYNAMIC_SOURCES]", "[HYDRODYNAMIC_WIND]",
                                             "[MUD_TRANSPORT_MODULE]"}));
    const paramfile::Section* b = Find(*saved, {"DOMAIN", "BOUNDARY_NAMES", "BOUNDARY_2"});
    ASSERT_TRUE(b);
    EXPECT_EQ(String(*b, "name"), "River \"Elbe\"");
    EXPECT_EQ(Int(*b, "code"), 7);
    const paramfile::Section* s = Find(*saved, {"HYDRODYNAMIC_SOURCES", "SOURCE_2"});
    ASSERT_TRUE(s);
    EXPECT_EQ(Entries(*s), (std::vector<std::string>{"name", "include", "x", "y"}));
    EXPECT_EQ(Int(*s, "include"), 0);
}

TEST(HostData, AModuleOnlyFileTakesTheHostDefaults) {
    std::unique_ptr<CSetupDocument> doc =
        Load("MUD_TRANSPORT_MODULE {\n    MODEL_DEFINITION {\n        number_of_fractions = 2\n"
             "    }\n}\n");
    ASSERT_TRUE(doc);
    EXPECT_FALSE(doc->GetDomain()->MeshExist());
    EXPECT_FALSE(doc->GetDomain()->Is3D());
    EXPECT_EQ(doc->GetBoundaryNames()->GetItemCount(), 0);
    EXPECT_EQ(doc->GetBoundaryConditions()->GetItemCount(), 0);
    EXPECT_EQ(doc->GetSources()->GetItemCount(), 0);
    EXPECT_EQ(doc->GetPeriod()->TimeStepCount(), 0);
    EXPECT_EQ(doc->GetModuleSelection()->Mode(), 2);
    EXPECT_EQ(doc->GetWind()->Include(), 0);
    EXPECT_EQ(doc->GetDensity()->DensityMode(), 0);
    EXPECT_EQ(doc->ValidateAll(), 1) << ::testing::PrintToString(Messages(*doc));
}

TEST(HostData, SyncedListsFollowEveryChangeOfTheBoundaries) {
    CSetupDocument doc;
    CBoundaryNamesKiv* names = doc.GetBoundaryNames();
    names->Append()->Identifier("Sea");
    Follower synced(names);

    names->Append()->Identifier("Elbe");
    synced.Tag();
    names->Append()->Identifier("Oste");
    synced.Tag();
    EXPECT_EQ(synced.Tags(), (std::vector<CString>{"Sea", "Elbe", "Oste"}));

    names->Insert(1, 1);
    names->GetItem(1)->Identifier("North");
    synced.Tag();
    EXPECT_EQ(synced.Tags(), (std::vector<CString>{"North", "Sea", "Elbe", "Oste"}));

    EXPECT_TRUE(names->MoveDown(1, 1));
    EXPECT_TRUE(names->MoveUp(4, 1));
    EXPECT_EQ(Titles(names), (std::vector<CString>{"Sea", "North", "Oste", "Elbe"}));
    EXPECT_EQ(synced.Tags(), Titles(names));
    // The view of the boundary conditions is titled by position, whatever moved.
    EXPECT_EQ(Titles(doc.GetBoundaryConditions()), Titles(names));

    names->Delete(2, 1);
    EXPECT_EQ(synced.Tags(), (std::vector<CString>{"Sea", "Oste", "Elbe"}));
    EXPECT_EQ(Titles(doc.GetBoundaryConditions()), Titles(names));
    // Section names follow the positions.
    EXPECT_EQ(names->GetItem(3)->GetSectionName(), "BOUNDARY_3");

    // Loading resizes the followers before the boundaries are read.
    std::unique_ptr<CSetupDocument> loaded = Load(
        "DOMAIN {\n BOUNDARY_NAMES {\n  ZoSEKivListItemCount = 2\n"
        "  BOUNDARY_1 {\n   name = \"A\"\n  }\n  BOUNDARY_2 {\n   name = \"B\"\n  }\n }\n}\n");
    ASSERT_TRUE(loaded);
    EXPECT_EQ(Titles(loaded->GetBoundaryConditions()), (std::vector<CString>{"A", "B"}));
}

TEST(HostData, SyncedListsFollowEveryChangeOfTheSources) {
    CSetupDocument doc;
    CHDSourcesKiv* sources = doc.GetSources();
    Follower synced(sources);

    sources->Append()->Name("Outfall");
    synced.Tag();
    sources->Append()->Name("Harbour");
    synced.Tag();
    sources->Insert(2, 1);
    sources->GetItem(2)->Name("Intake");
    synced.Tag();
    EXPECT_EQ(synced.Tags(), (std::vector<CString>{"Outfall", "Intake", "Harbour"}));
    EXPECT_TRUE(sources->MoveUp(3, 1));
    EXPECT_FALSE(sources->MoveUp(1, 1));
    EXPECT_EQ(synced.Tags(), Titles(sources));
    sources->Delete(1, 1);
    EXPECT_EQ(synced.Tags(), (std::vector<CString>{"Harbour", "Intake"}));
    EXPECT_EQ(sources->GetItem(1)->GetSectionName(), "SOURCE_1");
    sources->SetItemCount(0, 1);
    EXPECT_EQ(synced.GetItemCount(), 0);
}

TEST(HostData, DomainChangesReachItsListeners) {
    CSetupDocument doc;
    CDomainKiv* d = doc.GetDomain();
    DomainSpy spy;
    spy.Listen(d);
    d->ThreeD(true);
    d->LayerCount1(8);
    d->LayerCount2(2);
    d->VerticalKind(2);
    d->MeshFile("a.2dm");
    d->SetMeshInfo({});
    d->Projection("LONG/LAT");
    EXPECT_EQ(spy.messages, (std::vector<ENotifyMessage>{3, 11, 11, 11, 10, 10, 10}));
    EXPECT_EQ(d->LayerTotNum(), 10);

    // Reading tells them too: whatever changed, they see the domain as read.
    CSetupDocument fresh;
    DomainSpy readSpy;
    readSpy.Listen(fresh.GetDomain());
    paramfile::ParseResult p = paramfile::ParseText("DOMAIN {\n three_dimensional = 1\n}\n", "t");
    ASSERT_TRUE(p.document);
    fresh.GetDomain()->Load(const_cast<paramfile::Section*>(&p.document->Root()));
    EXPECT_TRUE(fresh.GetDomain()->Is3D());
    EXPECT_EQ(readSpy.messages, (std::vector<ENotifyMessage>{10, 3, 11}));
}

TEST(HostData, OddValuesLoadWithWarningsAndFailValidation) {
    CSetupDocument::OpenResult r = CSetupDocument::FromText(
        "DOMAIN {\n    number_of_sigma_layers = 2000000000\n    number_of_z_layers = 2000000000\n"
        "    vertical_kind = 2\n    three_dimensional = 1\n"
        "    BOUNDARY_NAMES {\n        ZoSEKivListItemCount = 2\n"
        "        BOUNDARY_1 {\n            name = \"\"\n            code = 3\n        }\n"
        "        BOUNDARY_2 {\n            code = 3\n        }\n    }\n}\n"
        "SIMULATION_PERIOD {\n    number_of_time_steps = \"many\"\n}\n"
        "HYDRODYNAMIC_SOURCES {\n    ZoSEKivListItemCount = -4\n}\n"
        "HYDRODYNAMIC_DENSITY {\n    density_mode = 9\n}\n"
        "HYDRODYNAMIC_WIND {\n    type = -1\n}\n",
        "odd.setup");
    ASSERT_FALSE(r.error);
    ASSERT_TRUE(r.document);
    EXPECT_GE(r.warnings.size(), 4u);
    CSetupDocument& doc = *r.document;
    // Refused counts keep the defaults, so the sum of layers stays a number.
    EXPECT_EQ(doc.GetDomain()->LayerTotNum(), 10);
    EXPECT_EQ(doc.GetPeriod()->TimeStepCount(), 0);
    EXPECT_EQ(doc.GetSources()->GetItemCount(), 0);

    EXPECT_EQ(doc.ValidateAll(), 0);
    const std::vector<std::string> m = Messages(doc);
    auto has = [&](const std::string& text) {
        return std::find(m.begin(), m.end(), text) != m.end();
    };
    EXPECT_TRUE(has("DOMAIN/BOUNDARY_NAMES/BOUNDARY_1: A boundary needs a name"))
        << ::testing::PrintToString(m);
    EXPECT_TRUE(has("DOMAIN/BOUNDARY_NAMES: Boundaries 1 and 2 have the same code 3"));
    EXPECT_TRUE(has("HYDRODYNAMIC_DENSITY: Density mode 9 is not known"));
    EXPECT_TRUE(has("HYDRODYNAMIC_WIND: Wind type -1 is not known"));
}

TEST(HostData, DomainValidation) {
    CSetupDocument doc;
    CDomainKiv* d = doc.GetDomain();
    d->ThreeD(true);
    d->LayerCount1(0);
    d->MeshFile("m.2dm");
    d->SetMeshInfo({10, 0, 0, 1, 0, 0});
    d->VerticalKind(3);
    EXPECT_EQ(doc.ValidateAll(), 0);
    EXPECT_EQ(Messages(doc).size(), 4u) << ::testing::PrintToString(Messages(doc));
    d->VerticalKind(1);
    EXPECT_EQ(doc.ValidateAll(), 0);
    const std::string noMesh = "DOMAIN: The mesh cannot be read: m.2dm: does not exist";
    EXPECT_EQ(Messages(doc),
              (std::vector<std::string>{
                  "DOMAIN: A three-dimensional domain needs at least one vertical layer",
                  "DOMAIN: The mesh extent has a minimum above its maximum", noMesh}));
    d->LayerCount1(3);
    d->SetMeshInfo({0, 10, 0, 1, -5, 0});
    EXPECT_EQ(doc.ValidateAll(), 0);
    EXPECT_EQ(Messages(doc), std::vector<std::string>{noMesh});
    d->MeshFile("");
    EXPECT_EQ(doc.ValidateAll(), 1);
}

TEST(HostData, NodesAskTheDocumentToSelectOthers) {
    CSetupDocument doc;
    CZoSEKivBase* asked = nullptr;
    doc.SelectTreeItem(doc.GetDomain());  // nobody shows the tree: nothing happens
    doc.SetTreeItemSelector([&](CZoSEKivBase* n) { asked = n; });
    doc.GetDomain()->GetRoot()->SelectTreeItem(doc.GetPeriod());
    EXPECT_EQ(asked, doc.GetPeriod());
}
