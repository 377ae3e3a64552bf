// UGRID netCDF: the variable with cf_role = "mesh_topology" names the node coordinates and
// the face-node connectivity (triangles and quadrilaterals, start_index 0 or 1, _FillValue
// for the missing fourth node). Bed levels come from a node variable of the mesh whose
// standard_name is "altitude" (or a sea-floor depth, positive down). Open boundaries come
// from boundary_node_connectivity together with a boundary variable of the mesh holding
// one code per edge; its flag_values and flag_meanings give the boundaries' names. Codes 0
// and 1 are land. The projection comes from the coordinates' grid_mapping (epsg_code) or
// from longitude/latitude standard names.
#include "MeshReader.h"
#include "projection/ZoMapProjection.h"
#include "fileio/NetcdfHeader.h"

#include <netcdf.h>

#include <algorithm>
#include <cmath>
#include <map>
#include <new>
#include <sstream>

namespace {

// A dimension of a netCDF-4 file can claim far more than the file holds; nothing is
// allocated beyond this (about 33 million nodes or elements).
constexpr size_t kMaxCount = size_t(1) << 25;

struct Fail {
    std::string message;
};

class File {
public:
    // maxCount: the most nodes, elements or rows the file can hold (see MaxCountOf).
    File(const std::string& path, size_t maxCount) : m_path(path), m_maxCount(maxCount) {
        m_status = nc_open(path.c_str(), NC_NOWRITE, &m_id);
    }
    ~File() {
        if (m_status == NC_NOERR)
            nc_close(m_id);
    }
    int Status() const { return m_status; }
    size_t MaxCount() const { return m_maxCount; }
    int Id() const { return m_id; }

    std::string TextAtt(int var, const char* name) const {
        nc_type type;
        size_t len = 0;
        if (nc_inq_att(m_id, var, name, &type, &len) != NC_NOERR || type != NC_CHAR ||
            len > (1 << 20))
            return {};
        std::string s(len, '\0');
        if (nc_get_att_text(m_id, var, name, s.data()) != NC_NOERR)
            return {};
        while (!s.empty() && s.back() == '\0')
            s.pop_back();
        return s;
    }
    bool IntAtt(int var, const char* name, long long& v) const {
        nc_type type;
        size_t len = 0;
        if (nc_inq_att(m_id, var, name, &type, &len) != NC_NOERR || len != 1 || type == NC_CHAR)
            return false;
        return nc_get_att_longlong(m_id, var, name, &v) == NC_NOERR;
    }
    std::vector<long long> IntsAtt(int var, const char* name) const {
        nc_type type;
        size_t len = 0;
        if (nc_inq_att(m_id, var, name, &type, &len) != NC_NOERR || type == NC_CHAR || len > 100000)
            return {};
        std::vector<long long> v(len);
        if (nc_get_att_longlong(m_id, var, name, v.data()) != NC_NOERR)
            return {};
        return v;
    }
    int Var(const std::string& name) const {
        int v = -1;
        return nc_inq_varid(m_id, name.c_str(), &v) == NC_NOERR ? v : -1;
    }
    std::vector<size_t> Shape(int var) const {
        int nd = 0;
        if (nc_inq_varndims(m_id, var, &nd) != NC_NOERR || nd < 0 || nd > NC_MAX_VAR_DIMS)
            return {};
        std::vector<int> dims(static_cast<size_t>(nd));
        nc_inq_vardimid(m_id, var, dims.data());
        std::vector<size_t> shape;
        for (int d : dims) {
            size_t len = 0;
            nc_inq_dimlen(m_id, d, &len);
            shape.push_back(len);
        }
        return shape;
    }
    std::string Name(int var) const {
        char name[NC_MAX_NAME + 1] = {};
        nc_inq_varname(m_id, var, name);
        return name;
    }
    int VarCount() const {
        int n = 0;
        nc_inq_nvars(m_id, &n);
        return n;
    }

private:
    std::string m_path;
    size_t m_maxCount = 0;
    int m_id = -1;
    int m_status = NC_NOERR;
};

std::vector<std::string> Words(const std::string& s) {
    std::istringstream in(s);
    std::vector<std::string> w;
    for (std::string t; in >> t;)
        w.push_back(t);
    return w;
}

void Check(int status, const std::string& what) {
    if (status != NC_NOERR)
        throw Fail{what + ": " + nc_strerror(status)};
}

std::vector<double> Doubles(const File& f, int var, size_t n, const std::string& what) {
    const std::vector<size_t> shape = f.Shape(var);
    if (shape.size() != 1 || shape[0] != n)
        throw Fail{what + " must be one value per node"};
    std::vector<double> v(n);
    if (n)
        Check(nc_get_var_double(f.Id(), var, v.data()), what);
    for (double d : v)
        if (!std::isfinite(d))
            throw Fail{what + " holds a value that is not a number"};
    return v;
}

int TopologyVariable(const File& f) {
    for (int v = 0; v < f.VarCount(); ++v)
        if (f.TextAtt(v, "cf_role") == "mesh_topology") {
            long long dim = 2;
            f.IntAtt(v, "topology_dimension", dim);
            if (dim == 2)
                return v;
        }
    throw Fail{
        "no variable with cf_role = \"mesh_topology\" and topology_dimension 2 (not a UGRID mesh)"};
}

// Node indices from 0 in an edge or face table, with the fill value as -1.
std::vector<int> Connectivity(const File& f, int var, size_t nodes, size_t columns,
                              const std::string& what, size_t& rows) {
    const std::vector<size_t> shape = f.Shape(var);
    if (shape.size() != 2 || (columns && shape[1] != columns) || shape[1] < 3 - (columns == 2) ||
        shape[1] > 4)
        throw Fail{what + " must have " +
                   (columns == 2 ? std::string("two nodes") : std::string("3 or 4 nodes")) +
                   " a row"};
    rows = shape[0];
    if (rows > f.MaxCount())
        throw Fail{what + ": more rows than can be read (" + std::to_string(rows) + ")"};
    std::vector<long long> raw(rows * shape[1]);
    if (!raw.empty())
        Check(nc_get_var_longlong(f.Id(), var, raw.data()), what);
    long long start = 0, fill = NC_FILL_INT;
    f.IntAtt(var, "start_index", start);
    const bool hasFill = f.IntAtt(var, "_FillValue", fill);
    std::vector<int> out(rows * 4, -1);
    for (size_t r = 0; r < rows; ++r) {
        int valid = 0;
        for (size_t c = 0; c < shape[1]; ++c) {
            const long long v = raw[r * shape[1] + c];
            if ((hasFill && v == fill) || (!hasFill && v == NC_FILL_INT) || v < start) {
                continue;
            }
            const long long index = v - start;
            if (index >= static_cast<long long>(nodes))
                throw Fail{what + " row " + std::to_string(r + 1) + " names node " +
                           std::to_string(v) + ", which does not exist"};
            out[r * 4 + static_cast<size_t>(valid++)] = static_cast<int>(index);
        }
        const int need = columns == 2 ? 2 : 3;
        if (valid < need)
            throw Fail{what + " row " + std::to_string(r + 1) + " has fewer than " +
                       std::to_string(need) + " nodes"};
        for (int i = 0; i < valid; ++i)
            for (int j = 0; j < i; ++j)
                if (out[r * 4 + i] == out[r * 4 + j])
                    throw Fail{what + " row " + std::to_string(r + 1) + " names a node twice"};
    }
    return out;
}

// The edges of one code chained into a line from one end to the other.
std::vector<int> Chain(const std::vector<std::pair<int, int>>& edges, int code) {
    std::map<int, std::vector<int>> next;
    for (auto [a, b] : edges) {
        next[a].push_back(b);
        next[b].push_back(a);
    }
    // From the end with the lower node number, so that the same edges give the same line.
    int start = -1;
    for (const auto& [n, adj] : next) {
        if (adj.size() > 2)
            throw Fail{"boundary code " + std::to_string(code) + " branches at a node"};
        if (adj.size() == 1 && start < 0)
            start = n;
    }
    if (start < 0)
        start = next.begin()->first;
    std::vector<int> line{start};
    int prev = -1, at = start;
    for (size_t step = 0; step < edges.size(); ++step) {
        const std::vector<int>& adj = next[at];
        const int to = adj[0] != prev ? adj[0] : (adj.size() > 1 ? adj[1] : -1);
        if (to < 0)
            break;
        line.push_back(to);
        prev = at;
        at = to;
    }
    if (line.size() != edges.size() + 1)
        throw Fail{"boundary code " + std::to_string(code) + " is not one connected line"};
    return line;
}

void ReadBoundaries(const File& f, int topo, const std::string& topoName, CMesh& mesh) {
    const std::string connName = f.TextAtt(topo, "boundary_node_connectivity");
    if (connName.empty())
        return;
    const int conn = f.Var(connName);
    if (conn < 0)
        throw Fail{"boundary_node_connectivity names " + connName + ", which does not exist"};
    size_t rows = 0;
    const std::vector<int> edges = Connectivity(f, conn, mesh.NodeCount(), 2, connName, rows);
    int codesVar = -1;
    for (int v = 0; v < f.VarCount() && codesVar < 0; ++v)
        if (f.TextAtt(v, "mesh") == topoName && f.TextAtt(v, "location") == "boundary")
            codesVar = v;
    // Without codes the edges cannot be told apart from the land boundary.
    if (codesVar < 0)
        return;
    const std::vector<size_t> shape = f.Shape(codesVar);
    if (shape.size() != 1 || shape[0] != rows)
        throw Fail{f.Name(codesVar) + " must hold one code per boundary edge"};
    std::vector<int> codes(rows);
    if (rows)
        Check(nc_get_var_int(f.Id(), codesVar, codes.data()), f.Name(codesVar));
    std::map<int, std::string> names;
    const std::vector<long long> values = f.IntsAtt(codesVar, "flag_values");
    const std::vector<std::string> meanings = Words(f.TextAtt(codesVar, "flag_meanings"));
    for (size_t i = 0; i < values.size() && i < meanings.size(); ++i) {
        std::string n = meanings[i];
        std::replace(n.begin(), n.end(), '_', ' ');
        names[static_cast<int>(values[i])] = n;
    }
    std::map<int, std::vector<std::pair<int, int>>> byCode;
    for (size_t r = 0; r < rows; ++r)
        if (codes[r] > 1)
            byCode[codes[r]].push_back({edges[r * 4], edges[r * 4 + 1]});
    for (const auto& [code, list] : byCode) {
        MeshBoundary b;
        b.code = code;
        b.name = names.count(code) ? names[code]
                                   : "Boundary " + std::to_string(mesh.boundaries.size() + 1);
        b.nodes = Chain(list, code);
        mesh.boundaries.push_back(std::move(b));
    }
}

std::string Projection(const File& f, int xVar) {
    if (f.TextAtt(xVar, "standard_name") == "longitude")
        return "LONG/LAT";
    const int crs = f.Var(f.TextAtt(xVar, "grid_mapping"));
    if (crs < 0)
        return {};
    long long epsg = 0;
    std::string code = f.TextAtt(crs, "epsg_code");
    if (code.rfind("EPSG:", 0) == 0)
        code = code.substr(5);
    if (!code.empty())
        epsg = std::atoll(code.c_str());
    else
        f.IntAtt(crs, "epsg", epsg);
    return epsg > 0 && epsg < INT32_MAX ? CZoMapProjection::FromEpsg(static_cast<int>(epsg))
                                        : std::string();
}

// Every value takes at least a byte of a classic file; compressed netCDF-4 data takes at
// least a byte in 1032 (the best that deflate does).
size_t MaxCountOf(const fileio::NetcdfCheck& check) {
    const auto size = static_cast<unsigned long long>(check.size);
    const unsigned long long most =
        check.format == fileio::NetcdfFormat::Hdf5 ? size * 1032 : size;
    return static_cast<size_t>(std::min<unsigned long long>(most, kMaxCount));
}

} // namespace

MeshReadResult ReadUgrid(const std::string& path) {
    // A header that claims more than the file holds would make the library allocate by it.
    fileio::NetcdfCheck check;
    if (const auto failure = fileio::PrecheckNetcdf(path, &check))
        return {nullptr, path + ": " + failure->Text()};
    File f(path, MaxCountOf(check));
    if (f.Status() != NC_NOERR)
        return {nullptr, path + ": " + nc_strerror(f.Status())};
    try {
        auto mesh = std::make_shared<CMesh>();
        const int topo = TopologyVariable(f);
        const std::string topoName = f.Name(topo);
        const std::vector<std::string> coords = Words(f.TextAtt(topo, "node_coordinates"));
        if (coords.size() != 2)
            throw Fail{topoName + ": node_coordinates must name two variables"};
        const int xVar = f.Var(coords[0]), yVar = f.Var(coords[1]);
        if (xVar < 0 || yVar < 0)
            throw Fail{topoName + ": node coordinate " + coords[xVar < 0 ? 0 : 1] +
                       " does not exist"};
        const std::vector<size_t> xShape = f.Shape(xVar);
        if (xShape.size() != 1 || xShape[0] == 0)
            throw Fail{"no nodes in " + coords[0]};
        const size_t n = xShape[0];
        if (n > f.MaxCount())
            throw Fail{"more nodes than can be read (" + std::to_string(n) + ")"};
        mesh->x = Doubles(f, xVar, n, coords[0]);
        mesh->y = Doubles(f, yVar, n, coords[1]);
        mesh->z.assign(n, 0.0);
        for (int v = 0; v < f.VarCount(); ++v) {
            if (f.TextAtt(v, "mesh") != topoName || f.TextAtt(v, "location") != "node")
                continue;
            const std::string sn = f.TextAtt(v, "standard_name");
            const bool down =
                f.TextAtt(v, "positive") == "down" || sn.rfind("sea_floor_depth", 0) == 0;
            if (sn != "altitude" && sn.rfind("sea_floor_depth", 0) != 0)
                continue;
            mesh->z = Doubles(f, v, n, f.Name(v));
            if (down)
                for (double& z : mesh->z)
                    z = -z;
            break;
        }
        const std::string facesName = f.TextAtt(topo, "face_node_connectivity");
        const int faces = f.Var(facesName);
        if (faces < 0)
            throw Fail{
                topoName + ": face_node_connectivity " +
                (facesName.empty() ? std::string("missing") : facesName + " does not exist")};
        size_t rows = 0;
        const std::vector<int> table = Connectivity(f, faces, n, 0, facesName, rows);
        if (rows == 0)
            throw Fail{"no elements in " + facesName};
        mesh->elements.resize(rows);
        for (size_t r = 0; r < rows; ++r)
            std::copy_n(table.begin() + static_cast<long>(r * 4), 4, mesh->elements[r].begin());
        ReadBoundaries(f, topo, topoName, *mesh);
        mesh->projection = Projection(f, xVar);
        mesh->Finish();
        return {std::move(mesh), {}};
    } catch (const Fail& e) {
        return {nullptr, path + ": " + e.message};
    } catch (const std::bad_alloc&) {
        return {nullptr, path + ": too large to read"};
    }
}
