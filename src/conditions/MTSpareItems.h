// Items that a list dropped when it shrank, kept to be made new again when it grows: with a
// value per boundary (or source) and fraction, changing the number of fractions would
// otherwise free and allocate again hundreds of thousands of small items.
#pragma once

#include <vector>

template <class T>
class CMTSpareItems {
public:
    CMTSpareItems() = default;
    CMTSpareItems(const CMTSpareItems&) = delete;
    CMTSpareItems& operator=(const CMTSpareItems&) = delete;
    ~CMTSpareItems() {
        for (T* item : m_items)
            delete item;
    }

    void Keep(T* item) { m_items.push_back(item); }
    // The item dropped last (the one that stood at the place to be filled first), or null.
    T* Take() {
        if (m_items.empty())
            return nullptr;
        T* item = m_items.back();
        m_items.pop_back();
        return item;
    }

private:
    std::vector<T*> m_items;
};
