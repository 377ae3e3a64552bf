#include "ZoSEKivListBase.h"

#include "MissingSections.h"

void CZoSEKivListBaseInterface::ReportMissingItems(void* section) {
    const char* keyword = nullptr;
    if (CountKeyword() && kivKeywordByNameNum(section, CountKeyword(), 1))
        keyword = CountKeyword();
    else if (kivKeywordByNameNum(section, "ZoSEKivListItemCount", 1))
        keyword = "ZoSEKivListItemCount";
    if (!keyword)
        return;
    const int count = GetItemCount();
    int missing = 0;
    std::vector<CString> names;
    for (int i = 1; i <= count; ++i) {
        const CString name = GetItemNode(i)->GetSectionName();
        if (name.empty() || kivSectionByNameNum(section, name.c_str(), 1))
            continue;
        if (++missing <= kMissingSectionsShown)
            names.push_back(name);
    }
    WarnMissingSections(section, keyword, count, missing, names, "those items take their defaults");
}
