#include "MTTransitionItemKiv.h"

#include "MTLayerItem.h"
#include "MTTransitionListKiv.h"

CMTTransitionItemKiv::CMTTransitionItemKiv(CZoSEKivListBaseInterface* list)
    : CZoSEKivBase("", "LAYER_%d", list), m_upperLayer(LayerNumberAtCreation(list)) {
    SetTitle(FormatString("Between layer %d and %d", m_upperLayer, m_upperLayer + 1));
    m_transition = new CFemInDataKiv("", "", 2, false, false, 0.001, 100424, this);
    AddChild(m_transition);
}

bool CMTTransitionItemKiv::IsDlgUsedInSetup() {
    const auto* list = dynamic_cast<const CMTTransitionListKiv*>(GetParent());
    return list && list->IncludeTransition();
}

const char* CMTTransitionItemKiv::GetDlgRuntimeClass(unsigned code) {
    return code == kDlgRuntimeClassRequest ? "CMTTransitionItemDlg"
                                           : CZoSEKivBase::GetDlgRuntimeClass(code);
}
