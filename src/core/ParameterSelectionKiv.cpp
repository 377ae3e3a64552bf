#include "ParameterSelectionKiv.h"

#include "setupeditor/Keywords.h"
#include "paramfile/Kiv.h"

#include <cstring>

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

namespace {
// Constants of the simulation engine, written ahead of the model definition.
struct EngineConstant {
    const char* section;
    const char* keyword;
    int value;
};
const EngineConstant kEngineConstants[] = {
    {"EQUATION", "formulation", 4},
    {"TIME", "start_time_step", 0},
    {"TIME", "time_step_factor", 1},
    {"SPACE", "number_of_2D_mesh_geometry", 1},
    {"SPACE", "number_of_2D_mesh_velocity", 1},
    {"SPACE", "number_of_2D_mesh_concentration", 1},
    {"SPACE", "number_of_3D_mesh_geometry", 2},
    {"SPACE", "number_of_3D_mesh_velocity", 2},
    {"SPACE", "number_of_3D_mesh_concentration", 2},
};
}  // namespace

void CParameterSelectionKiv::Save(void* h) {
    const char* open = nullptr;
    for (const EngineConstant& c : kEngineConstants) {
        if (!open || std::strcmp(open, c.section) != 0) {
            if (open)
                kivEndSection(h);
            kivAddSection(h, c.section);
            open = c.section;
        }
        kivPutParam(h, c.keyword, c.value);
    }
    kivEndSection(h);
    CZoSEKivBase::Save(h);
}

void CParameterSelectionKiv::Load(void* h) {
    // The constants are read only to say so when a file holds other values: they are
    // written as they are whatever the file held.
    for (const EngineConstant& c : kEngineConstants) {
        void* s = kivSectionByNameNum(h, c.section, 1);
        if (!s || !kivKeywordByNameNum(s, c.keyword, 1))
            continue;
        int value = c.value;
        kivGetParam(s, c.keyword, &value, 1, 1);
        if (value != c.value)
            kivWarn(s, c.keyword,
                    FormatString("%s = %d is a constant of the engine; saved as %d", c.keyword,
                                 value, c.value));
    }
    CZoSEKivBase::Load(h);
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

void CParameterSelectionKiv::DescribeKeywords(KeywordSink& sink) {
    static const KeywordDecl kDecls[] = {
        {"number_of_fractions", KeywordType::Int, "1", "Number of sediment fractions", 0, "1 .. 8"},
        {"number_of_layers", KeywordType::Int, "1", "Number of bed layers", 0, "1 .. 12"},
    };
    sink.Add(kDecls);
    // The engine's constants stand in sections of their own beside this one.
    for (const EngineConstant& c : kEngineConstants) {
        KeywordEntry e;
        e.path = sink.Outer() + "/" + c.section;
        e.keyword = c.keyword;
        e.type = KeywordType::Int;
        e.defaultValue = std::to_string(c.value);
        e.range = e.defaultValue;
        e.description = "A constant of the engine; always written as " + e.defaultValue;
        sink.Add(std::move(e));
    }
}
