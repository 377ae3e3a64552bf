#include "ForcingsWavesKiv.h"

#include "ForcingsWaveDBListKiv.h"
#include "MTWaveFieldKiv.h"
#include "host/ModuleSelection.h"
#include "hydro/HDWindForcingKiv.h"
#include "setupeditor/KivFields.h"

namespace {
const char* const kKey = "MT Waves";
}

struct WavesFields {
    using F = KivField<CForcingsWavesKiv>;
    using K = CForcingsWavesKiv;
    static inline const F kFields[] = {
        F::DoubleAsFloat("minimum_waterdepth_for_including_waves", &K::m_minimumDepth, 0.0).Unit(100000).Doc("Depth below which waves are left out"),
        F::Bool("include_liquefaction", &K::m_includeLiquefaction, false).Doc("Whether waves liquefy the bed"),
        F::Double("liquefaction_factor", &K::m_liquefactionFactor, 1.0).Doc("Factor of the liquefaction"),
        F::Int("shearstress_formulation", &K::m_shearStress, 3).Doc("Formulation of the bed shear stress of waves and current"),
        F::Int("type", &K::m_type, 0).Choices("0 no waves, 1 wave field, 2 wave database, 3 spectral-wave field").Doc("Where the waves come from"),
    };
};

CForcingsWavesKiv::CForcingsWavesKiv(CZoSEKivBase* parent)
    : CZoSEKivBase("Waves", "WAVES", parent) {
    SetDefault();
    GetRoot()->RegisterImportantNode(this, kKey);
    m_waveField = new CMTWaveFieldKiv(this);
    AddChild(m_waveField);
    m_waveDatabase = new CForcingsWaveDBListKiv(this);
    AddChild(m_waveDatabase);
}

CForcingsWavesKiv::~CForcingsWavesKiv() {
    // The children look the section up while they go.
    DeleteChildren();
    GetRoot()->UnregisterImportantNode(kKey);
}

bool CForcingsWavesKiv::IsWaveDatabaseAvailable() const {
    const CHDWindForcingKiv* wind = WindForcing(this);
    return wind && wind->Include() != 0 && wind->WindType() >= 1;
}

bool CForcingsWavesKiv::IsSpectralWaveFieldAvailable() const {
    const CModuleSelection* modules = ModuleSelection(this);
    return GetRoot() && GetRoot()->DecoupledSimulation() == 0 && modules &&
           modules->SpectralWaveMode() >= 1;
}

std::vector<int> CForcingsWavesKiv::AvailableWaveTypes() const {
    std::vector<int> types = {kNoWaves, kWaveField};
    if (IsWaveDatabaseAvailable())
        types.push_back(kWaveDatabase);
    if (IsSpectralWaveFieldAvailable())
        types.push_back(kSpectralWaveField);
    return types;
}

CString CForcingsWavesKiv::WaveTypeText(int type) {
    switch (type) {
    case kNoWaves: return "No waves";
    case kWaveField: return "Wave field";
    case kWaveDatabase: return "Wave database";
    case kSpectralWaveField: return "Wave field from SW simulation";
    default: return {};
    }
}

const std::vector<CString>& CForcingsWavesKiv::ShearStressTexts() {
    static const std::vector<CString> texts = {
        "Mean (Soulsby et al. 1993)", "Max (Fredsoe and Deigaard)", "Max (Fredsoe 1981)",
        "Max (Soulsby et al. 1993)"};
    return texts;
}

void CForcingsWavesKiv::WriteData(void* h) { WriteFields(h, *this, WavesFields::kFields); }
void CForcingsWavesKiv::ReadData(void* h) { ReadFields(h, *this, WavesFields::kFields); }
void CForcingsWavesKiv::SetDefault() { DefaultFields(*this, WavesFields::kFields); }

int CForcingsWavesKiv::ValidateData() {
    if (m_type == kWaveDatabase && !IsWaveDatabaseAvailable()) {
        m_type = kNoWaves;
        AddError("The wave database needs wind forcing that varies in time; the wave type was "
                 "set to \"No waves\"");
    }
    return 1;
}

const char* CForcingsWavesKiv::GetDlgRuntimeClass(unsigned code) {
    return code == kDlgRuntimeClassRequest ? "CForcingsWavesDlg"
                                           : CZoSEKivBase::GetDlgRuntimeClass(code);
}

CForcingsWavesKiv* WavesSection(const CZoSEKivBase* node) {
    return GetImportant<CForcingsWavesKiv>(node, kKey);
}

void CForcingsWavesKiv::DescribeKeywords(KeywordSink& sink) { DescribeFields(sink, WavesFields::kFields); }
