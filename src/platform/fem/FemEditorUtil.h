// Small file utilities of the editor's base library.
#pragma once

#include "common/Platform.h"

#include <vector>

class CFemEditorUtil {
public:
    // Reads a point file of lines "x y z name" (name optional) into the arrays, replacing
    // what they held; false, with the arrays left as they were, when the file cannot be
    // read or a line is malformed. The flag is kept for the callers and has no effect.
    static bool ImportXYZ(const CString& file, std::vector<double>& x, std::vector<double>& y,
                          std::vector<double>& z, std::vector<CString>& names, bool flag);
};
