// Stand-ins for the few Windows platform types the module is written against.
#pragma once

#include <cstdarg>
#include <string>

// The module's strings are UTF-8.
using CString = std::string;
using POSITION = int;

// printf-style formatting into a CString.
CString FormatString(const char* format, ...) __attribute__((format(printf, 1, 2)));
CString FormatStringV(const char* format, va_list args);

// Replaces every "%d" of a title or section-name pattern by number; other text is kept,
// so a pattern can never be misread as a format string.
CString ExpandNumberPattern(const CString& pattern, int number);
bool HasNumberPattern(const CString& pattern);
