#include "ZoFileSelector.h"

#include "DataFileCache.h"
#include "fem/UnitUtil.h"
#include "setupeditor/ZoSEKivBase.h"

#include <algorithm>
#include <cmath>
#include <filesystem>

namespace {

CString Trim(const CString& s) {
    const auto b = s.find_first_not_of(" \t\r\n");
    if (b == CString::npos)
        return {};
    const auto e = s.find_last_not_of(" \t\r\n");
    return s.substr(b, e - b + 1);
}

CString JoinOr(const std::vector<CString>& parts) {
    CString out;
    for (std::size_t i = 0; i < parts.size(); ++i) {
        if (i > 0)
            out += i + 1 == parts.size() ? " or " : ", ";
        out += parts[i];
    }
    return out;
}

CString TimeText(double seconds) {
    return datafile::FormatDateTime(static_cast<std::int64_t>(std::floor(seconds)));
}

const std::vector<datafile::Kind> kAllKinds = {datafile::Kind::TimeSeries, datafile::Kind::LineSeries,
                                               datafile::Kind::Grid, datafile::Kind::MeshData};

}  // namespace

CString ZoUnitTypeName(long unitType) {
    if (const QuantityInfo* q = CUnitUtil::FindQuantity(unitType))
        return q->name;
    return FormatString("unit type %ld", unitType);
}

bool CZoItemRequest::Accepts(long unitType) const {
    return m_types.empty() || std::find(m_types.begin(), m_types.end(), unitType) != m_types.end();
}

CString CZoItemRequest::AcceptedText() const {
    if (m_types.empty())
        return "any quantity";
    std::vector<CString> names;
    for (long t : m_types)
        names.push_back(ZoUnitTypeName(t));
    return JoinOr(names);
}

std::vector<ZoFilterEntry> ZoParseFilter(const CString& filter) {
    std::vector<CString> parts;
    std::size_t pos = 0;
    while (pos <= filter.size()) {
        const std::size_t bar = filter.find('|', pos);
        const std::size_t end = bar == CString::npos ? filter.size() : bar;
        parts.push_back(filter.substr(pos, end - pos));
        if (bar == CString::npos)
            break;
        pos = bar + 1;
    }
    std::vector<ZoFilterEntry> entries;
    for (std::size_t i = 0; i + 1 < parts.size(); i += 2) {
        const CString description = Trim(parts[i]);
        if (description.empty())
            break;
        ZoFilterEntry e{description, {}};
        std::size_t p = 0;
        const CString& list = parts[i + 1];
        while (p <= list.size()) {
            const std::size_t semi = list.find(';', p);
            const std::size_t end = semi == CString::npos ? list.size() : semi;
            const CString pattern = Trim(list.substr(p, end - p));
            if (!pattern.empty())
                e.patterns.push_back(pattern);
            if (semi == CString::npos)
                break;
            p = semi + 1;
        }
        entries.push_back(std::move(e));
    }
    return entries;
}

CString ZoQtFilter(const CString& filter) {
    CString out;
    for (const ZoFilterEntry& e : ZoParseFilter(filter)) {
        CString text = e.description;
        // The description usually repeats the patterns in parentheses; the dialog adds its own.
        if (!text.empty() && text.back() == ')') {
            const std::size_t open = text.rfind('(');
            if (open != CString::npos && text.find('*', open) != CString::npos)
                text = Trim(text.substr(0, open));
        }
        CString patterns;
        for (const CString& p : e.patterns)
            patterns += (patterns.empty() ? "" : " ") + (p == "*.*" ? CString("*") : p);
        if (!out.empty())
            out += ";;";
        out += text + " (" + patterns + ")";
    }
    return out;
}

CZoFileSelector::CZoFileSelector(const CZoSEKivBase* context) {
    if (context && context->GetRoot())
        m_baseFolder = context->GetRoot()->DocumentFolder();
}

CString CZoFileSelector::AbsolutePath(const CString& fileName) const {
    CString name = Trim(fileName);
    std::replace(name.begin(), name.end(), '\\', '/');
    if (name.empty())
        return name;
    std::filesystem::path p(name);
    if (p.is_absolute() || m_baseFolder.empty())
        return p.lexically_normal().string();
    return (std::filesystem::path(m_baseFolder) / p).lexically_normal().string();
}

CString CZoFileSelector::StoredName(const CString& path) const {
    if (m_baseFolder.empty() || path.empty())
        return path;
    const std::filesystem::path p = std::filesystem::path(path).lexically_normal();
    const std::filesystem::path rel = p.lexically_relative(std::filesystem::path(m_baseFolder).lexically_normal());
    if (rel.empty() || *rel.begin() == "..")
        return path;
    return rel.string();
}

std::vector<datafile::Kind> CZoFileSelector::AcceptedKinds() const {
    if (m_kinds)
        return *m_kinds;
    std::vector<datafile::Kind> kinds;
    for (const ZoFilterEntry& e : ZoParseFilter(m_filter))
        for (const CString& p : e.patterns) {
            if (p == "*.*" || p == "*")
                return kAllKinds;
            if (const auto k = datafile::KindFromExtension(p))
                if (std::find(kinds.begin(), kinds.end(), *k) == kinds.end())
                    kinds.push_back(*k);
        }
    return kinds.empty() ? kAllKinds : kinds;
}

CZoItemRequest& CZoFileSelector::AddRequest(const CString& description) {
    return m_requests.emplace_back(description);
}

void CZoFileSelector::SetTimeValidation(std::int64_t start, std::int64_t steps, double interval) {
    m_time = Period{start, steps, interval};
}

std::shared_ptr<const datafile::HeaderResult> CZoFileSelector::Header(const CString& fileName) const {
    return datafile::CachedHeader(AbsolutePath(fileName));
}

CString CZoFileSelector::GetNameOfItem(int itemNumber) const {
    if (Trim(m_fileName).empty())
        return {};
    const auto r = Header(m_fileName);
    if (!r->header || itemNumber < 1 || itemNumber > static_cast<int>(r->header->items.size()))
        return {};
    return r->header->items[static_cast<std::size_t>(itemNumber - 1)].name;
}

bool CZoFileSelector::CanAssign(const datafile::Header& h, int request, int itemNumber,
                                CString* reason) const {
    auto fail = [&](CString why) {
        if (reason)
            *reason = std::move(why);
        return false;
    };
    if (itemNumber < 1 || itemNumber > static_cast<int>(h.items.size()))
        return fail(FormatString("item %d: the file holds %d items", itemNumber,
                                 static_cast<int>(h.items.size())));
    if (request < 0 || request >= RequestCount())
        return true;
    const datafile::Item& item = h.items[static_cast<std::size_t>(itemNumber - 1)];
    const CZoItemRequest& r = Request(request);
    if (r.Accepts(item.unitType))
        return true;
    return fail(FormatString("item %d \"%s\" is a %s; \"%s\" needs %s", itemNumber,
                             item.name.c_str(), ZoUnitTypeName(item.unitType).c_str(),
                             r.Description().c_str(), r.AcceptedText().c_str()));
}

bool CZoFileSelector::IsQrdFileValid(const CString& fileName, const std::vector<int>& items,
                                     CString* error) const {
    return Check(fileName, &items, error);
}

bool CZoFileSelector::IsQrdFileValid(const CString& fileName, CString* error) const {
    return Check(fileName, nullptr, error);
}

bool CZoFileSelector::Check(const CString& fileName, const std::vector<int>* items,
                            CString* error) const {
    auto fail = [&](CString why) {
        if (error)
            *error = std::move(why);
        return false;
    };
    const CString name = Trim(fileName);
    if (name.empty())
        return fail("no data file is given");
    const auto r = Header(name);
    if (r->error) {
        datafile::Error e = *r->error;
        e.file = name;
        return fail(e.ToString());
    }
    const datafile::Header& h = *r->header;
    const std::vector<datafile::Kind> kinds = AcceptedKinds();
    if (std::find(kinds.begin(), kinds.end(), h.kind) == kinds.end()) {
        std::vector<CString> names;
        for (datafile::Kind k : kinds)
            names.push_back(datafile::KindName(k));
        return fail(name + ": a " + datafile::KindName(h.kind) + " file, where a " + JoinOr(names) +
                    " file is needed");
    }
    const int held = static_cast<int>(h.items.size());
    if (items) {
        const int needed = std::max(m_minItems, RequestCount());
        if (static_cast<int>(items->size()) < needed)
            return fail(FormatString("%s: %d items must be chosen, %d are", name.c_str(), needed,
                                     static_cast<int>(items->size())));
        for (std::size_t k = 0; k < items->size(); ++k) {
            CString why;
            if (!CanAssign(h, static_cast<int>(k), (*items)[k], &why))
                return fail(name + ": " + why);
        }
    } else {
        if (held < m_minItems)
            return fail(FormatString("%s: the file holds %d items, at least %d are needed",
                                     name.c_str(), held, m_minItems));
        for (const CZoItemRequest& req : m_requests)
            if (std::none_of(h.items.begin(), h.items.end(),
                             [&](const datafile::Item& i) { return req.Accepts(i.unitType); }))
                return fail(name + ": no item of the file can be the \"" + req.Description() +
                            "\" (" + req.AcceptedText() + ")");
    }
    if (m_time) {
        const double start = static_cast<double>(m_time->start);
        const double end = start + static_cast<double>(m_time->steps) * m_time->interval;
        const double fileStart = static_cast<double>(h.time.start);
        const double fileEnd = h.time.End();
        constexpr double kSlack = 1e-3;  // seconds: rounding of the step, not of the data
        if (fileStart > start + kSlack || fileEnd < end - kSlack)
            return fail(name + ": the time axis (" + TimeText(fileStart) + " to " +
                        TimeText(fileEnd) + ") does not cover the simulation period (" +
                        TimeText(start) + " to " + TimeText(end) + ")");
    }
    return true;
}
