// Writes small UGRID netCDF files for the tests through the netCDF C library.
#pragma once

#include <netcdf.h>

#include <string>
#include <vector>

namespace testsupport {

struct UgridSpec {
    std::vector<double> x, y, depth;       // depth positive down; empty for none
    std::vector<int> faces;                // maxNodes per face, fill -1
    int maxNodes = 3;
    int startIndex = 0;
    std::vector<int> edges;                // two per boundary edge
    std::vector<int> edgeCodes;            // one per edge; empty for none
    std::string flagMeanings;              // for codes 2, 3, ...
    std::vector<int> flagValues;
    int epsg = 0;
    bool topology = true;
};

inline bool WriteUgrid(const std::string& path, const UgridSpec& s) {
    int nc = 0;
    if (nc_create(path.c_str(), NC_CLOBBER, &nc) != NC_NOERR)
        return false;
    int dn, df, dm, de = -1, d2 = -1;
    nc_def_dim(nc, "nMesh2_node", s.x.size(), &dn);
    nc_def_dim(nc, "nMesh2_face", s.faces.size() / static_cast<size_t>(s.maxNodes), &df);
    nc_def_dim(nc, "nMaxMesh2_face_nodes", static_cast<size_t>(s.maxNodes), &dm);
    if (!s.edges.empty()) {
        nc_def_dim(nc, "nMesh2_boundary", s.edges.size() / 2, &de);
        nc_def_dim(nc, "Two", 2, &d2);
    }
    auto text = [nc](int var, const char* name, const std::string& v) {
        nc_put_att_text(nc, var, name, v.size(), v.c_str());
    };
    int topo, vx, vy, vf, vz = -1, vb = -1, vc = -1, crs = -1;
    nc_def_var(nc, "Mesh2", NC_INT, 0, nullptr, &topo);
    if (s.topology)
        text(topo, "cf_role", "mesh_topology");
    const int one = 2;
    nc_put_att_int(nc, topo, "topology_dimension", NC_INT, 1, &one);
    text(topo, "node_coordinates", "Mesh2_node_x Mesh2_node_y");
    text(topo, "face_node_connectivity", "Mesh2_face_nodes");
    if (!s.edges.empty())
        text(topo, "boundary_node_connectivity", "Mesh2_boundary_nodes");
    nc_def_var(nc, "Mesh2_node_x", NC_DOUBLE, 1, &dn, &vx);
    nc_def_var(nc, "Mesh2_node_y", NC_DOUBLE, 1, &dn, &vy);
    if (s.epsg) {
        nc_def_var(nc, "crs", NC_INT, 0, nullptr, &crs);
        text(crs, "epsg_code", "EPSG:" + std::to_string(s.epsg));
        text(vx, "grid_mapping", "crs");
    }
    const int faceDims[2] = {df, dm};
    nc_def_var(nc, "Mesh2_face_nodes", NC_INT, 2, faceDims, &vf);
    const int fill = -1;
    nc_put_att_int(nc, vf, "_FillValue", NC_INT, 1, &fill);
    nc_put_att_int(nc, vf, "start_index", NC_INT, 1, &s.startIndex);
    if (!s.depth.empty()) {
        nc_def_var(nc, "Mesh2_depth", NC_DOUBLE, 1, &dn, &vz);
        text(vz, "mesh", "Mesh2");
        text(vz, "location", "node");
        text(vz, "standard_name", "sea_floor_depth_below_geoid");
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
                nc_put_att_int(nc, vc, "flag_values", NC_INT, s.flagValues.size(), s.flagValues.data());
                text(vc, "flag_meanings", s.flagMeanings);
            }
        }
    }
    nc_enddef(nc);
    nc_put_var_double(nc, vx, s.x.data());
    nc_put_var_double(nc, vy, s.y.data());
    nc_put_var_int(nc, vf, s.faces.data());
    if (vz >= 0)
        nc_put_var_double(nc, vz, s.depth.data());
    if (vb >= 0)
        nc_put_var_int(nc, vb, s.edges.data());
    if (vc >= 0)
        nc_put_var_int(nc, vc, s.edgeCodes.data());
    return nc_close(nc) == NC_NOERR;
}

}  // namespace testsupport
