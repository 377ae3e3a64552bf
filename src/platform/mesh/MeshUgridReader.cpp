// UGRID netCDF: the variable with cf_role = "mesh_topology" and topology_dimension 2 names
// the node coordinates and the face-node connectivity (triangles and quadrilaterals, in
// either layout, start_index 0 or 1, fill values for the missing fourth node). x and y are
// told apart by standard_name, units or axis. The bed level is a node variable of the mesh
// recognised by standard_name or by the names tools use; its fill values are missing
// levels. Open boundaries come from boundary_node_connectivity together with a boundary
// variable of the mesh holding one code per edge; its flag_values and flag_meanings give
// the boundaries' names. Codes 0 and 1 are land. The projection comes from a grid_mapping
// on any variable of the mesh, or from geographical coordinates.
#include "MeshReader.h"
#include "projection/ZoMapProjection.h"
#include "fileio/NetcdfHeader.h"

#include <netcdf.h>

#include <algorithm>
#include <cctype>
#include <cmath>
#include <cstdlib>
#include <iomanip>
#include <map>
#include <new>
#include <sstream>

namespace {

// A dimension of a netCDF-4 file can claim far more than the file holds; nothing is
// allocated beyond this (about 33 million nodes or elements).
constexpr size_t kMaxCount = size_t(1) << 25;
// Wider face tables than this are not read at all.
constexpr size_t kMaxFaceColumns = 64;

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
    bool HasAtt(int var, const char* name) const {
        return nc_inq_attid(m_id, var, name, nullptr) == NC_NOERR;
    }
    // Numeric attributes of any type, floats included.
    std::vector<double> NumbersAtt(int var, const char* name) const {
        nc_type type;
        size_t len = 0;
        if (nc_inq_att(m_id, var, name, &type, &len) != NC_NOERR || type == NC_CHAR ||
            type == NC_STRING || len == 0 || len > 100000)
            return {};
        std::vector<double> v(len);
        if (nc_get_att_double(m_id, var, name, v.data()) != NC_NOERR)
            return {};
        return v;
    }
    bool NumberAtt(int var, const char* name, double& v) const {
        const std::vector<double> n = NumbersAtt(var, name);
        if (n.size() != 1)
            return false;
        v = n[0];
        return true;
    }
    int Var(const std::string& name) const {
        int v = -1;
        return !name.empty() && nc_inq_varid(m_id, name.c_str(), &v) == NC_NOERR ? v : -1;
    }
    int Dim(const std::string& name) const {
        int d = -1;
        return !name.empty() && nc_inq_dimid(m_id, name.c_str(), &d) == NC_NOERR ? d : -1;
    }
    nc_type Type(int var) const {
        nc_type t = NC_NAT;
        nc_inq_vartype(m_id, var, &t);
        return t;
    }
    std::vector<int> Dims(int var) const {
        int nd = 0;
        if (nc_inq_varndims(m_id, var, &nd) != NC_NOERR || nd < 0 || nd > NC_MAX_VAR_DIMS)
            return {};
        std::vector<int> dims(static_cast<size_t>(nd));
        nc_inq_vardimid(m_id, var, dims.data());
        return dims;
    }
    std::vector<size_t> Shape(int var) const {
        std::vector<size_t> shape;
        for (int d : Dims(var)) {
            size_t len = 0;
            nc_inq_dimlen(m_id, d, &len);
            shape.push_back(len);
        }
        return shape;
    }
    std::string DimName(int dim) const {
        char name[NC_MAX_NAME + 1] = {};
        nc_inq_dimname(m_id, dim, name);
        return name;
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

std::string Lower(std::string s) {
    for (char& c : s)
        c = static_cast<char>(std::tolower(static_cast<unsigned char>(c)));
    return s;
}

void Check(int status, const std::string& what) {
    if (status != NC_NOERR)
        throw Fail{what + ": " + nc_strerror(status)};
}

double DefaultFill(nc_type t) {
    switch (t) {
    case NC_BYTE:
        return NC_FILL_BYTE;
    case NC_UBYTE:
        return NC_FILL_UBYTE;
    case NC_SHORT:
        return NC_FILL_SHORT;
    case NC_USHORT:
        return NC_FILL_USHORT;
    case NC_INT:
        return NC_FILL_INT;
    case NC_UINT:
        return NC_FILL_UINT;
    case NC_INT64:
        return static_cast<double>(NC_FILL_INT64);
    case NC_UINT64:
        return static_cast<double>(NC_FILL_UINT64);
    case NC_FLOAT:
        return NC_FILL_FLOAT;
    default:
        return NC_FILL_DOUBLE;
    }
}

// The values of a variable that stand for no value: its _FillValue (else the type's
// default fill), its missing_value, and anything that is not a finite number.
struct NoValue {
    std::vector<double> values;
    bool declared = false; // _FillValue or missing_value given
    bool operator()(double v) const {
        return !std::isfinite(v) || std::find(values.begin(), values.end(), v) != values.end();
    }
};

NoValue NoValues(const File& f, int var) {
    NoValue n;
    n.values = f.NumbersAtt(var, "_FillValue");
    n.declared = !n.values.empty();
    if (n.values.empty())
        n.values.push_back(DefaultFill(f.Type(var)));
    const std::vector<double> missing = f.NumbersAtt(var, "missing_value");
    n.declared = n.declared || !missing.empty();
    n.values.insert(n.values.end(), missing.begin(), missing.end());
    return n;
}

std::vector<double> Coordinates(const File& f, int var, size_t n, const std::string& what) {
    const std::vector<size_t> shape = f.Shape(var);
    if (shape.size() != 1 || shape[0] != n)
        throw Fail{what + " must be one value per node"};
    std::vector<double> v(n);
    if (n)
        Check(nc_get_var_double(f.Id(), var, v.data()), what);
    const NoValue none = NoValues(f, var);
    for (double d : v)
        if (none(d))
            throw Fail{what + " holds a fill value or a value that is not a number"};
    return v;
}

struct Topology {
    int var = -1;
    std::string name;
};

// The 2D topology; any others are named in a note.
Topology FindTopology(const File& f, std::vector<std::string>& notes) {
    std::vector<std::pair<int, long long>> all;
    for (int v = 0; v < f.VarCount(); ++v)
        if (f.TextAtt(v, "cf_role") == "mesh_topology") {
            double dim = 2;
            f.NumberAtt(v, "topology_dimension", dim);
            all.push_back({v, std::isfinite(dim) && std::fabs(dim) < 1e9 ? std::llround(dim) : 0});
        }
    if (all.empty())
        throw Fail{"no variable with cf_role = \"mesh_topology\" (not a UGRID mesh)"};
    Topology t;
    for (const auto& [v, dim] : all)
        if (dim == 2 && (t.var < 0 || (!f.HasAtt(t.var, "face_node_connectivity") &&
                                       f.HasAtt(v, "face_node_connectivity"))))
            t = {v, f.Name(v)};
    std::string others;
    for (const auto& [v, dim] : all)
        if (v != t.var)
            others += (others.empty() ? "" : ", ") + f.Name(v) + " (" + std::to_string(dim) + "D)";
    if (t.var < 0)
        throw Fail{"no 2D mesh topology (only " + others + ")"};
    if (!others.empty())
        notes.push_back("2D topology " + t.name + " taken; passed over: " + others);
    return t;
}

// Node indices from 0 in an edge (columns 2) or face (columns 0: 3 or 4 nodes) table, four
// a row with -1 for none. faceDim, when known, tells which dimension counts the rows.
std::vector<int> Connectivity(const File& f, int var, size_t nodes, size_t columns, int faceDim,
                              const std::string& what, size_t& rows) {
    const char* const row = columns == 2 ? "edge" : "face";
    const std::vector<size_t> shape = f.Shape(var);
    const std::vector<int> dims = f.Dims(var);
    if (shape.size() != 2)
        throw Fail{what + " must be a table of two dimensions"};
    // The older layout puts the nodes of a row first.
    bool transposed;
    if (faceDim >= 0 && columns != 2)
        transposed = dims[1] == faceDim && dims[0] != faceDim;
    else if (columns == 2)
        transposed = shape[0] == 2 && shape[1] != 2;
    else {
        // A first dimension named as the nodes of a face ("nMaxMesh2_face_nodes"), or 3 or
        // 4 long against more faces, puts the nodes first.
        const bool max0 = Lower(f.DimName(dims[0])).find("max") != std::string::npos;
        const bool max1 = Lower(f.DimName(dims[1])).find("max") != std::string::npos;
        transposed = max0 != max1 ? max0 : (shape[0] == 3 || shape[0] == 4) && shape[1] > 4;
    }
    rows = shape[transposed ? 1 : 0];
    const size_t width = shape[transposed ? 0 : 1];
    if (columns == 2 && width != 2)
        throw Fail{what + " must have two nodes an edge"};
    if (columns != 2 && width > kMaxFaceColumns)
        throw Fail{what + ": faces of up to " + std::to_string(width) +
                   " nodes: the flow model takes triangles and quadrilaterals"};
    if (rows > f.MaxCount() || rows * width > 4 * f.MaxCount())
        throw Fail{what + ": more rows than can be read (" + std::to_string(rows) + ")"};
    // Read as doubles: any integer type, and floating tables with NaN as fill, alike.
    std::vector<double> raw(rows * width);
    if (!raw.empty())
        Check(nc_get_var_double(f.Id(), var, raw.data()), what);
    double start = 0;
    f.NumberAtt(var, "start_index", start);
    if (!(start >= 0 && start <= 1e9) || start != std::floor(start))
        throw Fail{what + ": start_index is not a whole number from 0"};
    const NoValue none = NoValues(f, var);
    std::vector<int> out(rows * 4, -1);
    size_t widest = 0, widestRow = 0;
    for (size_t r = 0; r < rows; ++r) {
        size_t valid = 0;
        for (size_t c = 0; c < width; ++c) {
            const double v = raw[transposed ? c * rows + r : r * width + c];
            // Tables without a declared fill mark the missing nodes by negative numbers.
            if (none(v) || (!none.declared && v < 0))
                continue;
            const double index = v - start;
            if (v != std::floor(v) || index < 0 || index >= static_cast<double>(nodes)) {
                std::ostringstream text;
                text << std::setprecision(17) << what << ": " << row << " " << r + 1
                     << " names node " << v << ", which does not exist (nodes " << start << " to "
                     << start + static_cast<double>(nodes) - 1 << ")";
                throw Fail{text.str()};
            }
            if (valid < 4)
                out[r * 4 + valid] = static_cast<int>(index);
            ++valid;
        }
        if (valid > widest)
            widest = valid, widestRow = r;
        const size_t need = columns == 2 ? 2 : 3;
        if (valid < need)
            throw Fail{what + ": " + row + " " + std::to_string(r + 1) + " has fewer than " +
                       std::to_string(need) + " nodes"};
        for (size_t i = 0; i < std::min<size_t>(valid, 4); ++i)
            for (size_t j = 0; j < i; ++j)
                if (out[r * 4 + i] == out[r * 4 + j])
                    throw Fail{what + ": " + row + " " + std::to_string(r + 1) +
                               " names a node twice"};
    }
    if (widest > 4)
        throw Fail{what + ": faces of up to " + std::to_string(widest) +
                   " nodes: the flow model takes triangles and quadrilaterals (face " +
                   std::to_string(widestRow + 1) + ")"};
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

void ReadBoundaries(const File& f, const Topology& topo, CMesh& mesh) {
    const std::string connName = f.TextAtt(topo.var, "boundary_node_connectivity");
    if (connName.empty())
        return;
    const int conn = f.Var(connName);
    if (conn < 0)
        throw Fail{"boundary_node_connectivity names " + connName + ", which does not exist"};
    size_t rows = 0;
    const std::vector<int> edges = Connectivity(f, conn, mesh.NodeCount(), 2, -1, connName, rows);
    int codesVar = -1;
    for (int v = 0; v < f.VarCount() && codesVar < 0; ++v)
        if (f.TextAtt(v, "mesh") == topo.name && f.TextAtt(v, "location") == "boundary")
            codesVar = v;
    // Without codes the edges cannot be told apart from the land boundary.
    if (codesVar < 0) {
        mesh.notes.push_back(connName +
                             " passed over: no boundary variable gives the edges' codes");
        return;
    }
    const std::vector<size_t> shape = f.Shape(codesVar);
    if (shape.size() != 1 || shape[0] != rows)
        throw Fail{f.Name(codesVar) + " must hold one code per boundary edge"};
    std::vector<int> codes(rows);
    if (rows)
        Check(nc_get_var_int(f.Id(), codesVar, codes.data()), f.Name(codesVar));
    std::map<int, std::string> names;
    const std::vector<double> values = f.NumbersAtt(codesVar, "flag_values");
    const std::vector<std::string> meanings = Words(f.TextAtt(codesVar, "flag_meanings"));
    for (size_t i = 0; i < values.size() && i < meanings.size(); ++i) {
        std::string n = meanings[i];
        std::replace(n.begin(), n.end(), '_', ' ');
        if (std::isfinite(values[i]) && std::fabs(values[i]) < 1e9)
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

// 'x' or 'y' for a coordinate that says which it is, else 0; geographical tells degrees.
char Axis(const File& f, int var, bool* geographical = nullptr) {
    const std::string sn = f.TextAtt(var, "standard_name");
    const std::string units = Lower(f.TextAtt(var, "units"));
    const auto is = [&](const char* a, const char* b) { return sn == a || sn == b; };
    const auto unitsOf = [&](const std::string& end) {
        for (const char* d : {"degrees_", "degree_", "degrees", "degree"})
            if (units == d + end || units == d + end.substr(0, 1))
                return true;
        return false;
    };
    char axis = 0;
    bool geo = false;
    if (is("longitude", "grid_longitude") || (sn.empty() && unitsOf("east")))
        axis = 'x', geo = true;
    else if (is("latitude", "grid_latitude") || (sn.empty() && unitsOf("north")))
        axis = 'y', geo = true;
    else if (sn == "projection_x_coordinate")
        axis = 'x';
    else if (sn == "projection_y_coordinate")
        axis = 'y';
    else if (sn.empty()) {
        const std::string a = Lower(f.TextAtt(var, "axis"));
        axis = a == "x" ? 'x' : a == "y" ? 'y' : 0;
    }
    if (geographical)
        *geographical = geo;
    return axis;
}

// The two node coordinates, x first, whatever order node_coordinates lists them in; from
// several pairs the projected one.
std::pair<std::string, std::string> NodeCoordinates(const File& f, const Topology& topo,
                                                    std::vector<std::string>& notes) {
    const std::vector<std::string> coords = Words(f.TextAtt(topo.var, "node_coordinates"));
    if (coords.size() < 2)
        throw Fail{topo.name + ": node_coordinates must name two variables"};
    for (const std::string& c : coords)
        if (f.Var(c) < 0)
            throw Fail{topo.name + ": node coordinate " + c + " does not exist"};
    std::string x, y, gx, gy;
    for (const std::string& c : coords) {
        bool geo = false;
        const char a = Axis(f, f.Var(c), &geo);
        if (a == 0)
            continue;
        std::string& slot = a == 'x' ? (geo ? gx : x) : (geo ? gy : y);
        if (slot.empty())
            slot = c;
    }
    if (x.empty() || y.empty())
        x = gx, y = gy;
    if (x.empty() || y.empty()) {
        // Nothing says which is which: the order of node_coordinates.
        x = coords[0], y = coords[1];
        if (Axis(f, f.Var(x)) == 'y' || Axis(f, f.Var(y)) == 'x')
            std::swap(x, y);
    }
    if (x == coords[1] && y == coords[0])
        notes.push_back("node_coordinates lists y first: x is " + x + ", y is " + y);
    if (coords.size() > 2)
        notes.push_back("node coordinates " + x + " and " + y + " taken of " +
                        std::to_string(coords.size()));
    return {x, y};
}

// The bed level: a node variable of the mesh by standard_name, else by the names tools use;
// depths are turned into levels. Fill values are missing levels.
void ReadBedLevel(const File& f, const Topology& topo, int nodeDim, CMesh& mesh) {
    static const char* const kUp[] = {"altitude",           "height_above_mean_sea_level",
                                      "height_above_geoid", "height_above_reference_ellipsoid",
                                      "surface_altitude",   "bed_altitude"};
    static const char* const kNamesUp[] = {"mesh2d_node_z", "netnode_z", "node_z", "elevation",
                                           "bed_level"};
    static const char* const kNamesDown[] = {"depth", "bathymetry", "bottom_depth"};
    const size_t n = mesh.NodeCount();
    int best = -1, bestRank = 9;
    bool down = false;
    for (int v = 0; v < f.VarCount(); ++v) {
        const std::vector<int> dims = f.Dims(v);
        const nc_type type = f.Type(v);
        if (dims.size() != 1 || dims[0] != nodeDim || type == NC_CHAR || type < NC_BYTE ||
            type > NC_UINT64)
            continue;
        const std::string mesh_ = f.TextAtt(v, "mesh"), location = f.TextAtt(v, "location");
        if (!mesh_.empty() && mesh_ != topo.name)
            continue;
        if (!location.empty() && location != "node")
            continue;
        const std::string sn = f.TextAtt(v, "standard_name");
        const std::string name = Lower(f.Name(v));
        int rank = 9;
        bool isDepth = false;
        if (std::find(std::begin(kUp), std::end(kUp), sn) != std::end(kUp))
            rank = 0;
        else if (sn.rfind("sea_floor_depth", 0) == 0 || sn == "depth")
            rank = 0, isDepth = true;
        else if (!sn.empty())
            continue; // a quantity of its own
        else if (std::find(std::begin(kNamesUp), std::end(kNamesUp), name) != std::end(kNamesUp) ||
                 name == Lower(topo.name) + "_node_z")
            rank = 1;
        else if (std::find(std::begin(kNamesDown), std::end(kNamesDown), name) !=
                 std::end(kNamesDown))
            rank = 1, isDepth = true;
        // Among equals, the variable that says it belongs to the mesh.
        if (rank < 9 && mesh_.empty())
            rank += 2;
        if (rank >= bestRank)
            continue;
        const std::string positive = Lower(f.TextAtt(v, "positive"));
        best = v, bestRank = rank;
        down = positive == "down" || (positive != "up" && isDepth);
    }
    mesh.z.assign(n, 0.0);
    if (best < 0) {
        mesh.zMissing.assign(n, 1);
        mesh.notes.push_back("bed level: none found (no node variable of the mesh is a bed "
                             "level or a depth)");
        return;
    }
    const std::string what = f.Name(best);
    Check(nc_get_var_double(f.Id(), best, mesh.z.data()), what);
    const NoValue none = NoValues(f, best);
    double scale = 1, offset = 0;
    f.NumberAtt(best, "scale_factor", scale);
    f.NumberAtt(best, "add_offset", offset);
    size_t missing = 0;
    std::vector<char> flags(n, 0);
    for (size_t i = 0; i < n; ++i) {
        double& z = mesh.z[i];
        if (none(z)) {
            flags[i] = 1, z = 0, ++missing;
            continue;
        }
        z = z * scale + offset;
        if (down)
            z = -z;
        if (!std::isfinite(z))
            flags[i] = 1, z = 0, ++missing;
    }
    if (missing) {
        mesh.zMissing = std::move(flags);
        mesh.notes.push_back("bed level missing on " + std::to_string(missing) + " of " +
                             std::to_string(n) + " nodes (fill values in " + what + ")");
    }
}

// The projection from a grid_mapping variable: an EPSG code in one of the attributes tools
// use, else a definition that PROJ can identify.
std::string ProjectionOf(const File& f, int crs, std::vector<std::string>& notes) {
    const std::string crsName = f.Name(crs);
    for (const char* att : {"epsg", "EPSG_code", "epsg_code"}) {
        std::string code = f.TextAtt(crs, att);
        double number = 0;
        if (code.empty() && f.NumberAtt(crs, att, number) && number > 0 && number < 1e9)
            code = std::to_string(std::llround(number));
        if (Lower(code).rfind("epsg:", 0) == 0)
            code = code.substr(5);
        if (code.empty())
            continue;
        const long long epsg = std::strtoll(code.c_str(), nullptr, 10);
        const std::string p = epsg > 0 && epsg < INT32_MAX
                                  ? CZoMapProjection::FromEpsg(static_cast<int>(epsg))
                                  : std::string();
        if (p.empty())
            notes.push_back("projection " + crsName + ":" + att + " = \"" + code +
                            "\" is not a known EPSG code; none taken");
        return p;
    }
    for (const char* att : {"crs_wkt", "spatial_ref", "proj4_params", "proj4"}) {
        const std::string def = f.TextAtt(crs, att);
        if (def.empty())
            continue;
        const int epsg = CZoMapProjection::EpsgOfDefinition(def);
        const std::string p = epsg > 0 ? CZoMapProjection::FromEpsg(epsg) : std::string();
        if (p.empty())
            notes.push_back("projection " + crsName + ":" + att +
                            " matches no EPSG code; none taken");
        return p;
    }
    if (f.TextAtt(crs, "grid_mapping_name") == "latitude_longitude")
        return "LONG/LAT";
    return {};
}

std::string Projection(const File& f, const Topology& topo, const std::string& xName,
                       const std::string& yName, std::vector<std::string>& notes) {
    bool geographical = false;
    Axis(f, f.Var(xName), &geographical);
    if (geographical)
        return "LONG/LAT";
    // The coordinates first, then the topology, then every variable of the mesh.
    std::vector<int> vars{f.Var(xName), f.Var(yName), topo.var};
    for (int v = 0; v < f.VarCount(); ++v)
        if (f.TextAtt(v, "mesh") == topo.name)
            vars.push_back(v);
    for (int v : vars) {
        // "crs" or the extended form "crs: x y".
        std::vector<std::string> words = Words(f.TextAtt(v, "grid_mapping"));
        if (words.empty())
            continue;
        std::string name = words[0];
        if (name.size() > 1 && name.back() == ':')
            name.pop_back();
        const int crs = f.Var(name);
        if (crs >= 0)
            return ProjectionOf(f, crs, notes);
    }
    return {};
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
        const Topology topo = FindTopology(f, mesh->notes);
        mesh->topology = topo.name;
        const auto [xName, yName] = NodeCoordinates(f, topo, mesh->notes);
        const int xVar = f.Var(xName), yVar = f.Var(yName);
        const std::vector<size_t> xShape = f.Shape(xVar);
        if (xShape.size() != 1 || xShape[0] == 0)
            throw Fail{"no nodes in " + xName};
        const size_t n = xShape[0];
        if (n > f.MaxCount())
            throw Fail{"more nodes than can be read (" + std::to_string(n) + ")"};
        mesh->x = Coordinates(f, xVar, n, xName);
        mesh->y = Coordinates(f, yVar, n, yName);
        ReadBedLevel(f, topo, f.Dims(xVar)[0], *mesh);
        const std::string facesName = f.TextAtt(topo.var, "face_node_connectivity");
        if (facesName.empty())
            throw Fail{topo.name + ": a 2D topology without faces (no face_node_connectivity)"};
        const int faces = f.Var(facesName);
        if (faces < 0)
            throw Fail{topo.name + ": face_node_connectivity " + facesName + " does not exist"};
        size_t rows = 0;
        const int faceDim = f.Dim(f.TextAtt(topo.var, "face_dimension"));
        const std::vector<int> table = Connectivity(f, faces, n, 0, faceDim, facesName, rows);
        if (rows == 0)
            throw Fail{"no elements in " + facesName};
        mesh->elements.resize(rows);
        for (size_t r = 0; r < rows; ++r)
            std::copy_n(table.begin() + static_cast<long>(r * 4), 4, mesh->elements[r].begin());
        ReadBoundaries(f, topo, *mesh);
        mesh->projection = Projection(f, topo, xName, yName, mesh->notes);
        mesh->Finish();
        return {std::move(mesh), {}};
    } catch (const Fail& e) {
        return {nullptr, path + ": " + e.message};
    } catch (const std::bad_alloc&) {
        return {nullptr, path + ": too large to read"};
    }
}
