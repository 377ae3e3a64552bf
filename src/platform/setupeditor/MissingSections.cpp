#include "MissingSections.h"

#include "paramfile/Kiv.h"
#include "paramfile/ParamFile.h"

#include <algorithm>
#include <charconv>
#include <string_view>

std::vector<int> NumberedSections(void* h, const CString& pattern, int count) {
    std::vector<int> numbers;
    const size_t at = pattern.find("%d");
    if (!h || at == CString::npos || count <= 0)
        return numbers;
    const std::string_view prefix(pattern.data(), at);
    const std::string_view suffix(pattern.data() + at + 2, pattern.size() - at - 2);
    const auto* s = static_cast<const paramfile::Section*>(h);
    for (int i = 0; i < s->EntryCount(); ++i) {
        if (!s->EntryIsSection(i))
            continue;
        const std::string_view name = s->SectionAt(i).Name();
        if (name.size() <= prefix.size() + suffix.size() || !name.starts_with(prefix) ||
            !name.ends_with(suffix))
            continue;
        const std::string_view digits =
            name.substr(prefix.size(), name.size() - prefix.size() - suffix.size());
        // Only the form "%d" writes: no sign, no leading zero.
        if (digits[0] < '1' || digits[0] > '9')
            continue;
        int n = 0;
        const auto r = std::from_chars(digits.data(), digits.data() + digits.size(), n);
        if (r.ec == std::errc() && r.ptr == digits.data() + digits.size() && n <= count)
            numbers.push_back(n);
    }
    std::sort(numbers.begin(), numbers.end());
    numbers.erase(std::unique(numbers.begin(), numbers.end()), numbers.end());
    return numbers;
}

MissingNumbers FindMissingNumbers(const std::vector<int>& present, int count) {
    MissingNumbers m;
    m.count = std::max(count, 0) - static_cast<int>(present.size());
    size_t next = 0;
    for (int n = 1; n <= count && static_cast<int>(m.first.size()) < std::min(m.count, kMissingSectionsShown); ++n) {
        if (next < present.size() && present[next] == n) {
            ++next;
            continue;
        }
        m.first.push_back(n);
    }
    return m;
}

void WarnMissingSections(void* h, const char* keyword, int count, int missing,
                         const std::vector<CString>& names, const char* consequence) {
    if (missing <= 0)
        return;
    CString list;
    for (const CString& name : names)
        list += (list.empty() ? "" : ", ") + name;
    const int more = missing - static_cast<int>(names.size());
    if (more > 0)
        list += FormatString(" and %d more", more);
    kivWarn(h, keyword,
            FormatString("%d of %d section%s %s missing (%s); %s", missing, count,
                         count == 1 ? "" : "s", missing == 1 ? "is" : "are", list.c_str(),
                         consequence));
}
