#pragma once

#include "MTBedItemGrid.h"
#include "MTTransitionItemKiv.h"

class CMTTransitionListKiv;

// Each pair of neighbouring layers with the kind of its transition value; all greyed while
// the list does not include transition.
class CMTTransitionGrid : public CMTBedItemGrid<CMTTransitionItemKiv> {
public:
    using CMTBedItemGrid::CMTBedItemGrid;
    void Initialize(CZoSEDlgBase* dialog, CMTTransitionListKiv* list);

protected:
    CString Description(CMTTransitionItemKiv* item) const override;
    bool IsGreyed() const override;

private:
    CMTTransitionListKiv* m_transitions = nullptr;
};
