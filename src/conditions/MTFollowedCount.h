// Lists whose number of items is another list's (the host's boundaries or sources) or the
// model definition's: a count stored in the file is checked against it, never taken, so
// that no list can run past the one it follows.
#pragma once

#include "common/Platform.h"
#include "paramfile/Kiv.h"

inline void CheckFollowedCount(void* h, int expected, const char* what) {
    void* keyword = kivKeywordByNameNum(h, "ZoSEKivListItemCount", 1);
    if (!keyword)
        return;
    int stored = kivParamCount(keyword) == 0 ? 0 : expected;
    kivGetParam(h, "ZoSEKivListItemCount", &stored, 1, 1);
    if (stored != expected)
        kivWarn(h, "ZoSEKivListItemCount",
                FormatString("item count %d differs from the number of %s (%d); the list "
                             "follows the %s",
                             stored, what, expected, what));
}
