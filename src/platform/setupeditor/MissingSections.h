// Items that a count promises but the file lacks are reported once per count, however many
// there are: a corrupt count of millions must not cost millions of messages.
#pragma once

#include "common/Platform.h"

#include <vector>

// How many section names a warning lists before it says "and N more".
constexpr int kMissingSectionsShown = 5;

// The numbers n, 1 <= n <= count, of the subsections of h named by pattern ("POINT_%d"),
// sorted and each once; found by one pass over the section, whatever the count. h is a
// read handle; nothing counts as read by this.
std::vector<int> NumberedSections(void* h, const CString& pattern, int count);

// The numbers from 1 to count that present (sorted) lacks: all of them counted, the first
// kMissingSectionsShown listed.
struct MissingNumbers {
    int count = 0;
    std::vector<int> first;
};
MissingNumbers FindMissingNumbers(const std::vector<int>& present, int count);

// Adds one warning at keyword: "3 of 5 sections are missing (A, B, C); consequence".
// names holds at most the first kMissingSectionsShown of them.
void WarnMissingSections(void* h, const char* keyword, int count, int missing,
                         const std::vector<CString>& names, const char* consequence);
