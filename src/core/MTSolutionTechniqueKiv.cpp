#include "MTSolutionTechniqueKiv.h"

#include "setupeditor/KivFields.h"

struct SolutionTechniqueFields {
    using F = KivField<CMTSolutionTechniqueKiv>;
    using K = CMTSolutionTechniqueKiv;
    static inline const F kFields[] = {
        F::Int("scheme_of_time_integration", &K::m_timeIntegration, 2).Choices("1 low order, fast algorithm, 2 higher order").Doc("Order of the time integration"),
        F::Int("scheme_of_space_discretization_horizontal", &K::m_spaceHorizontal, 2).Choices("1 low order, fast algorithm, 2 higher order").Doc("Order of the horizontal discretisation"),
        F::Int("scheme_of_space_discretization_vertical", &K::m_spaceVertical, 3).Doc("Order of the vertical discretisation"),
        F::Int("method_of_space_discretization_horizontal", &K::m_methodHorizontal, 0).Doc("Method of the horizontal discretisation"),
        F::Int("integration_method", &K::m_integrationMethod, 1).Doc("Method of integration"),
        F::Int("update_frequency", &K::m_updateFrequency, 1).Doc("Time steps between updates of the bed"),
    };
};

CMTSolutionTechniqueKiv::CMTSolutionTechniqueKiv(CZoSEKivBase* parent)
    : CZoSEKivBase("Solution technique", "SOLUTION_TECHNIQUE", parent) {
    SetDefault();
}

void CMTSolutionTechniqueKiv::SyncVerticalScheme() {
    if (m_spaceHorizontal == 1)
        m_spaceVertical = 1;
    else if (m_spaceHorizontal == 2)
        m_spaceVertical = 3;
}

void CMTSolutionTechniqueKiv::WriteData(void* h) {
    WriteFields(h, *this, SolutionTechniqueFields::kFields);
}

void CMTSolutionTechniqueKiv::ReadData(void* h) {
    ReadFields(h, *this, SolutionTechniqueFields::kFields);
}

const char* CMTSolutionTechniqueKiv::GetDlgRuntimeClass(unsigned code) {
    return code == kDlgRuntimeClassRequest ? "CMTSolutionTechniqueDlg"
                                           : CZoSEKivBase::GetDlgRuntimeClass(code);
}

void CMTSolutionTechniqueKiv::SetDefault() { DefaultFields(*this, SolutionTechniqueFields::kFields); }

void CMTSolutionTechniqueKiv::DescribeKeywords(KeywordSink& sink) { DescribeFields(sink, SolutionTechniqueFields::kFields); }
