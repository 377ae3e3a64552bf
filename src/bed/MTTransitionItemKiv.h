#pragma once

#include "fem/FemInDataKiv.h"
#include "setupeditor/ZoSEKivListBase.h"

// LAYER_%d of TRANSITION: the transition between layer k and k + 1.
class CMTTransitionItemKiv : public CZoSEKivBase {
public:
    explicit CMTTransitionItemKiv(CZoSEKivListBaseInterface* list);

    // k: the upper of the two layers.
    int UpperLayer() const { return m_upperLayer; }
    // Its keywords go straight into the item's section.
    CFemInDataKiv* Transition() const { return m_transition; }
    CString FormatText() const { return m_transition->FormatText(); }

    int ValidateData() override { return 1; }
    // In use only while the list includes transition; its value is kept and saved regardless.
    bool IsDlgUsedInSetup() override;
    void SetDefault() override { m_transition->SetDefault(); }
    const char* GetDlgRuntimeClass(unsigned code) override;

private:
    int m_upperLayer;
    CFemInDataKiv* m_transition;
};
