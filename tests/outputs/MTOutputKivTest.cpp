#include "OutputTestSupport.h"
#include "fem/UnitUtil.h"
#include "outputs/MTOutputCoordListKiv.h"
#include "outputs/MTOutputItemSubDischargeKiv.h"
#include "outputs/MTOutputItemSubKiv.h"
#include "outputs/MTOutputItemSubMassbudgetKiv.h"

#include <filesystem>
#include <fstream>

using namespace testsupport;
using namespace outputtest;
using List = CMTOutputItemSubKiv::List;

namespace {

std::vector<std::string> Keywords(const paramfile::Section& s) {
    std::vector<std::string> out;
    for (const std::string& e : Entries(s))
        out.push_back(e);
    return out;
}

std::vector<std::string> SelectionKeywords(const CMTOutputItemSubKiv* sub) {
    std::vector<std::string> out;
    for (List l : {List::Basic, List::Additional})
        for (int i = 0; i < sub->Count(l); ++i)
            out.push_back(sub->Item(l, i).keyword);
    return out;
}

int ValueOf(const CMTOutputItemSubKiv* sub, const std::string& keyword) {
    for (List l : {List::Basic, List::Additional})
        for (int i = 0; i < sub->Count(l); ++i)
            if (sub->Item(l, i).keyword == keyword)
                return sub->Item(l, i).value;
    return -1;
}

void Set(CMTOutputItemSubKiv* sub, const std::string& keyword, int value) {
    for (List l : {List::Basic, List::Additional})
        for (int i = 0; i < sub->Count(l); ++i)
            if (sub->Item(l, i).keyword == keyword)
                sub->Value(l, i, value);
}

const paramfile::Section* SavedOutput(CSetupDocument& doc, std::unique_ptr<paramfile::Document>& keep,
                                      const char* name = "OUTPUT_1") {
    keep = Saved(doc);
    return Find(*keep, {"MUD_TRANSPORT_MODULE", "OUTPUTS", name});
}

struct TempDir {
    std::filesystem::path path;
    TempDir() {
        path = std::filesystem::temp_directory_path() /
               ("outputs-test-" + std::to_string(::testing::UnitTest::GetInstance()->random_seed()) +
                "-" + ::testing::UnitTest::GetInstance()->current_test_info()->name());
        std::filesystem::create_directories(path);
    }
    ~TempDir() {
        std::error_code ec;
        std::filesystem::remove_all(path, ec);
    }
    std::string Write(const std::string& name, const std::string& text) const {
        std::ofstream(path / name) << text;
        return (path / name).string();
    }
};

}  // namespace

TEST(MTOutputKiv, NewSetupEndsTheModuleWithNoOutputs) {
    CSetupDocument doc;
    auto saved = Saved(doc);
    const paramfile::Section* module = Find(*saved, {"MUD_TRANSPORT_MODULE"});
    ASSERT_NE(module, nullptr);
    EXPECT_EQ(Entries(*module).back(), "[OUTPUTS]");
    const paramfile::Section* outputs = module->FindSection("OUTPUTS");
    EXPECT_EQ(Entries(*outputs), (std::vector<std::string>{"ZoSEKivListItemCount", "number_of_outputs"}));
    EXPECT_EQ(Int(*outputs, "number_of_outputs"), 0);
    EXPECT_EQ(GetImportant<CMTOutputKiv>(doc.Module(), "MTOutputs")->GetTitle(), "Outputs");
}

TEST(MTOutputKiv, OutputWritesItsKeywordsInOrderWithDefaultsFromAThreeDimensionalMesh) {
    auto doc = WithOutputs(true, true, 1);
    std::unique_ptr<paramfile::Document> keep;
    const paramfile::Section* out = SavedOutput(*doc, keep);
    ASSERT_NE(out, nullptr);
    EXPECT_EQ(Keywords(*out),
              (std::vector<std::string>{"include", "title", "file_name", "type", "format",
                                        "flood_and_dry", "coordinate_type", "zone",
                                        "input_file_name", "input_format", "interpolation_type",
                                        "first_time_step", "last_time_step", "time_step_frequency",
                                        "number_of_points", "[POINT_1]", "[LINE]", "[AREA]",
                                        "[PARAMETERS_2D]", "[PARAMETERS_3D]", "[DISCHARGE]",
                                        "[MASSBUDGET]"}));
    EXPECT_EQ(Int(*out, "include"), 1);
    EXPECT_EQ(String(*out, "title"), "OUTPUTXXX");
    EXPECT_EQ(Int(*out, "type"), 2);
    EXPECT_EQ(Int(*out, "format"), 0);
    EXPECT_EQ(Int(*out, "flood_and_dry"), 2);
    EXPECT_EQ(String(*out, "coordinate_type"), "UTM-32");
    EXPECT_EQ(Int(*out, "interpolation_type"), 2);
    EXPECT_EQ(Int(*out, "last_time_step"), 100);
    EXPECT_EQ(Int(*out, "time_step_frequency"), 1);
    const paramfile::Section* p = out->FindSection("POINT_1");
    EXPECT_EQ(Keywords(*p), (std::vector<std::string>{"name", "x", "y", "z", "layer"}));
    EXPECT_EQ(String(*p, "name"), "Point 1");
    EXPECT_EQ(Double(*p, "x"), 2000.0);
    EXPECT_EQ(Double(*p, "y"), 7000.0);
    EXPECT_EQ(Double(*p, "z"), -10.0);
    EXPECT_EQ(Int(*p, "layer"), 1);
    const paramfile::Section* line = out->FindSection("LINE");
    EXPECT_EQ(Keywords(*line), (std::vector<std::string>{"npoints", "x_first", "y_first", "z_first",
                                                         "x_last", "y_last", "z_last"}));
    EXPECT_EQ(Int(*line, "npoints"), 3);
    EXPECT_EQ(Double(*line, "x_first"), 1000.0);
    EXPECT_EQ(Double(*line, "z_first"), -20.0);
    EXPECT_EQ(Double(*line, "y_last"), 9000.0);
    const paramfile::Section* area = out->FindSection("AREA");
    EXPECT_EQ(Keywords(*area), (std::vector<std::string>{"number_of_points", "[POINT_1]", "[POINT_2]",
                                                         "[POINT_3]", "[POINT_4]", "layer_min",
                                                         "layer_max"}));
    // Widened by 1 % of the extent on every side, corners in order round the box.
    const double xs[] = {980, 980, 3020, 3020}, ys[] = {4960, 9040, 9040, 4960};
    for (int i = 0; i < 4; ++i) {
        const paramfile::Section* c = area->FindSection("POINT_" + std::to_string(i + 1));
        EXPECT_EQ(Double(*c, "x"), xs[i]) << i;
        EXPECT_EQ(Double(*c, "y"), ys[i]) << i;
    }
    EXPECT_EQ(Int(*area, "layer_min"), 1);
    EXPECT_EQ(Int(*area, "layer_max"), 10);
}

TEST(MTOutputKiv, DefaultsWithoutAMeshOrInTwoDimensions) {
    struct Case {
        bool mesh, threeD;
        int type;
        size_t points, corners;
        int layerMax;
    };
    for (const Case& c : {Case{false, false, 1, 0, 0, 1}, Case{false, true, 1, 0, 0, 1},
                          Case{true, false, 1, 1, 4, 10}, Case{true, true, 2, 1, 4, 10}}) {
        SCOPED_TRACE(std::to_string(c.mesh) + std::to_string(c.threeD));
        auto doc = WithOutputs(c.mesh, c.threeD, 1);
        CMTOutputItemMainKiv* o = Output(*doc, 1);
        EXPECT_EQ(o->Type(), c.type);
        EXPECT_EQ(o->Points().size(), c.points);
        EXPECT_EQ(o->Polygon().size(), c.corners);
        EXPECT_EQ(o->LayerMax(), c.layerMax);
        EXPECT_EQ(o->CoordinateType(), "UTM-32");
        if (!c.mesh) {
            EXPECT_EQ(o->Line().xFirst, 0.0);
            EXPECT_EQ(o->Line().zLast, 0.0);
        }
        EXPECT_EQ(o->CoordList()->GetItemCount(), 1);
    }
}

TEST(MTOutputKiv, WrittenInterpolationAndInputFormatFollowTheFormat) {
    struct Case {
        int format, interpolation, input;
    };
    for (const Case& c : {Case{0, 1, 2}, Case{1, 2, 2}, Case{2, 1, 1}, Case{3, 1, 1}}) {
        auto doc = WithOutputs(true, true, 1);
        CMTOutputItemMainKiv* o = Output(*doc, 1);
        o->Format(c.format);
        o->InterpolationType(1);
        o->InputFormat(2);
        std::unique_ptr<paramfile::Document> keep;
        const paramfile::Section* out = SavedOutput(*doc, keep);
        EXPECT_EQ(Int(*out, "interpolation_type"), c.interpolation) << c.format;
        EXPECT_EQ(Int(*out, "input_format"), c.input) << c.format;
        EXPECT_EQ(o->InterpolationType(), 1);
    }
}

TEST(MTOutputKiv, RoundTripKeepsEveryValueWhateverTheUsersUnits) {
    auto doc = WithOutputs(true, true, 2);
    CMTOutputItemMainKiv* o = Output(*doc, 2);
    o->Title("Mouth");
    o->FileName("results\\mouth.qrd0");
    o->Points() = {{1.25, 2.5, -3.75, 4, "A"}, {10.0, 20.0, 0.1, 2, "B"}};
    o->Line() = {7, 1, 2, 3, 4, 5, 6};
    o->Polygon() = {{1, 1}, {2, 2}, {3, 1}};
    o->LayerMin(2);
    o->LayerMax(5);
    o->Include(0);
    const std::string first = doc->ToText();
    // A coordinate unit chosen for display changes nothing in the file.
    CUnitUtil::SetUserUnit(100183, CUnitUtil::Quantities().front().units.front().id);
    for (const QuantityInfo& q : CUnitUtil::Quantities())
        if (q.code == 100183 || q.code == 100280)
            CUnitUtil::SetUserUnit(q.code, q.units.back().id);
    auto again = Load(first);
    EXPECT_EQ(again->ToText(), first);
    CUnitUtil::ResetUserUnits();
    CMTOutputItemMainKiv* r = Output(*again, 2);
    EXPECT_EQ(r->Title(), "Mouth");
    EXPECT_EQ(r->GetTitle(), "Mouth");
    EXPECT_EQ(r->FileName(), "results\\mouth.qrd0");
    ASSERT_EQ(r->Points().size(), 2u);
    EXPECT_EQ(r->Points()[0].z, -3.75);
    EXPECT_EQ(r->Points()[1].name, "B");
    EXPECT_EQ(r->Line().npoints, 7);
    EXPECT_EQ(r->Polygon().size(), 3u);
    EXPECT_EQ(r->LayerMin(), 2);
    EXPECT_FALSE(r->IsDlgUsedInSetup());
    EXPECT_TRUE(Output(*again, 1)->IsDlgUsedInSetup());
}

TEST(MTOutputKiv, ReadingTheGeometry) {
    const std::vector<std::pair<double, double>> defaultCorners = {
        {980, 4960}, {980, 9040}, {3020, 9040}, {3020, 4960}};
    struct Case {
        const char* name;
        const char* body;
        std::vector<std::pair<double, double>> corners;
        std::vector<std::string> points;
        const char* warning;  // part of the one warning expected, or null for none
    };
    // Without number_of_points an output has no points, whatever its default was.
    const Case cases[] = {
        {"older area form", "AREA {\nnumber_of_points = 0\nx_min = 1.0\nx_max = 2.0\ny_min = 3.0\ny_max = 4.0\n}\n",
         {{1, 3}, {1, 4}, {2, 4}, {2, 3}}, {}, nullptr},
        {"area without corners stays empty", "AREA {\nnumber_of_points = 0\n}\n", {}, {}, nullptr},
        {"area without a count has no corners", "AREA {\nlayer_min = 1\n}\n", {}, {}, nullptr},
        {"area without a count takes the older form", "AREA {\nx_min = 1.0\nx_max = 2.0\n}\n",
         {{1, 0}, {1, 0}, {2, 0}, {2, 0}}, {}, nullptr},
        {"missing points are reported",
         "number_of_points = 3\nPOINT_1 {\nname = \"a\"\n}\nPOINT_3 {\nx = 1.0\n}\n", defaultCorners,
         {"a", "POINT_3"}, "1 of 3 sections is missing (POINT_2); those points are left out"},
        {"a count no output holds reads as 0", "number_of_points = -4\n", defaultCorners, {},
         "number_of_points = -4 is not between 0 and 10000000; read as 0"},
        {"a count of the wrong type reads as 0",
         "number_of_points = \"two\"\n", defaultCorners, {},
         "expects an integer"},
        // The file's point is not replaced by the default one: it is reported as unread.
        {"no count reads as 0", "POINT_1 {\nname = \"mine\"\nx = 5.0\n}\n", defaultCorners, {},
         "POINT_1"},
        {"no count and no points", "", defaultCorners, {}, nullptr},
        {"missing corner", "AREA {\nnumber_of_points = 2\nPOINT_2 {\nx = 5.0\ny = 6.0\n}\n}\n", {{5, 6}},
         {}, "1 of 2 sections is missing (POINT_1)"},
        {"points beyond the count", "number_of_points = 1\nPOINT_1 {\n}\nPOINT_2 {\n}\n", defaultCorners,
         {"POINT_1"}, "POINT_2"},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.name);
        auto r = CSetupDocument::FromText(
            SetupText(true, false, std::string("number_of_outputs = 1\nOUTPUT_1 {\n") + c.body + "}\n"),
            "t.setup");
        ASSERT_TRUE(r.document);
        CMTOutputItemMainKiv* o = Output(*r.document, 1);
        std::vector<std::pair<double, double>> corners;
        for (const MTOutputCorner& k : o->Polygon())
            corners.emplace_back(k.x, k.y);
        EXPECT_EQ(corners, c.corners);
        std::vector<std::string> names;
        for (const MTOutputPoint& p : o->Points())
            names.push_back(p.name);
        EXPECT_EQ(names, c.points);
        if (!c.warning) {
            EXPECT_TRUE(r.warnings.empty());
            continue;
        }
        ASSERT_EQ(r.warnings.size(), 1u);
        EXPECT_NE(r.warnings[0].message.find(c.warning), std::string::npos) << r.warnings[0].message;
    }
}

// However many points a count promises, what is missing costs one warning and no memory.
TEST(MTOutputKiv, AHugeCountWithFewPointsIsReportedOnce) {
    auto r = CSetupDocument::FromText(
        SetupText(true, false,
                  "number_of_outputs = 1\nOUTPUT_1 {\nnumber_of_points = 2000000\n"
                  "POINT_2 {\n}\nPOINT_7 {\n}\nPOINT_01 {\n}\nPOINT_2000001 {\n}\n"
                  "AREA {\nnumber_of_points = 9000000\n}\n}\n"),
        "t.setup");
    ASSERT_TRUE(r.document);
    EXPECT_EQ(Output(*r.document, 1)->Points().size(), 2u);
    EXPECT_TRUE(Output(*r.document, 1)->Polygon().empty());
    // Neither a number written otherwise than a count writes it nor one beyond the count is
    // read: those are reported as unread where they stand.
    const char* const expected[] = {
        "1999998 of 2000000 sections are missing (POINT_1, POINT_3, POINT_4, POINT_5, POINT_6 and "
        "1999993 more); those points are left out",
        "'POINT_01'",
        "'POINT_2000001'",
        "9000000 of 9000000 sections are missing (POINT_1, POINT_2, POINT_3, POINT_4, POINT_5 and "
        "8999995 more); those points are left out",
    };
    ASSERT_EQ(r.warnings.size(), std::size(expected));
    for (size_t i = 0; i < std::size(expected); ++i)
        EXPECT_NE(r.warnings[i].message.find(expected[i]), std::string::npos) << r.warnings[i].message;
}

// --- quantities ---------------------------------------------------------------------------

TEST(MTOutputItemSubKiv, TwoDimensionalSelectionWritesEveryQuantityInOrder) {
    auto doc = WithOutputs(false, false, 1, 2, 1);
    std::unique_ptr<paramfile::Document> keep;
    const paramfile::Section* out = SavedOutput(*doc, keep);
    const paramfile::Section* p2 = out->FindSection("PARAMETERS_2D");
    const std::vector<std::string> expected = {
        "SSC_FRACTION_1", "SSC_FRACTION_2", "BED_THICKNESS_LAYER_1", "BED_MASS_LAYER_1_FRACTION_1",
        "BED_MASS_LAYER_1_FRACTION_2", "SETTLING_VELOCITY_FRACTION_1", "SETTLING_VELOCITY_FRACTION_2",
        "BED_SHEARSTRESS", "TOTAL_SSC", "TOTAL_BED_THICKNESS_CHANGE", "TOTAL_BED_MASS_CHANGE",
        "BED_LEVEL", "EROSION_FRACTION_1", "EROSION_FRACTION_2", "DEPOSITION_FRACTION_1",
        "DEPOSITION_FRACTION_2", "NET_DEPOSITION_FRACTION_1", "NET_DEPOSITION_FRACTION_2",
        "NET_DEPOSITION_ACCUMULATED_FRACTION_1", "NET_DEPOSITION_ACCUMULATED_FRACTION_2",
        "TOTAL_NET_DEPOSITION_ACCUMULATED", "WAVE_HEIGHT", "WAVE_PERIOD", "WAVE_DIRECTION",
        "U_VELOCITY", "V_VELOCITY", "CFL_NUMBER"};
    EXPECT_EQ(Keywords(*p2), expected);
    for (size_t i = 0; i < expected.size(); ++i)
        EXPECT_EQ(Int(*p2, expected[i]), i < 5 ? 1 : 0) << expected[i];
    EXPECT_EQ(Keywords(*out->FindSection("PARAMETERS_3D")),
              (std::vector<std::string>{"SSC_FRACTION_1", "SSC_FRACTION_2",
                                        "SETTLING_VELOCITY_FRACTION_1",
                                        "SETTLING_VELOCITY_FRACTION_2", "TOTAL_SSC", "U_VELOCITY",
                                        "V_VELOCITY", "W_VELOCITY", "CFL_NUMBER"}));
    EXPECT_EQ(Keywords(*out->FindSection("DISCHARGE")),
              (std::vector<std::string>{"Type", "DISCHARGE_POSITIVE", "ACCUMULATED_DISCHARGE_POSITIVE",
                                        "DISCHARGE_NEGATIVE", "ACCUMULATED_DISCHARGE_NEGATIVE",
                                        "SSC_FRACTION_1", "SSC_FRACTION_2"}));
    EXPECT_EQ(Keywords(*out->FindSection("MASSBUDGET")),
              (std::vector<std::string>{"SSC_FRACTION_1", "SSC_FRACTION_2"}));
}

TEST(MTOutputItemSubKiv, BedMassIsNumberedByLayerThenFraction) {
    auto doc = WithOutputs(false, false, 1, 2, 2);
    const std::vector<std::string> keys = SelectionKeywords(Output(*doc, 1)->Parameters2D());
    const std::vector<std::string> bedMass(keys.begin() + 4, keys.begin() + 8);
    EXPECT_EQ(bedMass, (std::vector<std::string>{"BED_MASS_LAYER_1_FRACTION_1", "BED_MASS_LAYER_1_FRACTION_2",
                                                 "BED_MASS_LAYER_2_FRACTION_1", "BED_MASS_LAYER_2_FRACTION_2"}));
    EXPECT_EQ(Output(*doc, 1)->Parameters2D()->Item(List::Basic, 6).label, "Bed mass - layer 2, fraction 1");
}

TEST(MTOutputItemSubKiv, MissingKeywordsReadAsBasicSelectedAndAdditionalNot) {
    auto doc = Load(SetupText(false, false,
                              "number_of_outputs = 1\nOUTPUT_1 {\nPARAMETERS_2D {\nSSC_FRACTION_1 = 0\n"
                              "U_VELOCITY = 1\nNOT_A_QUANTITY = 1\n}\n}\n"));
    CMTOutputItemSubKiv* p2 = Output(*doc, 1)->Parameters2D();
    EXPECT_EQ(ValueOf(p2, "SSC_FRACTION_1"), 0);
    EXPECT_EQ(ValueOf(p2, "SSC_FRACTION_2"), 1);
    EXPECT_EQ(ValueOf(p2, "TOTAL_SSC"), 0);
    EXPECT_EQ(ValueOf(p2, "U_VELOCITY"), 1);
}

TEST(MTOutputItemSubKiv, SelectionsSurviveChangesOfTheCounts) {
    auto doc = WithOutputs(false, false, 3, 1, 1);
    CParameterSelectionKiv* model = ModelDefinition(doc->Module());
    CMTOutputItemMainKiv* o = Output(*doc, 2);
    Set(o->Parameters2D(), "SSC_FRACTION_1", 0);
    Set(o->Parameters2D(), "TOTAL_SSC", 1);
    model->NumberOfFractions(2);
    EXPECT_EQ(ValueOf(o->Parameters2D(), "SSC_FRACTION_1"), 0);
    EXPECT_EQ(ValueOf(o->Parameters2D(), "SSC_FRACTION_2"), 1);
    EXPECT_EQ(ValueOf(o->Parameters2D(), "TOTAL_SSC"), 1);
    EXPECT_EQ(ValueOf(Output(*doc, 1)->Parameters2D(), "SSC_FRACTION_1"), 1);
    // A quantity that went away comes back with its default.
    Set(o->Parameters2D(), "SSC_FRACTION_2", 0);
    model->NumberOfFractions(1);
    model->NumberOfFractions(2);
    EXPECT_EQ(ValueOf(o->Parameters2D(), "SSC_FRACTION_2"), 1);

    // Layers rebuild the 2D and 3D selections only; the discharge keeps its choice.
    o->Discharge()->SetBasicItemSelected(4, false);
    Set(o->Parameters3D(), "W_VELOCITY", 1);
    model->NumberOfLayers(3);
    EXPECT_EQ(ValueOf(o->Parameters2D(), "BED_THICKNESS_LAYER_3"), 1);
    EXPECT_EQ(ValueOf(o->Parameters3D(), "W_VELOCITY"), 1);
    EXPECT_FALSE(o->Discharge()->IsBasicItemSelected(4));
    EXPECT_EQ(o->Discharge()->NumBasicItems(), 6);
    // Fractions rebuild the discharge and mass budget with every item selected again.
    model->NumberOfFractions(3);
    EXPECT_TRUE(o->Discharge()->IsBasicItemSelected(4));
    EXPECT_EQ(o->Discharge()->NumBasicItems(), 7);
    EXPECT_EQ(o->Massbudget()->NumBasicItems(), 3);
}

TEST(MTOutputItemSubKiv, QuantitiesOfferedByDimensionAndType) {
    auto doc = WithOutputs(true, true, 2);
    Output(*doc, 1)->Type(1);
    Output(*doc, 2)->Type(2);
    auto offered = [](CMTOutputItemSubKiv* sub) {
        std::vector<std::string> out;
        for (List l : {List::Basic, List::Additional})
            for (int i = 0; i < sub->Count(l); ++i)
                if (sub->IsOffered(sub->Item(l, i).itemClass))
                    out.push_back(sub->Item(l, i).keyword);
        return out;
    };
    const std::vector<std::string> twoD = offered(Output(*doc, 1)->Parameters2D());
    EXPECT_EQ(twoD, (std::vector<std::string>{
                        "BED_THICKNESS_LAYER_1", "BED_MASS_LAYER_1_FRACTION_1", "BED_MASS_LAYER_1_FRACTION_2",
                        "BED_SHEARSTRESS", "TOTAL_BED_THICKNESS_CHANGE", "TOTAL_BED_MASS_CHANGE",
                        "BED_LEVEL", "EROSION_FRACTION_1", "EROSION_FRACTION_2", "DEPOSITION_FRACTION_1",
                        "DEPOSITION_FRACTION_2", "NET_DEPOSITION_FRACTION_1", "NET_DEPOSITION_FRACTION_2",
                        "NET_DEPOSITION_ACCUMULATED_FRACTION_1", "NET_DEPOSITION_ACCUMULATED_FRACTION_2",
                        "TOTAL_NET_DEPOSITION_ACCUMULATED", "WAVE_HEIGHT", "WAVE_PERIOD",
                        "WAVE_DIRECTION"}));
    EXPECT_EQ(offered(Output(*doc, 2)->Parameters3D()), SelectionKeywords(Output(*doc, 2)->Parameters3D()));
    EXPECT_TRUE(Output(*doc, 1)->Parameters2D()->IsDlgUsedInSetup());
    EXPECT_FALSE(Output(*doc, 1)->Parameters3D()->IsDlgUsedInSetup());
    EXPECT_TRUE(Output(*doc, 2)->Parameters3D()->IsDlgUsedInSetup());
    // In two dimensions everything is offered.
    doc->GetDomain()->ThreeD(false);
    EXPECT_EQ(offered(Output(*doc, 1)->Parameters2D()), SelectionKeywords(Output(*doc, 1)->Parameters2D()));
}

// --- validation ---------------------------------------------------------------------------

TEST(MTOutputItemMainKiv, ValidationMessages) {
    TempDir dir;
    std::filesystem::create_directories(dir.path / "results");
    struct Case {
        const char* name;
        std::function<void(CMTOutputItemMainKiv&)> change;
        const char* message;  // empty: valid
    };
    const std::string folder = (dir.path / "results").string();
    const Case cases[] = {
        {"valid", [](auto&) {}, ""},
        {"bare name", [](auto& o) { o.FileName("out.QRD0"); }, ""},
        {"first negative", [](auto& o) { o.FirstTimeStep(-1); }, "First time step invalid"},
        {"first past the period", [](auto& o) { o.FirstTimeStep(101); }, "First time step invalid"},
        {"last past the period", [](auto& o) { o.LastTimeStep(101); }, "Last time step invalid"},
        {"last before first", [](auto& o) { o.FirstTimeStep(50), o.LastTimeStep(40); }, "Last time step invalid"},
        {"frequency 0", [](auto& o) { o.TimeStepFrequency(0); }, "Invalid time step frequency"},
        {"frequency past the period", [](auto& o) { o.TimeStepFrequency(101); }, "Invalid time step frequency"},
        {"no file", [](auto& o) { o.FileName(""); }, "File is not valid"},
        {"short name", [](auto& o) { o.FileName("a"); }, "File is not valid"},
        {"wrong extension", [](auto& o) { o.FileName("out.qrd1"); }, "File is not valid"},
        {"missing folder", [](auto& o) { o.FileName("nowhere/out.qrd0"); }, "File is not valid"},
        {"line series", [](auto& o) { o.Format(1), o.FileName("out.qrd1"); }, ""},
        {"point layer", [](auto& o) { o.InterpolationType(1), o.Points()[0].layer = 11; },
         "Illegal layer value in Point 1"},
        {"point layer 0", [](auto& o) { o.InterpolationType(1), o.Points()[0].layer = 0; },
         "Illegal layer value in Point 1"},
        {"z levels ignore layers", [](auto& o) { o.Points()[0].layer = 0; }, ""},
        {"volume layers", [](auto& o) { o.Format(3), o.FileName("out.qrdu"), o.LayerMin(4), o.LayerMax(3); },
         "Illegal layer value in volume specification"},
        {"volume layer past the domain", [](auto& o) { o.Format(3), o.FileName("out.qrdu"), o.LayerMax(11); },
         "Illegal layer value in volume specification"},
        {"area of two corners", [](auto& o) { o.Format(2), o.FileName("out.qrdu"), o.Polygon().resize(2); },
         "At least three points are required to define an area or a volume"},
        {"empty mass budget",
         [](auto& o) { o.Type(3), o.Polygon().clear(); },
         "At least three points are required to define an area or a volume"},
        {"point output without corners", [](auto& o) { o.Polygon().clear(); }, ""},
        {"excluded", [](auto& o) { o.Include(0), o.FirstTimeStep(-5), o.FileName(""); }, ""},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.name);
        auto doc = WithOutputs(true, true, 1);
        CMTOutputItemMainKiv* o = Output(*doc, 1);
        o->FileName(folder + "/out.qrd0");
        c.change(*o);
        doc->ValidateAll();
        // The domain names a mesh that is not there: its message is the domain's.
        std::vector<std::string> messages;
        for (const std::string& m : Messages(*doc))
            if (m.rfind("DOMAIN: The mesh cannot be read", 0) != 0)
                messages.push_back(m);
        if (*c.message) {
            EXPECT_EQ(messages, (std::vector<std::string>{std::string("MUD_TRANSPORT_MODULE/OUTPUTS/OUTPUT_1: ") +
                                                          c.message}));
        } else {
            EXPECT_TRUE(messages.empty()) << messages.front();
        }
        EXPECT_EQ(o->CheckData(false), !*c.message);
    }
}

TEST(MTOutputItemMainKiv, WithoutTimeStepsAnyFrequencyPasses) {
    auto doc = Load(DomainText(false, false, 0) +
                    "MUD_TRANSPORT_MODULE {\nOUTPUTS {\nnumber_of_outputs = 1\nOUTPUT_1 {\n"
                    "file_name = 'o.qrd0'\ntime_step_frequency = 77\n}\n}\n}\n");
    CMTOutputItemMainKiv* o = Output(*doc, 1);
    EXPECT_TRUE(o->CheckData(false));
    o->LastTimeStep(1);
    EXPECT_FALSE(o->CheckData(false));
}

TEST(MTOutputItemMainKiv, DomainChangesReachTheOutputs) {
    auto doc = WithOutputs(true, true, 3);
    Output(*doc, 1)->Format(3);
    Output(*doc, 2)->Type(3);
    Output(*doc, 3)->Type(4);
    Output(*doc, 3)->Format(3);
    doc->GetDomain()->ThreeD(false);
    EXPECT_EQ(Output(*doc, 1)->Type(), 1);
    EXPECT_EQ(Output(*doc, 1)->Format(), 2);
    EXPECT_EQ(Output(*doc, 2)->Type(), 3);
    // Mass budgets and discharges keep their kind, but no output keeps a volume.
    EXPECT_EQ(Output(*doc, 3)->Type(), 4);
    EXPECT_EQ(Output(*doc, 3)->Format(), 2);
    doc->GetDomain()->LayerCount1(6);
    EXPECT_EQ(Output(*doc, 2)->LayerMax(), 6);
}

// --- xyz import ---------------------------------------------------------------------------

TEST(MTOutputItemMainKiv, PointsImportedOnLoading) {
    TempDir dir;
    dir.Write("pts.xyz", "100.0 200.0 -3.7 north\n110.0 210.0 2.9\n");
    dir.Write("bad.xyz", "100.0 200.0\n");
    auto text = [](const char* file) {
        return SetupText(true, true, std::string("number_of_outputs = 1\nOUTPUT_1 {\ninput_format = 2\n"
                                                 "input_file_name = '") + file + "'\n}\n");
    };
    dir.Write("good.setup", text("pts.xyz"));
    dir.Write("bad.setup", text("bad.xyz"));
    auto good = CSetupDocument::Open((dir.path / "good.setup").string());
    ASSERT_TRUE(good.document);
    EXPECT_TRUE(good.warnings.empty());
    CMTOutputItemMainKiv* o = Output(*good.document, 1);
    ASSERT_EQ(o->Points().size(), 2u);  // no number_of_points: only the file's
    EXPECT_EQ(o->Points()[0].name, "north");
    EXPECT_EQ(o->Points()[0].layer, -3);
    EXPECT_EQ(o->Points()[1].layer, 2);
    EXPECT_EQ(o->Points()[1].y, 210.0);
    EXPECT_EQ(o->InputFormat(), 1);

    auto bad = CSetupDocument::Open((dir.path / "bad.setup").string());
    ASSERT_TRUE(bad.document);
    ASSERT_EQ(bad.warnings.size(), 1u);
    EXPECT_NE(bad.warnings[0].message.find("bad.xyz"), std::string::npos) << bad.warnings[0].message;
    EXPECT_TRUE(Output(*bad.document, 1)->Points().empty());
    EXPECT_EQ(Output(*bad.document, 1)->InputFormat(), 2);
}

TEST(MTOutputItemMainKiv, ImportAddsToTheGeometryInUse) {
    TempDir dir;
    const std::string file = dir.Write("three.xyz", "1.0 2.0 3.0 a\n4.0 5.0 6.0 b\n7.0 8.0 9.0 c\n");
    auto doc = WithOutputs(true, false, 3);
    CMTOutputItemMainKiv* points = Output(*doc, 1);
    CMTOutputItemMainKiv* line = Output(*doc, 2);
    CMTOutputItemMainKiv* area = Output(*doc, 3);
    line->Type(4);
    area->Format(2);
    for (CMTOutputItemMainKiv* o : {points, line, area})
        ASSERT_TRUE(o->ImportXyz(file, nullptr));
    EXPECT_EQ(points->Points().size(), 4u);
    EXPECT_EQ(points->Points()[3].name, "c");
    EXPECT_EQ(points->Points()[3].layer, 9);
    EXPECT_EQ(line->Line().xFirst, 1.0);
    EXPECT_EQ(line->Line().zLast, 6.0);
    EXPECT_EQ(area->Polygon().size(), 7u);
    EXPECT_EQ(area->Polygon()[6].y, 8.0);
    CString error;
    EXPECT_FALSE(area->ImportXyz(dir.Write("bad.xyz", "x y z\n"), &error));
    EXPECT_FALSE(error.empty());
    EXPECT_EQ(area->Polygon().size(), 7u);
}

TEST(MTOutputKiv, PlaceholderTitlesAreNamedAfterTheirPosition) {
    auto doc = WithOutputs(false, false, 3);
    Output(*doc, 2)->Title("Kept");
    Output(*doc, 3)->Title("OUTPUTXXX copy");
    EXPECT_TRUE(Outputs(*doc)->NameNewOutputs());
    EXPECT_EQ(Output(*doc, 1)->Title(), "Output 1");
    EXPECT_EQ(Output(*doc, 2)->Title(), "Kept");
    EXPECT_EQ(Output(*doc, 3)->Title(), "Output 3");
    EXPECT_FALSE(Outputs(*doc)->NameNewOutputs());
    Output(*doc, 1)->Title("OUT");
    EXPECT_FALSE(Outputs(*doc)->NameNewOutputs());
}
