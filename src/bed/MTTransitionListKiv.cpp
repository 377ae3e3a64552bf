#include "MTTransitionListKiv.h"

#include "setupeditor/KivFields.h"

struct TransitionListFields {
    using F = KivField<CMTTransitionListKiv>;
    static inline const F kFields[] = {
        F::Bool("include_transition", &CMTTransitionListKiv::m_includeTransition, false).Doc("Whether mass passes from layer to layer by consolidation"),
    };
};

CMTTransitionListKiv::CMTTransitionListKiv(CZoSEKivBase* parent)
    : CMTCountListKiv<CMTTransitionItemKiv>("Transition Between Layers", "TRANSITION", parent,
                                            MTCount::LayerPairs) {
    DefaultFields(*this, TransitionListFields::kFields);
}

void CMTTransitionListKiv::WriteData(void* h) {
    WriteFields(h, *this, TransitionListFields::kFields);
}

void CMTTransitionListKiv::ReadData(void* h) { ReadFields(h, *this, TransitionListFields::kFields); }

void CMTTransitionListKiv::SetDefault() { DefaultFields(*this, TransitionListFields::kFields); }

const char* CMTTransitionListKiv::GetDlgRuntimeClass(unsigned code) {
    return code == kDlgRuntimeClassRequest
               ? "CMTTransitionListDlg"
               : CMTCountListKiv<CMTTransitionItemKiv>::GetDlgRuntimeClass(code);
}

void CMTTransitionListKiv::DescribeKeywords(KeywordSink& sink) { DescribeFields(sink, TransitionListFields::kFields); }
