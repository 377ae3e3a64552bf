#include "DomainKiv.h"

#include "BoundaryNamesKiv.h"
#include "datafile/ZoFileSelector.h"
#include "mesh/MeshIndex.h"
#include "mesh/MeshReader.h"
#include "setupeditor/KivFields.h"

#include <filesystem>

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

namespace {
// LayerTotNum adds the two counts: a count no mesh can have is refused on reading.
void CheckLayerCount(void* h, const char* keyword, int& value, int before) {
    if (value >= 0 && value <= CDomainKiv::kMaxLayers)
        return;
    kivWarn(h, keyword,
            FormatString("%s = %d is not a usable number of layers (0 to %d); kept %d", keyword,
                         value, CDomainKiv::kMaxLayers, before));
    value = before;
}
}  // namespace

CDomainKiv::CDomainKiv(CZoSEKivBase* parent) : CZoSEKivBase("Domain", "DOMAIN", parent) {
    SetDefault();
    GetRoot()->RegisterImportantNode(this, "Domain");
    m_boundaries = new CBoundaryNamesKiv(this);
    AddChild(m_boundaries);
}

CDomainKiv::~CDomainKiv() { GetRoot()->UnregisterImportantNode("Domain"); }

MeshInfo CDomainKiv::GetMeshInfo() const {
    return {m_xMin, m_xMax, m_yMin, m_yMax, m_zMin, m_zMax};
}

void CDomainKiv::SetMeshInfo(const MeshInfo& i) {
    m_xMin = i.xMin, m_xMax = i.xMax, m_yMin = i.yMin, m_yMax = i.yMax;
    m_zMin = i.zMin, m_zMax = i.zMax;
    NotifyListeners(kMeshChanged);
}

void CDomainKiv::MeshFile(const CString& file) {
    if (file != m_meshFile)
        m_mesh.reset(), m_meshPath.clear();
    m_meshFile = file;
    NotifyListeners(kMeshChanged);
}

bool CDomainKiv::LoadMesh(const CString& storedName, const std::string& path, std::string* error) {
    const FileStamp stamp = StampOf(path);
    MeshReadResult r = ReadMeshFile(path); // refuses folders, devices and FIFOs at once
    if (!r.mesh) {
        if (error)
            *error = r.error;
        return false;
    }
    TakeMesh(storedName, r.mesh);
    m_meshPath = std::filesystem::path(path).lexically_normal().string();
    m_meshStamp = stamp;
    return true;
}

void CDomainKiv::TakeMesh(const CString& storedName, MeshPtr mesh) {
    if (!mesh)
        return;
    m_mesh = std::move(mesh);
    m_meshPath.clear();
    m_meshFile = storedName;
    const MeshExtent& e = m_mesh->Extent();
    m_xMin = e.xMin, m_xMax = e.xMax, m_yMin = e.yMin, m_yMax = e.yMax;
    m_zMin = e.zMin, m_zMax = e.zMax;
    if (!m_mesh->projection.empty())
        m_projection = m_mesh->projection;
    const int n = static_cast<int>(m_mesh->boundaries.size());
    m_boundaries->SetItemCount(n, 1);
    for (int i = 1; i <= n; ++i) {
        CBoundaryNameKiv* item = m_boundaries->GetItem(i);
        item->Identifier(m_mesh->boundaries[static_cast<size_t>(i - 1)].name);
        item->BoundaryCode(m_mesh->boundaries[static_cast<size_t>(i - 1)].code);
    }
    NotifyListeners(kMeshChanged);
}

CDomainKiv::FileStamp CDomainKiv::StampOf(const std::string& path) {
    std::error_code ec;
    const auto status = std::filesystem::status(path, ec);
    if (ec || !std::filesystem::is_regular_file(status))
        return {};
    const auto size = std::filesystem::file_size(path, ec);
    const auto time = std::filesystem::last_write_time(path, ec);
    if (ec)
        return {};
    return {static_cast<long long>(size), static_cast<long long>(time.time_since_epoch().count())};
}

MeshPtr CDomainKiv::EnsureMesh(const std::string& path, std::string* error) {
    if (m_mesh && m_meshPath.empty())
        return m_mesh;  // taken from a mesh that the caller read
    if (!MeshExist())
        return nullptr;
    // The map and validation resolve the name each their own way; one file is one key.
    const std::string normal = std::filesystem::path(path).lexically_normal().string();
    // Validation asks after every edit: a large mesh, or one that fails late, is read once.
    const FileStamp stamp = StampOf(normal);
    if (normal != m_meshPath || stamp != m_meshStamp) {
        MeshReadResult r = ReadMeshFile(normal);
        m_mesh = r.mesh;
        m_meshPath = normal;
        m_meshStamp = stamp;
        m_meshError = r.error;
    }
    if (!m_mesh && error)
        *error = m_meshError;
    return m_mesh;
}

MeshPtr CDomainKiv::NamedMesh(std::string* error) {
    return EnsureMesh(CZoFileSelector(this).AbsolutePath(m_meshFile), error);
}

const CMeshIndex* CDomainKiv::NamedMeshIndex() {
    const MeshPtr mesh = NamedMesh();
    if (!mesh)
        return nullptr;
    if (m_indexed != mesh) {
        m_index = std::make_unique<CMeshIndex>(*mesh);
        m_indexed = mesh;
    }
    return m_index.get();
}

void CDomainKiv::Projection(const CString& p) {
    m_projection = p;
    NotifyListeners(kMeshChanged);
}

void CDomainKiv::ThreeD(bool value) {
    m_threeDimensional = value;
    NotifyListeners(kThreeDChanged);
}

void CDomainKiv::VerticalKind(int kind) {
    m_verticalKind = kind;
    NotifyListeners(kLayersChanged);
}

void CDomainKiv::LayerCount1(int n) {
    m_layers1 = n;
    NotifyListeners(kLayersChanged);
}

void CDomainKiv::LayerCount2(int n) {
    m_layers2 = n;
    NotifyListeners(kLayersChanged);
}

void CDomainKiv::WriteData(void* h) { WriteFields(h, *this, DomainFields::kFields); }

void CDomainKiv::ReadData(void* h) {
    const int layers1 = m_layers1, layers2 = m_layers2;
    const CString meshFile = m_meshFile;
    ReadFields(h, *this, DomainFields::kFields);
    if (m_meshFile != meshFile)
        m_mesh.reset(), m_meshPath.clear();
    CheckLayerCount(h, "number_of_sigma_layers", m_layers1, layers1);
    CheckLayerCount(h, "number_of_z_layers", m_layers2, layers2);
    NotifyListeners(kMeshChanged);
    NotifyListeners(kThreeDChanged);
    NotifyListeners(kLayersChanged);
}

int CDomainKiv::ValidateData() {
    int ok = 1;
    if (m_verticalKind != 1 && m_verticalKind != 2) {
        AddError(FormatString("Vertical layering %d is not known (1 sigma, 2 sigma and z)",
                              m_verticalKind));
        ok = 0;
    }
    if (m_layers1 < 0 || m_layers2 < 0 || m_layers1 > kMaxLayers || m_layers2 > kMaxLayers) {
        AddError(FormatString("The number of vertical layers must be between 0 and %d",
                              kMaxLayers));
        ok = 0;
    } else if (m_threeDimensional && LayerTotNum() < 1) {
        AddError("A three-dimensional domain needs at least one vertical layer");
        ok = 0;
    }
    if (MeshExist() && (m_xMin > m_xMax || m_yMin > m_yMax || m_zMin > m_zMax)) {
        AddError("The mesh extent has a minimum above its maximum");
        ok = 0;
    }
    if (MeshExist()) {
        std::string error;
        if (const MeshPtr mesh = NamedMesh(&error))
            ok &= CheckBoundaries(*mesh) ? 1 : 0;
        else {
            AddError("The mesh cannot be read: " + error);
            ok = 0;
        }
    }
    return ok;
}

bool CDomainKiv::CheckBoundaries(const CMesh& mesh) {
    const int stored = m_boundaries->GetItemCount();
    const int held = static_cast<int>(mesh.boundaries.size());
    if (stored != held) {
        AddError(FormatString(held == 1 ? "The mesh has %d open boundary, the setup %d: open the "
                                          "mesh again to take its boundaries"
                                        : "The mesh has %d open boundaries, the setup %d: open the "
                                          "mesh again to take its boundaries",
                              held, stored));
        return false;
    }
    bool ok = true;
    for (int i = 1; i <= stored; ++i) {
        const CString& name = m_boundaries->GetItem(i)->Identifier();
        const std::string& meshName = mesh.boundaries[static_cast<size_t>(i - 1)].name;
        if (name != meshName) {
            AddError(FormatString("Open boundary %d is named \"%s\" in the setup and \"%s\" in the mesh",
                                  i, name.c_str(), meshName.c_str()));
            ok = false;
        }
    }
    return ok;
}

void CDomainKiv::SetDefault() {
    DefaultFields(*this, DomainFields::kFields);
    m_mesh.reset();
    m_meshPath.clear();
    m_meshStamp = {};
}

CDomainKiv* Domain(const CZoSEKivBase* node) { return GetImportant<CDomainKiv>(node, "Domain"); }
