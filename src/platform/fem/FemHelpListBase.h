#pragma once

#include <map>

// Help topics by index, for nodes whose dialog has several pages (a map and a list, ...).
class CFemHelpListBase {
public:
    virtual ~CFemHelpListBase() = default;
    void HelpID(int index, unsigned long helpId) { m_ids[index] = helpId; }
    // 0 when none is set for the index.
    unsigned long GetHelpID(int index) const {
        auto it = m_ids.find(index);
        return it == m_ids.end() ? 0 : it->second;
    }

private:
    std::map<int, unsigned long> m_ids;
};
