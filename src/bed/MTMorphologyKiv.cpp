#include "MTMorphologyKiv.h"

#include "setupeditor/KivFields.h"

struct MorphologyFields {
    using F = KivField<CMTMorphologyKiv>;
    using K = CMTMorphologyKiv;
    static inline const F kFields[] = {
        F::Bool("include_morphological_update", &K::m_includeUpdate, false).Doc("Whether the bed level follows erosion and deposition"),
        F::Bool("include_speedup", &K::m_includeSpeedup, false).Doc("Whether bed-level changes are sped up"),
        F::DoubleAsFloat("speedup_factor", &K::m_speedupFactor, 1.0).Doc("Factor by which bed-level changes are sped up"),
    };
};

CMTMorphologyKiv::CMTMorphologyKiv(CZoSEKivBase* parent)
    : CZoSEKivBase("Morphology", "MORPHOLOGY", parent) {
    SetDefault();
}

void CMTMorphologyKiv::WriteData(void* h) { WriteFields(h, *this, MorphologyFields::kFields); }

void CMTMorphologyKiv::ReadData(void* h) { ReadFields(h, *this, MorphologyFields::kFields); }

void CMTMorphologyKiv::SetDefault() { DefaultFields(*this, MorphologyFields::kFields); }

const char* CMTMorphologyKiv::GetDlgRuntimeClass(unsigned code) {
    return code == kDlgRuntimeClassRequest ? "CMTMorphologyDlg"
                                           : CZoSEKivBase::GetDlgRuntimeClass(code);
}

void CMTMorphologyKiv::DescribeKeywords(KeywordSink& sink) { DescribeFields(sink, MorphologyFields::kFields); }
