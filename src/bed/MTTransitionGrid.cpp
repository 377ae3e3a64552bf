#include "MTTransitionGrid.h"

#include "MTTransitionListKiv.h"

void CMTTransitionGrid::Initialize(CZoSEDlgBase* dialog, CMTTransitionListKiv* list) {
    m_transitions = list;
    CMTBedItemGrid::Initialize(dialog, list, {"Transition", "Format", "Edit"});
}

CString CMTTransitionGrid::Description(CMTTransitionItemKiv* item) const {
    return item->FormatText();
}

bool CMTTransitionGrid::IsGreyed() const {
    return m_transitions && !m_transitions->IncludeTransition();
}
