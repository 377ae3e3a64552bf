// Items of the per-layer lists take their defaults from the layer they are created for.
#pragma once

#include "setupeditor/ZoSEKivListBase.h"

// Items are only ever appended as the number of layers grows, so the layer of a new item
// is the number of items its list already holds, plus one.
inline int LayerNumberAtCreation(const CZoSEKivListBaseInterface* list) {
    return list ? list->GetItemCount() + 1 : 1;
}
