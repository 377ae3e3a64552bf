// A node that refers to a data file and to a list of its item numbers. Sections derive from
// it, say what they need of the file (SetUpFileSelector: item requests, minimum number of
// items) and check it with IsFileValid; the file-selector dialog edits it.
#pragma once

#include "ZoSEKivBase.h"
#include "datafile/ZoFileSelector.h"

#include <vector>

class ZoSEQrdSelection : public CZoSEKivBase {
public:
    // flag: the user chooses items of the file (1), or only the file (0).
    ZoSEQrdSelection(const CString& title, const CString& sectionName, CZoSEKivBase* parent,
                     int flag);

    const CString& FileName() const { return m_fileName; }
    void FileName(const CString& name) { m_fileName = name; }
    // index is 1-based; 0 for an index beyond the list.
    int ItemNumber(int index) const;
    void ItemNumber(int index, int number);  // grows the list to index when needed
    const std::vector<int>& ItemNumber() const { return m_items; }
    void ItemNumber(const std::vector<int>& numbers) { m_items = numbers; }
    // Sets the number of items; new ones take their position as item number (1, 2, 3, ...).
    void SetNoItems(int count);
    int GetNoItems() const { return static_cast<int>(m_items.size()); }
    int Flag() const { return m_flag; }

    // Per-item names are the deriving section's; the base has none.
    virtual CString ItemName(int /*index*/) const { return {}; }

    // Item requests and the like; the base asks for nothing.
    virtual void SetUpFileSelector(CZoFileSelector& selector);
    // A selector for this node: relative names against the setup's folder, set up by
    // SetUpFileSelector, holding the file name and the item numbers.
    CZoFileSelector MakeFileSelector();
    // The data file's path with a relative name taken against the setup file's folder.
    CString AbsoluteFileName() const;
    // IsQrdFileValid of a selector from MakeFileSelector with the node's item numbers
    // (without them when the node holds none).
    bool IsFileValid(CString* error = nullptr);

    // "file_name" and "item_numbers"; sections that keep the keywords elsewhere override.
    void WriteData(void* h) override;
    void DescribeKeywords(KeywordSink& sink) override;
    void ReadData(void* h) override;
    // The file check; "File is not valid", with the reason, when it fails.
    int ValidateData() override;
    void SetDefault() override;

private:
    int m_flag;
    CString m_fileName;
    std::vector<int> m_items;
};
