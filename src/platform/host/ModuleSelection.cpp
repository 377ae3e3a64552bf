#include "ModuleSelection.h"

#include "setupeditor/KivFields.h"

struct ModuleSelectionFields {
    using F = KivField<CModuleSelection>;
    static inline const F kFields[] = {
        F::Int("mud_transport_mode", &CModuleSelection::m_mudTransportMode, 2).Doc("How the mud-transport module runs (0 not in use)"),
        F::Int("spectral_wave_mode", &CModuleSelection::m_spectralWaveMode, 0).Doc("How the spectral-wave module runs (0 not in use)"),
        F::Flag("decoupled_simulation", &CModuleSelection::m_decoupled, false).Choices("0 coupled, 1 decoupled").Doc("Whether the simulation runs decoupled from the flow"),
    };
};

CModuleSelection::CModuleSelection(CZoSEKivBase* parent)
    : CZoSEKivBase("Module Selection", "MODULE_SELECTION", parent) {
    SetDefault();
    GetRoot()->RegisterImportantNode(this, "ModuleSelection");
}

CModuleSelection::~CModuleSelection() { GetRoot()->UnregisterImportantNode("ModuleSelection"); }

void CModuleSelection::WriteData(void* h) { WriteFields(h, *this, ModuleSelectionFields::kFields); }
void CModuleSelection::ReadData(void* h) { ReadFields(h, *this, ModuleSelectionFields::kFields); }
void CModuleSelection::SetDefault() { DefaultFields(*this, ModuleSelectionFields::kFields); }

CModuleSelection* ModuleSelection(const CZoSEKivBase* node) {
    return GetImportant<CModuleSelection>(node, "ModuleSelection");
}

void CModuleSelection::DescribeKeywords(KeywordSink& sink) { DescribeFields(sink, ModuleSelectionFields::kFields); }
