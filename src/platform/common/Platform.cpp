#include "Platform.h"

#include <cstdio>
#include <vector>

CString FormatStringV(const char* format, va_list args) {
    va_list copy;
    va_copy(copy, args);
    char small[256];
    int n = std::vsnprintf(small, sizeof small, format, copy);
    va_end(copy);
    if (n < 0)
        return {};
    if (static_cast<size_t>(n) < sizeof small)
        return CString(small, static_cast<size_t>(n));
    std::vector<char> big(static_cast<size_t>(n) + 1);
    std::vsnprintf(big.data(), big.size(), format, args);
    return CString(big.data(), static_cast<size_t>(n));
}

CString FormatString(const char* format, ...) {
    va_list args;
    va_start(args, format);
    CString s = FormatStringV(format, args);
    va_end(args);
    return s;
}

CString ExpandNumberPattern(const CString& pattern, int number) {
    size_t at = pattern.find("%d");
    if (at == CString::npos)
        return pattern;
    const CString digits = std::to_string(number);
    CString out;
    out.reserve(pattern.size() + 8);
    size_t from = 0;
    for (; at != CString::npos; at = pattern.find("%d", from)) {
        out.append(pattern, from, at - from);
        out += digits;
        from = at + 2;
    }
    out.append(pattern, from, CString::npos);
    return out;
}

bool HasNumberPattern(const CString& pattern) { return pattern.find("%d") != CString::npos; }
