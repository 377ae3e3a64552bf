// The kiv* calls through which the model reads and writes the parameter file.
// Write handles are paramfile::Builder*; read handles are const paramfile::Section*,
// keyword handles const paramfile::Keyword*, parameter handles const paramfile::Param*.
// No call reports an error: absent sections and keywords show as null handles or
// unchanged values; a value of the wrong type leaves the target unchanged and adds a
// warning to the document.
#pragma once

#include <cstdint>
#include <string>

// --- writing -------------------------------------------------------------------------
void kivAddSection(void* h, const char* name);
void kivEndSection(void* h);
void kivPutParam(void* h, const char* keyword, int value);
void kivPutParam(void* h, const char* keyword, double value);
void kivPutParam(void* h, const char* keyword, float value);
void kivPutParam(void* h, const char* keyword, bool value);
void kivPutParam(void* h, const char* keyword, const std::string& value);
void kivPutParam(void* h, const char* keyword, const char* value);
void kivPutParamFilename(void* h, const char* keyword, const std::string& path);
void kivAddKeyword(void* h, const char* keyword);
void kivAddInt(void* h, int value);
void kivAddDouble(void* h, double value);
void kivAddFloat(void* h, float value);
void kivAddString(void* h, const std::string& value);
void kivAddFilename(void* h, const std::string& path);
void kivAddResultFilename(void* h, const std::string& path);
// format: one letter per value: i int, d double, f float (passed as double), b bool
// (passed as int), s string (const char*), F file name (const char*).
void kivPutListParam(void* h, const char* keyword, const char* format, ...);

// --- reading -------------------------------------------------------------------------
void* kivSectionByNameNum(void* h, const char* name, int n);
void* kivKeywordByNameNum(void* h, const char* keyword, int n);
int kivParamCount(void* k);
void* kivParamByNum(void* k, int n);  // n from 1; null past the end
double kivGetDouble(void* p);         // 0 when not a number
int kivGetInt(void* p);               // 0 when not an integer
std::string kivGetResultFilename(void* p);

// occurrence: which occurrence of the keyword (from 1); index: which parameter (from 1).
void kivGetParam(void* h, const char* keyword, int* value, int occurrence, int index);
void kivGetParam(void* h, const char* keyword, double* value, int occurrence, int index);
void kivGetParam(void* h, const char* keyword, float* value, int occurrence, int index);
void kivGetParam(void* h, const char* keyword, bool* value, int occurrence, int index);
void kivGetParam(void* h, const char* keyword, std::string* value, int occurrence, int index);
void kivGetParamFilename(void* h, const char* keyword, std::string* value, int occurrence,
                         int index);
// Pointers in format order (letters as kivPutListParam: i int*, d double*, f float*,
// b bool*, s and F std::string*). Values missing or of the wrong type leave their target.
void kivGetListParam(void* h, const char* keyword, int occurrence, const char* format, ...);

// Adds a warning at the keyword (or at the section when the keyword is absent).
void kivWarn(void* h, const char* keyword, const std::string& message);
