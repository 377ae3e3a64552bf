#pragma once

#include "MTTransitionItemKiv.h"
#include "core/MTCountListKiv.h"

// TRANSITION: whether transition between neighbouring layers is modelled, and one value
// per pair of neighbouring layers (none with a single layer).
class CMTTransitionListKiv : public CMTCountListKiv<CMTTransitionItemKiv> {
public:
    explicit CMTTransitionListKiv(CZoSEKivBase* parent);

    bool IncludeTransition() const { return m_includeTransition; }
    void IncludeTransition(bool include) { m_includeTransition = include; }

    void WriteData(void* h) override;
    void DescribeKeywords(KeywordSink& sink) override;
    void ReadData(void* h) override;
    int ValidateData() override { return 1; }
    // Nothing to edit below two layers.
    bool IsDlgUsedInSetup() override { return GetItemCount() >= 1; }
    void SetDefault() override;
    const char* GetDlgRuntimeClass(unsigned code) override;

private:
    friend struct TransitionListFields;
    bool m_includeTransition = false;
};
