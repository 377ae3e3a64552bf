#include "MTDepositionKiv.h"

#include "MTReadChecks.h"
#include "setupeditor/KivFields.h"

struct DepositionFields {
    using F = KivField<CMTDepositionKiv>;
    using K = CMTDepositionKiv;
    static inline const F kFields[] = {
        F::Int("concentration_profile", &K::m_concentrationProfile, 1).Choices("0 Rouse profile, 1 Teeter profile").Doc("Vertical profile of the concentration near the bed"),
        F::Double("centroid_height", &K::m_centroidHeight, 0.3).Doc("Height of the concentration's centroid above the bed, relative to the depth"),
    };
};

CMTDepositionItemKiv::CMTDepositionItemKiv(CZoSEKivBase* parent)
    : CZoSEKivBase("Fraction %d", "FRACTION_%d", parent),
      m_criticalShearStress(new CFemInDataKiv("CRITICAL_SHEARSTRESS_FOR_DEPOSITION",
                                              "Critical Shear Stress", 2, false, false, 0.07,
                                              100152, this)) {
    AddChild(m_criticalShearStress);
}

const char* CMTDepositionItemKiv::GetDlgRuntimeClass(unsigned code) {
    return code == kDlgRuntimeClassRequest ? "CMTDepositionItemDlg"
                                           : CZoSEKivBase::GetDlgRuntimeClass(code);
}

CMTDepositionKiv::CMTDepositionKiv(CZoSEKivBase* parent)
    : CMTCountListKiv("Deposition", "DEPOSITION", parent, MTCount::Fractions) {
    DefaultFields(*this, DepositionFields::kFields);
}

void CMTDepositionKiv::WriteData(void* h) { WriteFields(h, *this, DepositionFields::kFields); }

void CMTDepositionKiv::ReadData(void* h) {
    ReadFields(h, *this, DepositionFields::kFields);
    WarnUnknownChoice(h, "concentration_profile", m_concentrationProfile, 0, 1);
}

const char* CMTDepositionKiv::GetDlgRuntimeClass(unsigned code) {
    return code == kDlgRuntimeClassRequest ? "CMTDepositionDlg"
                                           : CMTCountListKiv::GetDlgRuntimeClass(code);
}

void CMTDepositionKiv::SetDefault() { DefaultFields(*this, DepositionFields::kFields); }

void CMTDepositionKiv::DescribeKeywords(KeywordSink& sink) { DescribeFields(sink, DepositionFields::kFields); }
