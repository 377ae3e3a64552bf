#include "OutputItemsKiv.h"

#include "setupeditor/Keywords.h"
#include "paramfile/Kiv.h"

bool COutputItemsKiv::GetBasicItem(int index, CString& label, CString& keyword, int& type,
                                   bool& selected) const {
    if (index < 0 || index >= NumBasicItems())
        return false;
    const Item& item = m_items[static_cast<size_t>(index)];
    label = item.label;
    keyword = item.keyword;
    type = item.type;
    selected = item.selected;
    return true;
}

bool COutputItemsKiv::IsBasicItemSelected(int index) const {
    return index >= 0 && index < NumBasicItems() && m_items[static_cast<size_t>(index)].selected;
}

void COutputItemsKiv::SetBasicItemSelected(int index, bool selected) {
    if (index >= 0 && index < NumBasicItems())
        m_items[static_cast<size_t>(index)].selected = selected;
}

void COutputItemsKiv::WriteData(void* h) {
    for (const Item& item : m_items)
        kivPutParam(h, item.keyword.c_str(), item.selected ? 1 : 0);
}

void COutputItemsKiv::ReadData(void* h) {
    for (Item& item : m_items) {
        int value = item.selected ? 1 : 0;
        kivGetParam(h, item.keyword.c_str(), &value, 1, 1);
        item.selected = value == 1;
    }
}

void COutputItemsKiv::DescribeKeywords(KeywordSink& sink) {
    for (const Item& item : m_items) {
        KeywordEntry e;
        e.path = sink.Path();
        e.keyword = item.keyword;
        e.type = KeywordType::Int;
        e.defaultValue = item.selected ? "1" : "0";
        e.choices = "0 not written, 1 written";
        e.description = "Whether the output writes " + item.label;
        sink.Add(std::move(e));
    }
}
