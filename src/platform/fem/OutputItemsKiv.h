// A section of selectable output quantities: each item a label shown to the user, the
// keyword it is stored under and whether it is selected. Items keep the order they were
// added in; the section writes one integer keyword per item (1 selected, 0 not).
#pragma once

#include "setupeditor/ZoSEKivBase.h"

#include <vector>

class COutputItemsKiv : public CZoSEKivBase {
public:
    COutputItemsKiv(const CString& title, const CString& sectionName, CZoSEKivBase* parent)
        : CZoSEKivBase(title, sectionName, parent) {}

    void RemoveAllItems() { m_items.clear(); }
    void AddBasicItem(const CString& label, const CString& keyword, int type, bool selected) {
        m_items.push_back({label, keyword, type, selected});
    }
    int NumBasicItems() const { return static_cast<int>(m_items.size()); }
    // index from 0; false outside.
    bool GetBasicItem(int index, CString& label, CString& keyword, int& type,
                      bool& selected) const;
    bool IsBasicItemSelected(int index) const;
    void SetBasicItemSelected(int index, bool selected);

    void WriteData(void* h) override;
    void DescribeKeywords(KeywordSink& sink) override;
    // A missing keyword keeps the item's selection; keywords of no item are left alone.
    void ReadData(void* h) override;

private:
    struct Item {
        CString label;
        CString keyword;
        int type;
        bool selected;
    };
    std::vector<Item> m_items;
};
