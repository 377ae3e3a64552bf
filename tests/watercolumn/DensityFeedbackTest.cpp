#include "WaterColumnTestSupport.h"
#include "hydro/HDDensityKiv.h"
#include "watercolumn/MTDensityFeedbackKiv.h"

using namespace testsupport;
using namespace wctest;
using paramfile::ParamType;

namespace {
CMTDensityFeedbackKiv* Feedback(CSetupDocument& doc) {
    return Node<CMTDensityFeedbackKiv>(doc, {"WATER_COLUMN", "DENSITY_AND_VISCOSITY"});
}
const paramfile::Section* Written(const paramfile::Document& saved) {
    return Find(saved, {"MUD_TRANSPORT_MODULE", "WATER_COLUMN", "DENSITY_AND_VISCOSITY"});
}
}  // namespace

TEST(DensityFeedback, NewSetupWritesFlagAsBoolAndFloats) {
    auto doc = NewSetup(1);
    auto saved = Saved(*doc);
    const auto* s = Written(*saved);
    ASSERT_NE(s, nullptr);
    EXPECT_EQ(Entries(*s), (std::vector<std::string>{"include_density_feedback_on_HD",
                                                     "density_of_sediment",
                                                     "base_in_viscosity_formula",
                                                     "concentration_in_viscosity_formula"}));
    EXPECT_EQ(TypeOf(*s, "include_density_feedback_on_HD"), ParamType::Boolean);
    EXPECT_FALSE(Bool(*s, "include_density_feedback_on_HD"));
    EXPECT_EQ(Double(*s, "density_of_sediment"), 2650.0);
    EXPECT_EQ(Double(*s, "base_in_viscosity_formula"), 1.0);
    EXPECT_EQ(Double(*s, "concentration_in_viscosity_formula"), 1.0);
    for (const char* kw : {"density_of_sediment", "base_in_viscosity_formula",
                           "concentration_in_viscosity_formula"})
        EXPECT_NE(TypeOf(*s, kw), ParamType::Integer) << kw;
    EXPECT_STREQ(Feedback(*doc)->GetDlgRuntimeClass(2555), "CMTDensityFeedbackDlg");
}

TEST(DensityFeedback, UseFollowsTheHydrodynamicDensityModeButValuesAreAlwaysWritten) {
    auto doc = NewSetup(1);
    CMTDensityFeedbackKiv* feedback = Feedback(*doc);
    feedback->DensityOfSediment(2500.0);
    EXPECT_FALSE(feedback->IsDlgUsedInSetup());
    EXPECT_EQ(Double(*Written(*Saved(*doc)), "density_of_sediment"), 2500.0);
    doc->GetDensity()->DensityMode(1);
    EXPECT_TRUE(feedback->IsDlgUsedInSetup());
    doc->GetDensity()->DensityMode(-1);
    EXPECT_FALSE(feedback->IsDlgUsedInSetup());
}

TEST(DensityFeedback, RoundTripWritesDoublesAsFloats) {
    auto doc = Load(Module(1,
        " WATER_COLUMN {\n  DENSITY_AND_VISCOSITY {\n   include_density_feedback_on_HD = true\n"
        "   density_of_sediment = 2400.5\n   base_in_viscosity_formula = -0.25\n  }\n }\n"));
    CMTDensityFeedbackKiv* feedback = Feedback(*doc);
    EXPECT_TRUE(feedback->IncludeDensityFeedback());
    EXPECT_EQ(feedback->DensityOfSediment(), 2400.5);
    EXPECT_EQ(feedback->BaseInViscosityFormula(), -0.25);
    EXPECT_EQ(feedback->ConcentrationInViscosityFormula(), 1.0);  // missing: kept
    feedback->ConcentrationInViscosityFormula(1.0 / 3.0);
    auto saved = Saved(*doc);
    const auto* s = Written(*saved);
    EXPECT_TRUE(Bool(*s, "include_density_feedback_on_HD"));
    EXPECT_EQ(Double(*s, "density_of_sediment"), 2400.5);
    EXPECT_EQ(Double(*s, "base_in_viscosity_formula"), -0.25);
    EXPECT_EQ(Double(*s, "concentration_in_viscosity_formula"), 0.33333334);
    EXPECT_EQ(Load(doc->ToText())->ToText(), doc->ToText());

    // Beyond the float range the file holds an infinity, never undefined narrowing.
    feedback->DensityOfSediment(1e300);
    EXPECT_EQ(Double(*Written(*Saved(*doc)), "density_of_sediment"),
              std::numeric_limits<double>::infinity());
}
