// The data-file selection: which data file a value reads and which of its items, and the
// test of whether a file will do. The item requests say what the caller needs (one
// request per item, each accepting some unit types); the time validation says which period
// the file's time axis must cover. The file-selector dialog (widgets) is built on this; the
// model uses it alone to validate.
#pragma once

#include "DataFile.h"
#include "common/Platform.h"

#include <cstdint>
#include <deque>
#include <memory>
#include <optional>
#include <vector>

class CZoSEKivBase;

class CZoItemRequest {
public:
    explicit CZoItemRequest(const CString& description) : m_description(description) {}
    const CString& Description() const { return m_description; }
    // The one unit type accepted / several accepted unit types.
    void SetOvuType(long type) { m_types = {type}; }
    void SetMultiOvuType(const std::vector<long>& types) { m_types = types; }
    const std::vector<long>& OvuTypes() const { return m_types; }
    // A request without unit types accepts any item.
    bool Accepts(long unitType) const;
    // "Wave height or Significant wave height".
    CString AcceptedText() const;

private:
    CString m_description;
    std::vector<long> m_types;
};

// One entry of a file filter: "Time series files (*.qrd0)" with its patterns {"*.qrd0"}.
struct ZoFilterEntry {
    CString description;
    std::vector<CString> patterns;
};
// Filters are written as "Text|*.a;*.b|Text|*.c||"; blanks around patterns are ignored.
std::vector<ZoFilterEntry> ZoParseFilter(const CString& filter);
// The same as a file dialog's filter: "Text (*.a *.b);;Text (*.c)"; "*.*" becomes "*".
CString ZoQtFilter(const CString& filter);

class CZoFileSelector {
public:
    CZoFileSelector() = default;
    // Relative file names are taken relative to the folder of the node's setup file.
    explicit CZoFileSelector(const CZoSEKivBase* context);
    virtual ~CZoFileSelector() = default;

    void SetBaseFolder(const CString& folder) { m_baseFolder = folder; }
    const CString& BaseFolder() const { return m_baseFolder; }
    // The path a stored name stands for ('\' read as '/'; relative to the base folder).
    CString AbsolutePath(const CString& fileName) const;
    // The name to store for a chosen path: relative when it lies in the base folder or below.
    CString StoredName(const CString& path) const;

    void SetFileName(const CString& name) { m_fileName = name; }
    const CString& FileName() const { return m_fileName; }
    void SetFilter(const CString& filter) { m_filter = filter; }
    const CString& Filter() const { return m_filter; }
    void SetDefaultExt(const CString& ext) { m_defaultExt = ext; }
    const CString& DefaultExt() const { return m_defaultExt; }

    // The kinds of file accepted: those the filter names, all where it offers "*.*" or is
    // empty, unless set here.
    void SetAcceptedKinds(std::vector<datafile::Kind> kinds) { m_kinds = std::move(kinds); }
    std::vector<datafile::Kind> AcceptedKinds() const;

    // Plug-ins (file converters) do not exist here; the flag is kept for the callers.
    void EnablePlugin(int enable) { m_plugin = enable != 0; }
    bool PluginEnabled() const { return m_plugin; }
    void SetMinNoItems(int n) { m_minItems = n; }
    int GetMinNoItems() const { return m_minItems; }

    CZoItemRequest& AddRequest(const CString& description);
    int RequestCount() const { return static_cast<int>(m_requests.size()); }
    const CZoItemRequest& Request(int index) const { return m_requests[static_cast<std::size_t>(index)]; }
    void ClearRequests() { m_requests.clear(); }

    // Item numbers (1-based), in the order of the requests.
    void SetSelectedItems(const std::vector<int>& items) { m_selected = items; }
    const std::vector<int>& SelectedItems() const { return m_selected; }
    // The name of an item of the current file; empty when the file or item does not exist.
    CString GetNameOfItem(int itemNumber) const;

    // The file's time axis must cover start .. start + steps × interval (seconds since 1970).
    void SetTimeValidation(std::int64_t start, std::int64_t steps, double interval);
    void ClearTimeValidation() { m_time.reset(); }
    bool HasTimeValidation() const { return m_time.has_value(); }

    // Whether the file will do, from its header alone: it exists and is a data file of an
    // accepted kind, it holds the item numbers and each has a unit type its request accepts,
    // and its time axis covers the period. error says what failed.
    bool IsQrdFileValid(const CString& fileName, const std::vector<int>& items,
                        CString* error) const;
    // Without item numbers: the file has enough items, and one for every request.
    bool IsQrdFileValid(const CString& fileName, CString* error) const;

    // The header of a file (cached).
    std::shared_ptr<const datafile::HeaderResult> Header(const CString& fileName) const;
    // Whether item itemNumber of the header may fill the request; why not in reason.
    bool CanAssign(const datafile::Header& header, int request, int itemNumber,
                   CString* reason) const;

private:
    bool Check(const CString& fileName, const std::vector<int>* items, CString* error) const;

    CString m_baseFolder;
    CString m_fileName;
    CString m_filter;
    CString m_defaultExt;
    std::optional<std::vector<datafile::Kind>> m_kinds;
    bool m_plugin = true;
    int m_minItems = 0;
    std::deque<CZoItemRequest> m_requests;
    std::vector<int> m_selected;
    struct Period {
        std::int64_t start;
        std::int64_t steps;
        double interval;
    };
    std::optional<Period> m_time;
};

// Unit-type names for messages: "Wave height" (or the code where the type is unknown).
CString ZoUnitTypeName(long unitType);
