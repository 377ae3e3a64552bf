#pragma once

#include "setupeditor/ZoSEQrdSelection.h"

#include <array>
#include <vector>

class CMTDredgingItemsKiv;

// The time series of a dredger: its x and y position, the rate of dredged mass and the
// spill, as four items of a data file. The dredger reads and writes the keywords in its own
// section, so this node's own persistence does nothing.
class CMTDredgingFile : public ZoSEQrdSelection {
public:
    static constexpr int kItemCount = 4;
    enum Item { kX = 1, kY = 2, kRate = 3, kSpill = 4 };

    explicit CMTDredgingFile(CMTDredgingItemsKiv* dredger);

    // index 1 to 4 (x, y, rate, spill); empty beyond.
    CString ItemName(int index) const override;
    void ItemName(int index, const CString& name);

    // Four requests: x and y in the dredger's projection, the rate and the spill.
    void SetUpFileSelector(CZoFileSelector& selector) override;

    // The positions of the track (items x and y, in the dredger's projection), at most
    // kMaxTrackPoints of them; points that are not numbers are left out. False, with the
    // reason, when the file cannot be read. Tracks are kept by file, size and time.
    static constexpr int kMaxTrackPoints = 100000;
    bool ReadTrack(std::vector<double>& x, std::vector<double>& y, CString* error = nullptr) const;

    void WriteData(void*) override {}
    void DescribeKeywords(KeywordSink&) override {}
    void ReadData(void*) override {}
    // The selector must accept the file with its four items, and the name must end in
    // "qrd0" or "kx0".
    int ValidateData() override;
    void SetDefault() override;

private:
    CMTDredgingItemsKiv* m_dredger;
    std::array<CString, kItemCount> m_itemNames;
};

// Whether a file name ends in "qrd0" or "kx0" (in any case).
bool IsDredgingFileName(const CString& fileName);
