#include "MTDensityFeedbackKiv.h"

#include "hydro/HDDensityKiv.h"
#include "setupeditor/KivFields.h"

struct DensityFeedbackFields {
    using F = KivField<CMTDensityFeedbackKiv>;
    using K = CMTDensityFeedbackKiv;
    static inline const F kFields[] = {
        F::Bool("include_density_feedback_on_HD", &K::m_includeFeedback, false).Doc("Whether suspended sediment acts on the flow's density"),
        F::DoubleAsFloat("density_of_sediment", &K::m_densityOfSediment, 2650.0).Unit(100017).Doc("Density of the sediment"),
        F::DoubleAsFloat("base_in_viscosity_formula", &K::m_baseInViscosity, 1.0).Unit(100144).Doc("Base in the formula of the viscosity"),
        F::DoubleAsFloat("concentration_in_viscosity_formula", &K::m_concentrationInViscosity,
                         1.0).Unit(100403).Doc("Concentration in the formula of the viscosity"),
    };
};

CMTDensityFeedbackKiv::CMTDensityFeedbackKiv(CZoSEKivBase* parent)
    : CZoSEKivBase("Viscosity and Density", "DENSITY_AND_VISCOSITY", parent) {
    SetDefault();
}

void CMTDensityFeedbackKiv::WriteData(void* h) {
    WriteFields(h, *this, DensityFeedbackFields::kFields);
}

void CMTDensityFeedbackKiv::ReadData(void* h) {
    ReadFields(h, *this, DensityFeedbackFields::kFields);
}

bool CMTDensityFeedbackKiv::IsDlgUsedInSetup() {
    // Without a hydrodynamic density section the flow's density cannot vary.
    const CHDDensityKiv* density = HDDensity(this);
    return density && density->DensityMode() > 0;
}

const char* CMTDensityFeedbackKiv::GetDlgRuntimeClass(unsigned code) {
    return code == kDlgRuntimeClassRequest ? "CMTDensityFeedbackDlg"
                                           : CZoSEKivBase::GetDlgRuntimeClass(code);
}

void CMTDensityFeedbackKiv::SetDefault() { DefaultFields(*this, DensityFeedbackFields::kFields); }

void CMTDensityFeedbackKiv::DescribeKeywords(KeywordSink& sink) { DescribeFields(sink, DensityFeedbackFields::kFields); }
