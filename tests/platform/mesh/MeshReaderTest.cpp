#include "mesh/MeshReader.h"
#include "UgridTestFile.h"
#include "mesh/MeshIndex.h"

#include <gtest/gtest.h>

#include <cstdio>
#include <filesystem>
#include <fstream>

namespace {

// A square of two triangles and a quadrilateral beside it, with two open boundaries.
const char* const kGood = R"(MESH2D
MESHNAME "test"
E3T 1 1 2 3 1
E3T 2 1 3 4 1
E4Q 3 2 5 6 3 1
ND 1 0.0 0.0 -5.0
ND 2 10.0 0.0 -4.0
ND 3 10.0 10.0 -3.0
ND 4 0.0 10.0 1.5
ND 5 20.0 0.0 -2.0
ND 6 20.0 10.0 -1.0
NS 1 2 -5 7 Sea boundary
NS 4
NS -3
)";

std::string Temp(const std::string& name) {
    return (std::filesystem::temp_directory_path() / ("mudmesh_" + name)).string();
}

TEST(Mesh2dm, ReadsNodesElementsBoundariesAndExtent) {
    const MeshReadResult r = Read2dm(kGood, "good.2dm");
    ASSERT_TRUE(r.mesh) << r.error;
    const CMesh& m = *r.mesh;
    EXPECT_EQ(m.NodeCount(), 6u);
    EXPECT_EQ(m.ElementCount(), 3u);
    EXPECT_EQ(m.TriangleCount(), 2u);
    EXPECT_EQ(m.QuadrilateralCount(), 1u);
    EXPECT_EQ(m.elements[2], (CMesh::Element{1, 4, 5, 2}));
    EXPECT_EQ(m.elements[0][3], -1);
    const MeshExtent& e = m.Extent();
    EXPECT_EQ(e.xMin, 0.0);
    EXPECT_EQ(e.xMax, 20.0);
    EXPECT_EQ(e.yMax, 10.0);
    EXPECT_EQ(e.zMin, -5.0);
    EXPECT_EQ(e.zMax, 1.5);
    ASSERT_EQ(m.boundaries.size(), 2u);
    EXPECT_EQ(m.boundaries[0].name, "Sea boundary");
    EXPECT_EQ(m.boundaries[0].code, 7);
    EXPECT_EQ(m.boundaries[0].nodes, (std::vector<int>{0, 1, 4}));
    // A string over two lines without a code takes its number.
    EXPECT_EQ(m.boundaries[1].name, "Boundary 2");
    EXPECT_EQ(m.boundaries[1].code, 3);
    EXPECT_EQ(m.boundaries[1].nodes, (std::vector<int>{3, 2}));
}

TEST(Mesh2dm, SparseIdsAndCrLf) {
    const MeshReadResult r = Read2dm(
        "MESH2D\r\nND 5 0 0 0\r\nND 2000000000 1 0 0\r\nND 7 0 1 0\r\nE3T 1 5 2000000000 7\r\n",
        "a.2dm");
    ASSERT_TRUE(r.mesh) << r.error;
    EXPECT_EQ(r.mesh->elements[0], (CMesh::Element{0, 1, 2, -1}));
}

TEST(Mesh2dm, BadFilesSayWhereAndWhy) {
    const struct {
        const char* text;
        const char* error;
    } cases[] = {
        {"", "bad.2dm: the file is empty"},
        {"MESH2D\nE3T 1 1 2 3 1\n", "bad.2dm: no nodes (ND)"},
        {"MESH2D\nND 1 0 0 0\nND 2 1 0 0\nND 3 0 1 0\n", "bad.2dm: no elements (E3T, E4Q)"},
        {"MESH2D\nND 1 0 0 0\nND 2 1 0 0\nND 3 0 1 0\nE3T 1 1 2 9 1\n",
         "bad.2dm:5: element names node 9, which does not exist"},
        {"MESH2D\nND 1 0 0 0\nND 2 1 0 0\nND 3 0 1 0\nE3T 1 1 2 2 1\n",
         "bad.2dm:5: element 1 names node 2 twice"},
        {"MESH2D\nND 1 0 0\n", "bad.2dm:2: ND needs an id and x, y, z"},
        {"MESH2D\nND 1 0 zero 0\n", "bad.2dm:2: node 1 has a coordinate that is not a number"},
        {"MESH2D\nND 1 0 nan 0\n", "bad.2dm:2: node 1 has a coordinate that is not a number"},
        {"MESH2D\nND 1 0 0 0\nND 1 1 0 0\n", "bad.2dm:3: node 1 is defined twice"},
        {"MESH2D\nND 1 0 0 0\nND 2 1 0 0\nND 3 0 1 0\nE3T 1 1 2\n",
         "bad.2dm:5: element 1 needs 3 nodes"},
        {"MESH2D\nND 1 0 0 0\nND 2 1 0 0\nND 3 0 1 0\nE3T 1 1 2 3\nNS -1\n",
         "bad.2dm:6: a node string needs at least two nodes"},
        {"MESH2D\nND 1 0 0 0\nND 2 1 0 0\nND 3 0 1 0\nE3T 1 1 2 3\nNS 1 2\n",
         "bad.2dm:6: node string not ended (its last node id must be negative)"},
        {"MESH2D\nND 1 0 0 0\nND 2 1 0 0\nND 3 0 1 0\nE3T 1 1 2 3\nNS 1 -8\n",
         "bad.2dm:6: node string names node 8, which does not exist"},
        {"MESH2D\nND 1 0 0 0\nND 2 1 0 0\nND 3 0 1 0\nE3T 1 1 2 3\nNS 1 -2 4 A\nNS 2 -3 4 B\n",
         "bad.2dm:7: boundary code 4 is used twice"},
        {"MESH2D\nE6T 1 1 2 3 4 5 6 1\n",
         "bad.2dm:2: element type E6T is not supported (E3T and E4Q only)"},
    };
    for (const auto& c : cases) {
        const MeshReadResult r = Read2dm(c.text, "bad.2dm");
        EXPECT_FALSE(r.mesh) << c.text;
        EXPECT_EQ(r.error, c.error) << c.text;
    }
}

TEST(MeshFile, MissingFileAndFileThatIsNotNetcdf) {
    EXPECT_EQ(ReadMeshFile(Temp("none.2dm")).error, Temp("none.2dm") + ": does not exist");
    const std::string path = Temp("text.nc");
    std::ofstream(path) << kGood;
    const MeshReadResult r = ReadMeshFile(path);
    EXPECT_FALSE(r.mesh);
    EXPECT_EQ(r.error, path + ": is not a valid netCDF file: it is neither a classic netCDF file "
                        "nor a netCDF-4 (HDF5) file");
    std::remove(path.c_str());
}

testsupport::UgridSpec Square() {
    testsupport::UgridSpec s;
    // Nodes 0..5 as in kGood; a triangle pair and a quadrilateral, one-based.
    s.x = {0, 10, 10, 0, 20, 20};
    s.y = {0, 0, 10, 10, 0, 10};
    s.depth = {5, 4, 3, -1.5, 2, 1};
    s.maxNodes = 4;
    s.startIndex = 1;
    s.faces = {1, 2, 3, -1, 1, 3, 4, -1, 2, 5, 6, 3};
    // Land, the sea along the bottom in two edges given out of order, the river at the right.
    s.edges = {4, 1, 2, 5, 1, 2, 5, 6};
    s.edgeCodes = {1, 2, 2, 3};
    s.flagValues = {2, 3};
    s.flagMeanings = "Sea_boundary River";
    s.epsg = 32632;
    return s;
}

TEST(MeshUgrid, ReadsFacesBedLevelsBoundariesAndProjection) {
    const std::string path = Temp("good.nc");
    ASSERT_TRUE(testsupport::WriteUgrid(path, Square()));
    const MeshReadResult r = ReadMeshFile(path);
    ASSERT_TRUE(r.mesh) << r.error;
    const CMesh& m = *r.mesh;
    EXPECT_EQ(m.NodeCount(), 6u);
    EXPECT_EQ(m.TriangleCount(), 2u);
    EXPECT_EQ(m.elements[2], (CMesh::Element{1, 4, 5, 2}));
    EXPECT_EQ(m.Extent().zMin, -5.0);
    EXPECT_EQ(m.Extent().zMax, 1.5);
    EXPECT_EQ(m.projection, "UTM-32");
    ASSERT_EQ(m.boundaries.size(), 2u);
    EXPECT_EQ(m.boundaries[0].name, "Sea boundary");
    EXPECT_EQ(m.boundaries[0].code, 2);
    EXPECT_EQ(m.boundaries[0].nodes, (std::vector<int>{0, 1, 4}));
    EXPECT_EQ(m.boundaries[1].name, "River");
    EXPECT_EQ(m.boundaries[1].nodes, (std::vector<int>{4, 5}));
    std::remove(path.c_str());
}

TEST(MeshUgrid, BadFilesGiveTheReason) {
    struct Case {
        const char* name;
        void (*change)(testsupport::UgridSpec&);
        const char* error;
    };
    const Case cases[] = {
        {"no topology", [](testsupport::UgridSpec& s) { s.topology = false; },
         "no variable with cf_role = \"mesh_topology\""},
        {"node out of range", [](testsupport::UgridSpec& s) { s.faces[2] = 9; },
         "Mesh2_face_nodes row 1 names node 9, which does not exist"},
        {"two-node face", [](testsupport::UgridSpec& s) { s.faces[1] = -1; },
         "Mesh2_face_nodes row 1 has fewer than 3 nodes"},
        {"branching boundary",
         [](testsupport::UgridSpec& s) {
             s.edges = {1, 2, 2, 5, 2, 3, 5, 6};
             s.edgeCodes = {2, 2, 2, 3};
         },
         "boundary code 2 branches at a node"},
        {"broken boundary",
         [](testsupport::UgridSpec& s) {
             s.edgeCodes = {2, 3, 3, 2};
         },
         "is not one connected line"},
    };
    const std::string path = Temp("bad.nc");
    for (const Case& c : cases) {
        testsupport::UgridSpec s = Square();
        c.change(s);
        ASSERT_TRUE(testsupport::WriteUgrid(path, s)) << c.name;
        const MeshReadResult r = ReadMeshFile(path);
        EXPECT_FALSE(r.mesh) << c.name;
        EXPECT_NE(r.error.find(c.error), std::string::npos) << c.name << ": " << r.error;
        EXPECT_EQ(r.error.rfind(path + ": ", 0), 0u) << r.error;
    }
    std::remove(path.c_str());
}

TEST(MeshUgrid, ADimensionFarBeyondTheFileIsRefusedNotAllocated) {
    // netCDF-4 stores nothing for values never written: a small file can claim 2^31 nodes.
    const std::string path = Temp("huge.nc");
    int nc = 0, dim = 0, topo = 0, x = 0, y = 0;
    ASSERT_EQ(nc_create(path.c_str(), NC_CLOBBER | NC_NETCDF4, &nc), NC_NOERR);
    nc_def_dim(nc, "nodes", size_t(1) << 31, &dim);
    nc_def_var(nc, "Mesh2", NC_INT, 0, nullptr, &topo);
    nc_put_att_text(nc, topo, "cf_role", 13, "mesh_topology");
    nc_put_att_text(nc, topo, "node_coordinates", 5, "nx ny");
    nc_def_var(nc, "nx", NC_DOUBLE, 1, &dim, &x);
    nc_def_var(nc, "ny", NC_DOUBLE, 1, &dim, &y);
    ASSERT_EQ(nc_close(nc), NC_NOERR);
    const MeshReadResult r = ReadMeshFile(path);
    EXPECT_FALSE(r.mesh);
    EXPECT_EQ(r.error, path + ": more nodes than can be read (2147483648)");
    std::remove(path.c_str());
}

TEST(MeshIndex, FindsTheElementUnderAPointAndOnlyNearbyElements) {
    const MeshReadResult r = Read2dm(kGood, "good.2dm");
    ASSERT_TRUE(r.mesh);
    const CMeshIndex index(*r.mesh);
    EXPECT_EQ(index.ElementAt(8, 2), 0);
    EXPECT_EQ(index.ElementAt(2, 8), 1);
    EXPECT_EQ(index.ElementAt(15, 5), 2);
    EXPECT_EQ(index.ElementAt(10, 5), 0); // on an edge
    EXPECT_EQ(index.ElementAt(25, 5), -1);
    std::vector<int> seen;
    index.ForEach(-100, -100, 100, 100, [&](int e) { seen.push_back(e); });
    std::sort(seen.begin(), seen.end());
    EXPECT_EQ(seen, (std::vector<int>{0, 1, 2}));
}

} // namespace
