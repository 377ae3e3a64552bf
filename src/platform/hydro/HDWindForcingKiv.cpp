#include "HDWindForcingKiv.h"

#include "setupeditor/KivFields.h"

namespace {
const char* const kKey = "FemInDataWind";
}

struct WindFields {
    using F = KivField<CHDWindForcingKiv>;
    using K = CHDWindForcingKiv;
    static inline const F kFields[] = {
        F::Flag("include", &K::m_include, false).Choices("0 excluded, 1 included").Doc("Whether the flow model is forced by wind"),
        F::Int("type", &K::m_type, 0).Doc("How the wind is given (constant, varying in time, ...)"),
    };
};

CHDWindForcingKiv::CHDWindForcingKiv(CZoSEKivBase* parent)
    : CZoSEKivBase("Wind Forcing", "HYDRODYNAMIC_WIND", parent) {
    SetDefault();
    GetRoot()->RegisterImportantNode(this, kKey);
}

CHDWindForcingKiv::~CHDWindForcingKiv() { GetRoot()->UnregisterImportantNode(kKey); }

const std::vector<CString>& CHDWindForcingKiv::WindTypeTexts() {
    static const std::vector<CString> texts = {"Constant", "Varying in time, constant in domain",
                                               "Varying in time and domain"};
    return texts;
}

void CHDWindForcingKiv::WriteData(void* h) { WriteFields(h, *this, WindFields::kFields); }
void CHDWindForcingKiv::ReadData(void* h) { ReadFields(h, *this, WindFields::kFields); }
void CHDWindForcingKiv::SetDefault() { DefaultFields(*this, WindFields::kFields); }

int CHDWindForcingKiv::ValidateData() {
    if (m_type < 0 || m_type >= static_cast<int>(WindTypeTexts().size())) {
        AddError(FormatString("Wind type %d is not known", m_type));
        return 0;
    }
    return 1;
}

CHDWindForcingKiv* WindForcing(const CZoSEKivBase* node) {
    return GetImportant<CHDWindForcingKiv>(node, kKey);
}

void CHDWindForcingKiv::DescribeKeywords(KeywordSink& sink) { DescribeFields(sink, WindFields::kFields); }
