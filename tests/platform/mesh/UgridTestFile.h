// Writes small UGRID netCDF files for the tests through the netCDF C library, in the
// layouts, types and file formats that other tools write.
#pragma once

#include <netcdf.h>

#include <cmath>

#include <string>
#include <vector>

namespace testsupport {

struct UgridSpec {
    std::vector<double> x, y, depth; // depth positive down; empty for none
    std::vector<int> faces;          // maxNodes per face, fill -1
    int maxNodes = 3;
    int startIndex = 0;
    std::vector<int> edges;     // two per boundary edge
    std::vector<int> edgeCodes; // one per edge; empty for none
    std::string flagMeanings;   // for codes 2, 3, ...
    std::vector<int> flagValues;
    int epsg = 0;
    bool topology = true;

    int format = 0; // 0 classic, NC_64BIT_OFFSET or NC_NETCDF4
    // The face table: its type (NC_INT, NC_INT64, NC_UINT, NC_DOUBLE with NaN as fill), the
    // older (nodes, faces) layout, and whether face_dimension says so.
    nc_type faceType = NC_INT;
    bool transposed = false;
    bool faceDimensionAttribute = false;
    bool startIndexAsFloat = false;
    bool faceFillAttribute = true;
    bool hasFaces = true;   // the topology names a face table
    bool network1d = false; // a 1D topology written first
    // Coordinates: which node_coordinates lists first, and what they say they are.
    bool yFirst = false;
    std::string xStandardName, yStandardName, xUnits, yUnits;
    // The bed level variable.
    std::string depthName = "Mesh2_depth";
    std::string depthStandardName = "sea_floor_depth_below_geoid";
    std::string positive;
    bool depthOfMesh = true; // mesh and location attributes
    bool depthFill = false;  // _FillValue = depthFillValue
    double depthFillValue = -999;
    bool depthMissing = false; // missing_value = depthFillValue
    nc_type depthType = NC_DOUBLE;
    // The projection: the attribute of the crs variable that states it, and which variable
    // names the crs in its grid_mapping ("x", "depth").
    std::string crsAttribute = "epsg_code";
    std::string crsText; // for crs_wkt and the like
    std::string gridMappingOn = "x";
};

inline bool WriteUgrid(const std::string& path, const UgridSpec& s) {
    int nc = 0;
    if (nc_create(path.c_str(), NC_CLOBBER | s.format, &nc) != NC_NOERR)
        return false;
    auto text = [nc](int var, const char* name, const std::string& v) {
        nc_put_att_text(nc, var, name, v.size(), v.c_str());
    };
    int dn, df, dm, de = -1, d2 = -1;
    if (s.network1d) {
        int dnet, net;
        nc_def_dim(nc, "nNetwork_node", 2, &dnet);
        nc_def_var(nc, "network", NC_INT, 0, nullptr, &net);
        text(net, "cf_role", "mesh_topology");
        const int one = 1;
        nc_put_att_int(nc, net, "topology_dimension", NC_INT, 1, &one);
        text(net, "node_coordinates", "network_x network_y");
    }
    const size_t faceCount = s.faces.size() / static_cast<size_t>(s.maxNodes);
    nc_def_dim(nc, "nMesh2_node", s.x.size(), &dn);
    nc_def_dim(nc, "nMesh2_face", faceCount, &df);
    nc_def_dim(nc, "nMaxMesh2_face_nodes", static_cast<size_t>(s.maxNodes), &dm);
    if (!s.edges.empty()) {
        nc_def_dim(nc, "nMesh2_boundary", s.edges.size() / 2, &de);
        nc_def_dim(nc, "Two", 2, &d2);
    }
    int topo, vx, vy, vf, vz = -1, vb = -1, vc = -1, crs = -1;
    nc_def_var(nc, "Mesh2", NC_INT, 0, nullptr, &topo);
    if (s.topology)
        text(topo, "cf_role", "mesh_topology");
    const int two = 2;
    nc_put_att_int(nc, topo, "topology_dimension", NC_INT, 1, &two);
    text(topo, "node_coordinates",
         s.yFirst ? "Mesh2_node_y Mesh2_node_x" : "Mesh2_node_x Mesh2_node_y");
    if (s.hasFaces)
        text(topo, "face_node_connectivity", "Mesh2_face_nodes");
    if (s.faceDimensionAttribute)
        text(topo, "face_dimension", "nMesh2_face");
    if (!s.edges.empty())
        text(topo, "boundary_node_connectivity", "Mesh2_boundary_nodes");
    nc_def_var(nc, "Mesh2_node_x", NC_DOUBLE, 1, &dn, &vx);
    nc_def_var(nc, "Mesh2_node_y", NC_DOUBLE, 1, &dn, &vy);
    const std::pair<int, const std::string*> coordAtts[] = {{vx, &s.xStandardName},
                                                            {vy, &s.yStandardName}};
    for (const auto& [var, sn] : coordAtts)
        if (!sn->empty())
            text(var, "standard_name", *sn);
    if (!s.xUnits.empty())
        text(vx, "units", s.xUnits);
    if (!s.yUnits.empty())
        text(vy, "units", s.yUnits);
    const int faceDims[2] = {s.transposed ? dm : df, s.transposed ? df : dm};
    nc_def_var(nc, "Mesh2_face_nodes", s.faceType, 2, faceDims, &vf);
    if (s.faceFillAttribute && s.faceType != NC_DOUBLE) {
        const long long fill = s.faceType == NC_UINT ? 4294967295LL : -1;
        nc_put_att_longlong(nc, vf, "_FillValue", s.faceType, 1, &fill);
    }
    if (s.startIndexAsFloat) {
        const float start = static_cast<float>(s.startIndex);
        nc_put_att_float(nc, vf, "start_index", NC_FLOAT, 1, &start);
    } else {
        nc_put_att_int(nc, vf, "start_index", NC_INT, 1, &s.startIndex);
    }
    if (!s.depth.empty()) {
        nc_def_var(nc, s.depthName.c_str(), s.depthType, 1, &dn, &vz);
        if (s.depthOfMesh) {
            text(vz, "mesh", "Mesh2");
            text(vz, "location", "node");
        }
        if (!s.depthStandardName.empty())
            text(vz, "standard_name", s.depthStandardName);
        if (!s.positive.empty())
            text(vz, "positive", s.positive);
        if (s.depthFill)
            nc_put_att_double(nc, vz, "_FillValue", s.depthType, 1, &s.depthFillValue);
        if (s.depthMissing)
            nc_put_att_double(nc, vz, "missing_value", s.depthType, 1, &s.depthFillValue);
    }
    if (s.epsg || !s.crsText.empty()) {
        nc_def_var(nc, "crs", NC_INT, 0, nullptr, &crs);
        if (!s.crsText.empty())
            text(crs, s.crsAttribute.c_str(), s.crsText);
        else if (s.crsAttribute == "epsg")
            nc_put_att_int(nc, crs, "epsg", NC_INT, 1, &s.epsg);
        else
            text(crs, s.crsAttribute.c_str(), "EPSG:" + std::to_string(s.epsg));
        text(s.gridMappingOn == "depth" ? vz : vx, "grid_mapping", "crs");
    }
    if (!s.edges.empty()) {
        const int edgeDims[2] = {de, d2};
        nc_def_var(nc, "Mesh2_boundary_nodes", NC_INT, 2, edgeDims, &vb);
        nc_put_att_int(nc, vb, "start_index", NC_INT, 1, &s.startIndex);
        if (!s.edgeCodes.empty()) {
            nc_def_var(nc, "Mesh2_boundary_types", NC_INT, 1, &de, &vc);
            text(vc, "mesh", "Mesh2");
            text(vc, "location", "boundary");
            if (!s.flagValues.empty()) {
                nc_put_att_int(nc, vc, "flag_values", NC_INT, s.flagValues.size(),
                               s.flagValues.data());
                text(vc, "flag_meanings", s.flagMeanings);
            }
        }
    }
    nc_enddef(nc);
    nc_put_var_double(nc, vx, s.x.data());
    nc_put_var_double(nc, vy, s.y.data());
    std::vector<double> faces(s.faces.size());
    const size_t m = static_cast<size_t>(s.maxNodes);
    for (size_t f = 0; f < faceCount; ++f)
        for (size_t i = 0; i < m; ++i) {
            const int v = s.faces[f * m + i];
            double& out = faces[s.transposed ? i * faceCount + f : f * m + i];
            out = v >= 0                    ? v
                  : s.faceType == NC_DOUBLE ? NAN
                  : s.faceType == NC_UINT   ? 4294967295.0
                                            : -1;
        }
    nc_put_var_double(nc, vf, faces.data());
    if (vz >= 0)
        nc_put_var_double(nc, vz, s.depth.data());
    if (vb >= 0)
        nc_put_var_int(nc, vb, s.edges.data());
    if (vc >= 0)
        nc_put_var_int(nc, vc, s.edgeCodes.data());
    return nc_close(nc) == NC_NOERR;
}

} // namespace testsupport
