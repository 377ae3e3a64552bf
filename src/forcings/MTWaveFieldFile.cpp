#include "MTWaveFieldFile.h"

#include "ForcingsWavesKiv.h"
#include "MTWaveFieldKiv.h"
#include "fem/SimulationPeriodKiv.h"

#include <cctype>
#include <cstring>

namespace {
constexpr unsigned kMsgFileNotValid = 4112;
}

bool EndsWithNoCase(const CString& name, const char* ext) {
    const std::size_t n = std::strlen(ext);
    if (name.size() < n)
        return false;
    for (std::size_t i = 0; i < n; ++i) {
        const auto a = static_cast<unsigned char>(name[name.size() - n + i]);
        const auto b = static_cast<unsigned char>(ext[i]);
        if (std::tolower(a) != std::tolower(b))
            return false;
    }
    return true;
}

CMTWaveFieldFile::CMTWaveFieldFile(CMTWaveFieldKiv* parent)
    : ZoSEQrdSelection("Wave field data file", "", parent, 1) {
    SetNoItems(kItems);
}

CMTWaveFieldKiv* CMTWaveFieldFile::WaveField() const {
    return static_cast<CMTWaveFieldKiv*>(GetParent());
}

CString CMTWaveFieldFile::ItemName(int index) const {
    if (index < 1 || index > kItems)
        return {};
    return m_itemNames[static_cast<std::size_t>(index - 1)];
}

void CMTWaveFieldFile::ItemName(int index, const CString& name) {
    if (index >= 1 && index <= kItems)
        m_itemNames[static_cast<std::size_t>(index - 1)] = name;
}

void CMTWaveFieldFile::SetUpFileSelector(CZoFileSelector& selector) {
    if (const CSimulationPeriodKiv* period = SimulationPeriod(this))
        period->SetUpQrdValidation_SimulationPeriod(selector);
    const int format = WaveField()->GetFormat();
    if (format != CMTWaveFieldKiv::kTimeSeries && format != CMTWaveFieldKiv::kTimeAndDomain)
        return;
    // The kinds the check takes, so that the selector refuses the others with its reason.
    if (format == CMTWaveFieldKiv::kTimeSeries)
        selector.SetAcceptedKinds({datafile::Kind::TimeSeries});
    else
        selector.SetAcceptedKinds({datafile::Kind::Grid, datafile::Kind::MeshData});
    selector.AddRequest("Wave height").SetMultiOvuType({100084, 100097});
    selector.AddRequest("Wave period").SetOvuType(100085);
    selector.AddRequest("Wave direction").SetMultiOvuType({100095, 100407});
}

bool CMTWaveFieldFile::CheckFile(CString* why) {
    const CForcingsWavesKiv* waves = WavesSection(this);
    if (!waves || waves->WaveType() != CForcingsWavesKiv::kWaveField)
        return true;
    const CString& name = FileName();
    auto misnamed = [&](const char* endings) {
        if (why)
            *why = FormatString("the file name does not end in %s", endings);
        return false;
    };
    switch (WaveField()->GetFormat()) {
    case CMTWaveFieldKiv::kTimeSeries:
        if (!EndsWithNoCase(name, "qrd0") && !EndsWithNoCase(name, "kx0"))
            return misnamed("qrd0 or kx0");
        return IsFileValid(why);
    case CMTWaveFieldKiv::kTimeAndDomain:
        if (!EndsWithNoCase(name, "qrdu") && !EndsWithNoCase(name, "qrd2") &&
            !EndsWithNoCase(name, "kx2"))
            return misnamed("qrdu, qrd2 or kx2");
        return IsFileValid(why);
    default:
        return true;
    }
}

void CMTWaveFieldFile::SetDefault() {
    ZoSEQrdSelection::SetDefault();
    SetNoItems(kItems);
    m_itemNames = {};
}

int CMTWaveFieldFile::ValidateData() {
    CString why;
    if (CheckFile(&why))
        return 1;
    AddError(kMsgFileNotValid, why);
    return 0;
}
