#include "DomainKiv.h"

#include "setupeditor/KivFields.h"

struct DomainFields {
    using F = KivField<CDomainKiv>;
    using K = CDomainKiv;
    static inline const F kFields[] = {
        F::FileName("mesh_file", &K::m_meshFile, ""),
        F::Double("x_min", &K::m_xMin, 0.0),
        F::Double("x_max", &K::m_xMax, 0.0),
        F::Double("y_min", &K::m_yMin, 0.0),
        F::Double("y_max", &K::m_yMax, 0.0),
        F::Double("z_min", &K::m_zMin, 0.0),
        F::Double("z_max", &K::m_zMax, 0.0),
        F::String("projection", &K::m_projection, "UTM-32"),
        F::Flag("three_dimensional", &K::m_threeDimensional, false),
        F::Int("vertical_kind", &K::m_verticalKind, 1),
        F::Int("number_of_sigma_layers", &K::m_layers1, 10),
        F::Int("number_of_z_layers", &K::m_layers2, 0),
    };
};

CDomainKiv::CDomainKiv(CZoSEKivBase* parent) : CZoSEKivBase("Domain", "DOMAIN", parent) {
    SetDefault();
    GetRoot()->RegisterImportantNode(this, "Domain");
}

CDomainKiv::~CDomainKiv() { GetRoot()->UnregisterImportantNode("Domain"); }

MeshInfo CDomainKiv::GetMeshInfo() const {
    return {m_xMin, m_xMax, m_yMin, m_yMax, m_zMin, m_zMax};
}

void CDomainKiv::SetMeshInfo(const MeshInfo& i) {
    m_xMin = i.xMin, m_xMax = i.xMax, m_yMin = i.yMin, m_yMax = i.yMax;
    m_zMin = i.zMin, m_zMax = i.zMax;
}

void CDomainKiv::WriteData(void* h) { WriteFields(h, *this, DomainFields::kFields); }

void CDomainKiv::ReadData(void* h) {
    ReadFields(h, *this, DomainFields::kFields);
    NotifyListeners(kMeshChanged);
}

int CDomainKiv::ValidateData() {
    if (m_layers1 < 0 || m_layers2 < 0) {
        AddError("The number of vertical layers cannot be negative");
        return 0;
    }
    return 1;
}

void CDomainKiv::SetDefault() { DefaultFields(*this, DomainFields::kFields); }

CDomainKiv* Domain(const CZoSEKivBase* node) { return GetImportant<CDomainKiv>(node, "Domain"); }
