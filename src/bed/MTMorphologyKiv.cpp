#include "MTMorphologyKiv.h"

#include "setupeditor/KivFields.h"

struct MorphologyFields {
    using F = KivField<CMTMorphologyKiv>;
    using K = CMTMorphologyKiv;
    static inline const F kFields[] = {
        F::Bool("include_morphological_update", &K::m_includeUpdate, false),
        F::Bool("include_speedup", &K::m_includeSpeedup, false),
        F::DoubleAsFloat("speedup_factor", &K::m_speedupFactor, 1.0),
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
