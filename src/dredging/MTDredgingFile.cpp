#include "MTDredgingFile.h"

#include "MTDredgingItemsKiv.h"
#include "projection/ZoMapProjection.h"

#include <algorithm>
#include <cctype>

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
