// Checks applied while a water-column section reads itself.
#pragma once

#include "common/Platform.h"
#include "paramfile/Kiv.h"

// A choice outside its known values is kept as read (and written back), with a warning.
inline void WarnUnknownChoice(void* h, const char* keyword, int value, int first, int last) {
    if (value < first || value > last)
        kivWarn(h, keyword,
                FormatString("%s = %d is not a known choice (%d to %d); kept as read", keyword,
                             value, first, last));
}

// An integer flag is true exactly when it is 1; anything but 0 or 1 is worth a warning,
// because it reads as 0 and is written back as 0.
inline void WarnUnknownFlag(void* h, const char* keyword, int value) {
    if (value != 0 && value != 1)
        kivWarn(h, keyword,
                FormatString("%s = %d is neither 0 nor 1; read as 0", keyword, value));
}
