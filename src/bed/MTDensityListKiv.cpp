#include "MTDensityListKiv.h"

const char* CMTDensityListKiv::GetDlgRuntimeClass(unsigned code) {
    return code == kDlgRuntimeClassRequest
               ? "CMTDensityListDlg"
               : CMTCountListKiv<CMTDensityItemKiv>::GetDlgRuntimeClass(code);
}
