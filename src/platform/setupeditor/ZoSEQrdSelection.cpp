#include "ZoSEQrdSelection.h"

#include "setupeditor/Keywords.h"
#include "paramfile/Kiv.h"

#include <algorithm>

namespace {
constexpr unsigned kMsgFileNotValid = 4112;
// An item list read from a file cannot ask for more entries than a data file may hold.
constexpr int kMaxItemNumbers = datafile::kMaxItems;
}  // namespace

ZoSEQrdSelection::ZoSEQrdSelection(const CString& title, const CString& sectionName,
                                   CZoSEKivBase* parent, int flag)
    : CZoSEKivBase(title, sectionName, parent), m_flag(flag) {}

int ZoSEQrdSelection::ItemNumber(int index) const {
    if (index < 1 || index > GetNoItems())
        return 0;
    return m_items[static_cast<std::size_t>(index - 1)];
}

void ZoSEQrdSelection::ItemNumber(int index, int number) {
    if (index < 1 || index > kMaxItemNumbers)
        return;
    if (index > GetNoItems())
        SetNoItems(index);
    m_items[static_cast<std::size_t>(index - 1)] = number;
}

void ZoSEQrdSelection::SetNoItems(int count) {
    count = std::max(0, std::min(count, kMaxItemNumbers));
    const int old = GetNoItems();
    m_items.resize(static_cast<std::size_t>(count));
    for (int i = old; i < count; ++i)
        m_items[static_cast<std::size_t>(i)] = i + 1;
}

void ZoSEQrdSelection::SetUpFileSelector(CZoFileSelector&) {}

CZoFileSelector ZoSEQrdSelection::MakeFileSelector() {
    CZoFileSelector selector(this);
    selector.SetFileName(m_fileName);
    selector.SetSelectedItems(m_items);
    SetUpFileSelector(selector);
    return selector;
}

CString ZoSEQrdSelection::AbsoluteFileName() const { return CZoFileSelector(this).AbsolutePath(m_fileName); }

bool ZoSEQrdSelection::IsFileValid(CString* error) {
    const CZoFileSelector selector = MakeFileSelector();
    if (m_items.empty())
        return selector.IsQrdFileValid(m_fileName, error);
    return selector.IsQrdFileValid(m_fileName, m_items, error);
}

void ZoSEQrdSelection::WriteData(void* h) {
    kivPutParamFilename(h, "file_name", m_fileName);
    kivAddKeyword(h, "item_numbers");
    for (int n : m_items)
        kivAddInt(h, n);
}

void ZoSEQrdSelection::ReadData(void* h) {
    kivGetParamFilename(h, "file_name", &m_fileName, 1, 1);
    if (void* k = kivKeywordByNameNum(h, "item_numbers", 1)) {
        const int n = std::min(kivParamCount(k), kMaxItemNumbers);
        std::vector<int> items(static_cast<std::size_t>(n));
        for (int i = 1; i <= n; ++i) {
            items[static_cast<std::size_t>(i - 1)] = ItemNumber(i) ? ItemNumber(i) : i;
            kivGetParam(h, "item_numbers", &items[static_cast<std::size_t>(i - 1)], 1, i);
        }
        m_items = std::move(items);
    }
}

int ZoSEQrdSelection::ValidateData() {
    CString why;
    if (IsFileValid(&why))
        return 1;
    AddError(kMsgFileNotValid, why);
    return 0;
}

void ZoSEQrdSelection::SetDefault() {
    m_fileName.clear();
    const int n = GetNoItems();
    m_items.clear();
    SetNoItems(n);
}

void ZoSEQrdSelection::DescribeKeywords(KeywordSink& sink) {
    static const KeywordDecl kDecls[] = {
        {"file_name", KeywordType::FileName, "''", "Data file"},
        {"item_numbers", KeywordType::IntList, "", "Items of the data file to read"},
    };
    sink.Add(kDecls);
}
