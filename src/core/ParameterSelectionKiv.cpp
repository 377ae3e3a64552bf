#include "ParameterSelectionKiv.h"

#include "paramfile/Kiv.h"

namespace {
const char* const kKey = "MT Task Selection";

// Reads a count, refusing values no setup can hold.
void ReadCount(void* h, const char* keyword, int& value) {
    int read = value;
    kivGetParam(h, keyword, &read, 1, 1);
    if (read < 0 || read > kMaxModelCount) {
        kivWarn(h, keyword,
                FormatString("%s = %d is not a usable count (0 to %d); kept %d", keyword, read,
                             kMaxModelCount, value));
        return;
    }
    value = read;
}
}  // namespace

CParameterSelectionKiv::CParameterSelectionKiv(CZoSEKivBase* parent)
    : CZoSEKivBase("Parameter Selection", "MODEL_DEFINITION", parent) {
    GetRoot()->RegisterImportantNode(this, kKey);
}

CParameterSelectionKiv::~CParameterSelectionKiv() { GetRoot()->UnregisterImportantNode(kKey); }

void CParameterSelectionKiv::NumberOfFractions(int n) {
    m_fractions = n;
    NotifyListeners(kNotifyFractions);
}

void CParameterSelectionKiv::NumberOfLayers(int n) {
    m_layers = n;
    NotifyListeners(kNotifyLayers);
}

void CParameterSelectionKiv::Save(void* h) {
    // Constants of the simulation engine, written ahead of the model definition.
    kivAddSection(h, "EQUATION");
    kivPutParam(h, "formulation", 4);
    kivEndSection(h);
    kivAddSection(h, "TIME");
    kivPutParam(h, "start_time_step", 0);
    kivPutParam(h, "time_step_factor", 1);
    kivEndSection(h);
    kivAddSection(h, "SPACE");
    kivPutParam(h, "number_of_2D_mesh_geometry", 1);
    kivPutParam(h, "number_of_2D_mesh_velocity", 1);
    kivPutParam(h, "number_of_2D_mesh_concentration", 1);
    kivPutParam(h, "number_of_3D_mesh_geometry", 2);
    kivPutParam(h, "number_of_3D_mesh_velocity", 2);
    kivPutParam(h, "number_of_3D_mesh_concentration", 2);
    kivEndSection(h);
    CZoSEKivBase::Save(h);
}

void CParameterSelectionKiv::WriteData(void* h) {
    kivPutParam(h, "number_of_fractions", m_fractions);
    kivPutParam(h, "number_of_layers", m_layers);
}

void CParameterSelectionKiv::ReadData(void* h) {
    ReadCount(h, "number_of_fractions", m_fractions);
    ReadCount(h, "number_of_layers", m_layers);
    NotifyListeners(kNotifyFractions);
    NotifyListeners(kNotifyLayers);
}

int CParameterSelectionKiv::ValidateData() {
    if (m_fractions < 1 || m_fractions > 8 || m_layers < 1 || m_layers > 12) {
        AddError(4127);
        return 0;
    }
    return 1;
}

const char* CParameterSelectionKiv::GetDlgRuntimeClass(unsigned code) {
    return code == kDlgRuntimeClassRequest ? "CParameterSelectionDlg"
                                           : CZoSEKivBase::GetDlgRuntimeClass(code);
}

CParameterSelectionKiv* ModelDefinition(const CZoSEKivBase* node) {
    return GetImportant<CParameterSelectionKiv>(node, kKey);
}
