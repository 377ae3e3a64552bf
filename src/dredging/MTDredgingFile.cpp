#include "MTDredgingFile.h"

#include "MTDredgingItemsKiv.h"
#include "projection/ZoMapProjection.h"

#include <algorithm>
#include <cctype>
#include <cmath>
#include <filesystem>
#include <map>
#include <tuple>

namespace {
constexpr unsigned kMsgFileNotValid = 4112;
constexpr long kGeographicalCoordinate = 100157;
constexpr long kProjectedCoordinate = 100183;

bool EndsWithNoCase(const CString& text, const char* suffix) {
    const CString s(suffix);
    if (text.size() < s.size())
        return false;
    return std::equal(s.begin(), s.end(), text.end() - static_cast<std::ptrdiff_t>(s.size()),
                      [](char a, char b) {
                          return std::tolower(static_cast<unsigned char>(a)) ==
                                 std::tolower(static_cast<unsigned char>(b));
                      });
}
struct TrackKey {
    std::string path;
    std::uintmax_t size;
    std::filesystem::file_time_type time;
    int x, y;
    bool operator<(const TrackKey& o) const {
        return std::tie(path, size, time, x, y) < std::tie(o.path, o.size, o.time, o.x, o.y);
    }
};
struct Track {
    std::vector<double> x, y;
};
// Pages redraw the map after every change; the file is read again only when it changed.
std::map<TrackKey, Track>& TrackCache() {
    static std::map<TrackKey, Track> cache;
    return cache;
}
constexpr std::size_t kMaxCachedTracks = 64;
}  // namespace

bool IsDredgingFileName(const CString& fileName) {
    return EndsWithNoCase(fileName, "qrd0") || EndsWithNoCase(fileName, "kx0");
}

CMTDredgingFile::CMTDredgingFile(CMTDredgingItemsKiv* dredger)
    : ZoSEQrdSelection("MT Dredging file", "", dredger, 1), m_dredger(dredger) {
    SetNoItems(kItemCount);
}

CString CMTDredgingFile::ItemName(int index) const {
    if (index < 1 || index > kItemCount)
        return {};
    return m_itemNames[static_cast<std::size_t>(index - 1)];
}

void CMTDredgingFile::ItemName(int index, const CString& name) {
    if (index >= 1 && index <= kItemCount)
        m_itemNames[static_cast<std::size_t>(index - 1)] = name;
}

void CMTDredgingFile::SetUpFileSelector(CZoFileSelector& selector) {
    selector.EnablePlugin(0);
    selector.SetMinNoItems(kItemCount);
    // A dredger's positions and rates are one series in time.
    selector.SetAcceptedKinds({datafile::Kind::TimeSeries});
    const long coordinate = CZoMapProjection::IsGeographical(m_dredger->CoordinateType())
                                ? kGeographicalCoordinate
                                : kProjectedCoordinate;
    selector.AddRequest("x-coordinate").SetOvuType(coordinate);
    selector.AddRequest("y-coordinate").SetOvuType(coordinate);
    selector.AddRequest("rate of dredged mass").SetMultiOvuType({100195, 100504});
    selector.AddRequest("spill").SetMultiOvuType({100013, 100505});
}

bool CMTDredgingFile::ReadTrack(std::vector<double>& x, std::vector<double>& y,
                                CString* error) const {
    auto fail = [&](CString why) {
        if (error)
            *error = std::move(why);
        return false;
    };
    x.clear();
    y.clear();
    const CString path = AbsoluteFileName();
    if (path.empty())
        return fail("no data file is given");
    std::error_code ec;
    const auto size = std::filesystem::file_size(path, ec);
    const auto time = ec ? std::filesystem::file_time_type() : std::filesystem::last_write_time(path, ec);
    if (ec) {
        // Not a regular file: the reader says what it is, without reading from it.
        const datafile::HeaderResult h = datafile::ReadHeader(path);
        return fail(FileName() + ": " +
                    (h.error ? h.error->message : CString("the file does not exist")));
    }
    const TrackKey key{path, size, time, ItemNumber(kX), ItemNumber(kY)};
    auto& cache = TrackCache();
    if (auto it = cache.find(key); it != cache.end()) {
        x = it->second.x;
        y = it->second.y;
        return true;
    }
    datafile::ValuesRequest request;
    request.items = {key.x - 1, key.y - 1};
    request.maxSteps = kMaxTrackPoints;
    request.check = false;
    datafile::Header header;
    const datafile::ValuesResult r = datafile::ReadValues(path, request, &header);
    if (r.error)
        return fail(r.error->ToString());
    if (header.kind != datafile::Kind::TimeSeries)
        return fail(FileName() + ": not a time series");
    for (const std::vector<double>& row : r.rows)
        if (row.size() == 2 && std::isfinite(row[0]) && std::isfinite(row[1])) {
            x.push_back(row[0]);
            y.push_back(row[1]);
        }
    if (cache.size() >= kMaxCachedTracks)
        cache.clear();
    cache[key] = Track{x, y};
    return true;
}

int CMTDredgingFile::ValidateData() {
    if (!IsFileValid() || !IsDredgingFileName(FileName())) {
        AddError(kMsgFileNotValid);
        return 0;
    }
    return 1;
}

void CMTDredgingFile::SetDefault() {
    FileName("");
    ItemNumber(std::vector<int>{1, 2, 3, 4});
    m_itemNames = {};
}
