#pragma once

#include "FemNotifier.h"
#include "mesh/Mesh.h"
#include "setupeditor/ZoSEKivBase.h"

class CBoundaryNamesKiv;
class CMeshIndex;

struct MeshInfo {
    double xMin = 0, xMax = 0, yMin = 0, yMax = 0, zMin = 0, zMax = 0;
};

// The model domain ("Domain"): the mesh (present or not, its extent and open boundaries),
// whether the model is three-dimensional with its vertical layers, and the map projection.
// Every change through a setter is told to the listeners.
class CDomainKiv : public CZoSEKivBase, public CFemNotifier {
public:
    enum Message {
        kThreeDChanged = 3,
        kMeshChanged = 10,   // mesh file, extent or projection
        kLayersChanged = 11,  // vertical kind or a layer count
    };
    // Layer counts read beyond this are refused (they would only ever be typing errors).
    static constexpr int kMaxLayers = 1000;

    explicit CDomainKiv(CZoSEKivBase* parent);
    ~CDomainKiv() override;

    bool MeshExist() const { return !m_meshFile.empty(); }
    const CString& MeshFile() const { return m_meshFile; }
    void MeshFile(const CString& file);
    MeshInfo GetMeshInfo() const;
    void SetMeshInfo(const MeshInfo& info);
    bool Is3D() const { return m_threeDimensional; }
    void Is3D(bool value) { ThreeD(value); }
    bool ThreeD() const { return m_threeDimensional; }
    void ThreeD(bool value);
    // 1: sigma layers only; 2: sigma and z layers.
    int VerticalKind() const { return m_verticalKind; }
    void VerticalKind(int kind);
    int LayerCount1() const { return m_layers1; }
    void LayerCount1(int n);
    int LayerCount2() const { return m_layers2; }
    void LayerCount2(int n);
    // The first count alone for vertical kind 1, else both together.
    int LayerTotNum() const { return m_verticalKind == 1 ? m_layers1 : m_layers1 + m_layers2; }
    const CString& Projection() const { return m_projection; }
    void Projection(const CString& p);

    // The mesh itself, shared by every view that shows it; null until it is read. A setup
    // read from a file names its mesh, whose geometry is read when a view first needs it.
    const MeshPtr& Mesh() const { return m_mesh; }
    // Reads the mesh at path and takes everything from it (TakeMesh); on failure the error
    // says why and nothing changes.
    bool LoadMesh(const CString& storedName, const std::string& path, std::string* error);
    // The mesh file (stored as storedName), extent, projection (when the mesh names one) and
    // open boundaries from a mesh, the boundary list following through its list operations.
    void TakeMesh(const CString& storedName, MeshPtr mesh);
    // The geometry of the mesh already named, read from path (resolved by the caller) once,
    // and again only when the file changes (also when it could not be read); the stored
    // extent and boundaries stay as they are. Null with the error when unreadable.
    MeshPtr EnsureMesh(const std::string& path, std::string* error);
    // EnsureMesh of the named mesh, a relative name taken against the setup's folder.
    MeshPtr NamedMesh(std::string* error = nullptr);
    // The spatial index of NamedMesh, built once for it; null when there is no mesh to use.
    const CMeshIndex* NamedMeshIndex();

    // The open boundaries of the mesh, registered as "BoundaryNames".
    CBoundaryNamesKiv* BoundaryNames() const { return m_boundaries; }

    void WriteData(void* h) override;
    void ReadData(void* h) override;
    int ValidateData() override;
    void SetDefault() override;

private:
    friend struct DomainFields;
    CString m_meshFile;
    double m_xMin = 0, m_xMax = 0, m_yMin = 0, m_yMax = 0, m_zMin = 0, m_zMax = 0;
    bool m_threeDimensional = false;
    int m_verticalKind = 1;
    int m_layers1 = 0;
    int m_layers2 = 0;
    CString m_projection;
    CBoundaryNamesKiv* m_boundaries = nullptr;
    struct FileStamp {
        long long size = -1, time = 0;
        bool operator==(const FileStamp&) const = default;
    };
    static FileStamp StampOf(const std::string& path);
    bool CheckBoundaries(const CMesh& mesh);

    MeshPtr m_mesh;
    std::string m_meshPath;   // where m_mesh was read from
    FileStamp m_meshStamp;    // of m_meshPath when it was read
    std::string m_meshError;  // why m_meshPath could not be read
    MeshPtr m_indexed;        // the mesh m_index was built for
    std::unique_ptr<CMeshIndex> m_index;
};

CDomainKiv* Domain(const CZoSEKivBase* node);
