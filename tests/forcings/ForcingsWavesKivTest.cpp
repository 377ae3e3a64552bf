#include "ForcingsTestSupport.h"
#include "forcings/MTWaveFieldFile.h"

using namespace testsupport;
using namespace forcingstest;
using paramfile::ParamType;

namespace {

ParamType TypeOf(const paramfile::Section& s, std::string_view kw) {
    const paramfile::Keyword* k = s.FindKeyword(kw);
    EXPECT_TRUE(k && k->ParamCount() == 1) << kw;
    return k && k->ParamCount() > 0 ? k->ParamAt(0).Type() : ParamType::String;
}

}  // namespace

TEST(ForcingsWavesKiv, NewSetupWritesTheWavesWithTheirDefaultsTypesAndOrder) {
    CSetupDocument doc;
    auto saved = Saved(doc);
    const paramfile::Section* forcings = Find(*saved, {"MUD_TRANSPORT_MODULE", "FORCINGS"});
    ASSERT_NE(forcings, nullptr);
    EXPECT_EQ(Entries(*forcings), (std::vector<std::string>{"[WAVES]"}));
    const paramfile::Section* waves = forcings->FindSection("WAVES");
    EXPECT_EQ(Entries(*waves),
              (std::vector<std::string>{"minimum_waterdepth_for_including_waves",
                                        "include_liquefaction", "liquefaction_factor",
                                        "shearstress_formulation", "type", "[WAVE_FIELD]",
                                        "[WAVE_DATABASE]"}));
    // Floats read back as reals; the text is the float's shortest form.
    EXPECT_EQ(TypeOf(*waves, "minimum_waterdepth_for_including_waves"), ParamType::Double);
    EXPECT_EQ(TypeOf(*waves, "include_liquefaction"), ParamType::Boolean);
    EXPECT_EQ(TypeOf(*waves, "liquefaction_factor"), ParamType::Double);
    EXPECT_EQ(TypeOf(*waves, "shearstress_formulation"), ParamType::Integer);
    EXPECT_EQ(TypeOf(*waves, "type"), ParamType::Integer);
    EXPECT_EQ(Double(*waves, "minimum_waterdepth_for_including_waves"), 0.0);
    EXPECT_FALSE(Bool(*waves, "include_liquefaction"));
    EXPECT_EQ(Double(*waves, "liquefaction_factor"), 1.0);
    EXPECT_EQ(Int(*waves, "shearstress_formulation"), 3);
    EXPECT_EQ(Int(*waves, "type"), 0);
}

TEST(ForcingsWavesKiv, ReadsWhatIsThereAndKeepsTheRestAndSavesTheSameAgain) {
    auto doc = Load(R"(
MUD_TRANSPORT_MODULE {
    FORCINGS {
        WAVES {
            minimum_waterdepth_for_including_waves = 0.25
            include_liquefaction = true
            type = 1
        }
    }
}
)");
    CForcingsWavesKiv* w = Waves(*doc);
    EXPECT_EQ(w->MinimumWaterDepth(), 0.25);
    EXPECT_TRUE(w->IncludeLiquefaction());
    EXPECT_EQ(w->LiquefactionFactor(), 1.0);
    EXPECT_EQ(w->ShearStressFormulation(), 3);
    EXPECT_EQ(w->WaveType(), 1);
    const std::string text = doc->ToText();
    EXPECT_EQ(Load(text)->ToText(), text);
}

TEST(ForcingsWavesKiv, TypeListOffersWhatTheHostAllows) {
    struct Case {
        bool windIncluded;
        int windType;
        int spectralWaveMode;
        bool decoupled;
        std::vector<int> types;
    };
    const Case cases[] = {
        {false, 0, 0, false, {0, 1}},
        {false, 2, 0, false, {0, 1}},      // wind off: no database, whatever its type
        {true, 0, 0, false, {0, 1}},       // constant wind: no database
        {true, 1, 0, false, {0, 1, 2}},
        {true, 2, 0, false, {0, 1, 2}},
        {false, 0, 1, false, {0, 1, 3}},
        {false, 0, 2, false, {0, 1, 3}},
        {false, 0, 1, true, {0, 1}},       // decoupled: no simulation alongside
        {true, 1, 1, false, {0, 1, 2, 3}},
        {true, 1, 1, true, {0, 1, 2}},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(::testing::Message() << c.windIncluded << " " << c.windType << " "
                                          << c.spectralWaveMode << " " << c.decoupled);
        CSetupDocument doc;
        SetWind(doc, c.windIncluded, c.windType);
        doc.GetModuleSelection()->SpectralWaveMode(c.spectralWaveMode);
        doc.GetModuleSelection()->DecoupledSimulation(c.decoupled);
        EXPECT_EQ(Waves(doc)->AvailableWaveTypes(), c.types);
        EXPECT_EQ(doc.DecoupledSimulation(), c.decoupled ? 1 : 0);
    }
}

TEST(ForcingsWavesKiv, DecoupledFlagIsKeptWithTheModuleSelection) {
    auto doc = Load("MODULE_SELECTION {\n    decoupled_simulation = 1\n}\n");
    EXPECT_EQ(doc->DecoupledSimulation(), 1);
    auto saved = Saved(*doc);
    const paramfile::Section* s = Find(*saved, {"MODULE_SELECTION"});
    ASSERT_NE(s, nullptr);
    EXPECT_EQ(Int(*s, "decoupled_simulation"), 1);
    EXPECT_EQ(CSetupDocument().DecoupledSimulation(), 0);
}

TEST(ForcingsWavesKiv, DatabaseTypeWithoutWindBecomesNoWavesAndTheUserIsTold) {
    const char* text = R"(
HYDRODYNAMIC_WIND {
    include = 0
    type = 1
}
MUD_TRANSPORT_MODULE {
    FORCINGS {
        WAVES {
            type = 2
        }
    }
}
)";
    auto doc = Load(text);
    EXPECT_EQ(Waves(*doc)->WaveType(), 2);  // loaded as stored
    EXPECT_EQ(doc->ValidateAll(), 1);
    EXPECT_EQ(Waves(*doc)->WaveType(), 0);
    EXPECT_EQ(Messages(*doc),
              (std::vector<std::string>{
                  "MUD_TRANSPORT_MODULE/FORCINGS/WAVES: The wave database needs wind forcing "
                  "that varies in time; the wave type was set to \"No waves\""}));
    // Told once: the setup now holds what the engine will read.
    doc->ValidateAll();
    EXPECT_TRUE(doc->Errors().empty());

    // With the wind varying in time the database stays.
    auto withWind = Load(text);
    SetWind(*withWind, true, 1);
    withWind->ValidateAll();
    EXPECT_EQ(Waves(*withWind)->WaveType(), 2);
}

TEST(ForcingsWavesKiv, SpectralWaveTypeIsKeptWhereItIsNotOffered) {
    CSetupDocument doc;
    Waves(doc)->WaveType(3);
    EXPECT_EQ(doc.ValidateAll(), 1);
    EXPECT_EQ(Waves(doc)->WaveType(), 3);
    EXPECT_TRUE(doc.Errors().empty());
}

TEST(ForcingsWavesKiv, NavigationShowsWavesBelowForcings) {
    CSetupDocument doc;
    CForcingsWavesKiv* w = Waves(doc);
    ASSERT_NE(w, nullptr);
    EXPECT_EQ(w->GetTitle(), "Waves");
    EXPECT_EQ(w->GetParent()->GetTitle(), "Forcings");
    EXPECT_STREQ(w->GetDlgRuntimeClass(kDlgRuntimeClassRequest), "CForcingsWavesDlg");
    // The sub-sections are edited in the waves form and have no dialog of their own.
    EXPECT_EQ(w->WaveField()->GetDlgRuntimeClass(kDlgRuntimeClassRequest), nullptr);
    EXPECT_EQ(w->WaveDatabase()->GetDlgRuntimeClass(kDlgRuntimeClassRequest), nullptr);
    EXPECT_EQ(WaveFieldSection(doc.Module()), w->WaveField());
}

TEST(ForcingsWavesKiv, BundledExampleTakesItsWavesFromATimeSeries) {
    CSetupDocument::OpenResult opened =
        CSetupDocument::Open(std::string(MUD_SOURCE_DIR) + "/examples/estuary.setup");
    ASSERT_TRUE(opened.document);
    const CSetupDocument& doc = *opened.document;
    EXPECT_EQ(Waves(doc)->WaveType(), CForcingsWavesKiv::kWaveField);
    EXPECT_EQ(Field(doc)->GetFormat(), CMTWaveFieldKiv::kTimeSeries);
    EXPECT_EQ(Field(doc)->File()->FileName(), "data/waves_mouth.qrd0");
    EXPECT_TRUE(Field(doc)->File()->CheckFile());
    EXPECT_EQ(Field(doc)->File()->ItemName(1), "height");
}
