#include "ForcingsWaveDBFile.h"

#include "ForcingsWavesKiv.h"

namespace {
constexpr unsigned kMsgFileNotValid = 4112;
}

CForcingsWaveDBFile::CForcingsWaveDBFile(CZoSEKivBase* parent)
    : ZoSEQrdSelection("MT Waves Database file", "", parent, 1) {
    SetNoItems(kItems);
}

void CForcingsWaveDBFile::SetUpFileSelector(CZoFileSelector& selector) {
    selector.EnablePlugin(0);
    selector.SetMinNoItems(kItems);
    // A point's file is a wave field over the domain, as the selector's filter offers.
    selector.SetAcceptedKinds({datafile::Kind::Grid, datafile::Kind::MeshData});
    selector.AddRequest("Wave height").SetMultiOvuType({100084, 100097});
    selector.AddRequest("Wave period").SetOvuType(100085);
    selector.AddRequest("Wave direction").SetMultiOvuType({100095, 100407});
}

bool CForcingsWaveDBFile::CheckFile(CString* why) {
    const CForcingsWavesKiv* waves = WavesSection(this);
    if (waves && waves->WaveType() != CForcingsWavesKiv::kWaveDatabase)
        return true;
    // With the item numbers: items that are not the wave quantities would not do either.
    return IsFileValid(why);
}

void CForcingsWaveDBFile::SetDefault() {
    ZoSEQrdSelection::SetDefault();
    SetNoItems(kItems);
}

int CForcingsWaveDBFile::ValidateData() {
    CString why;
    if (CheckFile(&why))
        return 1;
    AddError(kMsgFileNotValid, why);
    return 0;
}
