#pragma once

#include "ZoSEKivBase.h"

// The nodes the navigation tree shows: those with a dialog of their own. The children of a
// node without one are shown in its place. visit(node, depth) in tree order.
template <class Visit>
void WalkNavigationTree(CZoSEKivBase* node, int depth, Visit&& visit) {
    const bool shown = node->GetDlgRuntimeClass(kDlgRuntimeClassRequest) != nullptr;
    if (shown)
        visit(node, depth);
    POSITION pos = 0;
    for (CZoSEKivBase* c = node->GetFirstChild(pos); c; c = node->GetNextChild(pos))
        WalkNavigationTree(c, shown ? depth + 1 : depth, visit);
}
