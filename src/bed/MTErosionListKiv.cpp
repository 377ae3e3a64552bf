#include "MTErosionListKiv.h"

#include "setupeditor/KivFields.h"

struct ErosionListFields {
    using F = KivField<CMTErosionListKiv>;
    static inline const F kFields[] = {
        F::DoubleAsFloat("max_concentration_due_to_erosion",
                         &CMTErosionListKiv::m_maxConcentration, 50.0).Unit(100403).Doc("Largest concentration erosion may bring about"),
    };
};

CMTErosionListKiv::CMTErosionListKiv(CZoSEKivBase* parent)
    : CMTCountListKiv<CMTErosionItemKiv>("Erosion", "EROSION", parent, MTCount::Layers) {
    DefaultFields(*this, ErosionListFields::kFields);
}

void CMTErosionListKiv::WriteData(void* h) { WriteFields(h, *this, ErosionListFields::kFields); }

void CMTErosionListKiv::ReadData(void* h) { ReadFields(h, *this, ErosionListFields::kFields); }

void CMTErosionListKiv::SetDefault() { DefaultFields(*this, ErosionListFields::kFields); }

const char* CMTErosionListKiv::GetDlgRuntimeClass(unsigned code) {
    return code == kDlgRuntimeClassRequest
               ? "CMTErosionListDlg"
               : CMTCountListKiv<CMTErosionItemKiv>::GetDlgRuntimeClass(code);
}

void CMTErosionListKiv::DescribeKeywords(KeywordSink& sink) { DescribeFields(sink, ErosionListFields::kFields); }
