// Lists whose number of items is another list's (the host's boundaries or sources) or the
// model definition's: a count stored in the file is checked against it, never taken, so
// that no list can run past the one it follows.
#pragma once

#include "common/Platform.h"
#include "paramfile/Kiv.h"

// one / many name what is followed ("fraction", "fractions").
inline void CheckFollowedCount(void* h, int expected, const char* one, const char* many) {
    void* keyword = kivKeywordByNameNum(h, "ZoSEKivListItemCount", 1);
    if (!keyword)
        return;
    // No value counts as 0.
    int stored = 0;
    if (kivParamCount(keyword) > 0) {
        stored = expected;
        kivGetParam(h, "ZoSEKivListItemCount", &stored, 1, 1);
    }
    if (stored != expected)
        kivWarn(h, "ZoSEKivListItemCount",
                FormatString("ZoSEKivListItemCount = %d, but the setup has %d %s; the list "
                             "follows them",
                             stored, expected, expected == 1 ? one : many));
}
