#include "mesh/MeshReader.h"
#include "UgridTestFile.h"
#include "mesh/MeshIndex.h"
#include "mesh/MeshRaster.h"

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

// One small file per kind that other tools write: what is read and what the notes say.
TEST(Mesh2dm, FilesOfOtherTools) {
    struct Boundary {
        std::string name;
        int code;
        std::vector<int> nodes;
    };
    const struct Case {
        const char* name;
        std::string text;
        size_t nodes, triangles, quads;
        std::vector<Boundary> boundaries;
        std::vector<std::string> notes; // each note begins so
        CMesh::Element first;
    } cases[] = {
        {"node strings named by a word, bare or quoted",
         "MESH2D\nND 1 0 0 -1\nND 2 1 0 -1\nND 3 1 1 -1\nND 4 0 1 -1\nND 5 2 0 -1\n"
         "E4Q 1 1 2 3 4 1\nNS 1 2 -5 inflow_boundary\nNS 3 4 -1 \"one two\"\nNS 5 -3 7 Sea\n"
         "NS 2 -3\n",
         5,
         0,
         1,
         {{"inflow_boundary", 2, {0, 1, 4}},
          {"one two", 3, {2, 3, 0}},
          {"Sea", 7, {4, 2}},
          {"Boundary 4", 5, {1, 2}}},
         {},
         {0, 1, 2, 3}},
        {"ids from 0 with gaps, out of order, elements first",
         "E3T 0 0 7 3\nE3T 9 3 7 12 1\nND 12 1 1 0\nND 0 0 0 0\nND 7 1 0 0\nND 3 0 1 0\n"
         "NS 12 -0\n",
         4,
         2,
         0,
         {{"Boundary 1", 2, {0, 1}}},
         {},
         {1, 2, 3, -1}},
        {"line elements beside faces",
         "MESH2D\nND 1 0 0 0\nND 2 1 0 0\nND 3 0 1 0\nE2L 1 1 2 1\nE3T 2 1 2 3 1\n"
         "E3L 3 1 2 3 1\n",
         3,
         1,
         0,
         {},
         {"2 line elements (E2L, E3L) passed over"},
         {0, 1, 2, -1}},
        {"quadratic elements by their corners",
         // A 6-node triangle and a 9-node quadrilateral sharing the edge 3-4-5; node 20 is in
         // no element and stays.
         "MESH2D\nND 1 0 0 0\nND 2 1 0 0\nND 3 2 0 -1\nND 4 1 1 0\nND 5 0 2 0\nND 6 0 1 0\n"
         "ND 7 4 0 0\nND 8 4 2 0\nND 9 3 0 0\nND 10 4 1 0\nND 11 2 2 0\nND 12 3 1 0\n"
         "ND 20 9 9 -3\nE6T 1 1 2 3 4 5 6 1\nE9Q 2 3 9 7 10 8 11 5 4 12 1\nNS 1 2 3 9 -7\n",
         6,
         1,
         1,
         {{"Boundary 1", 2, {0, 1, 3}}},
         {"2 quadratic elements (E6T, E8Q, E9Q) read by their corner nodes; the mid-side nodes "
          "are not used (7 nodes left out)"},
         {0, 1, 2, -1}},
        {"cards of other tools, CRLF and a Latin-1 name",
         "MESH2D 4 2\r\nMESHNAME \"a\"\r\nNUM_MATERIALS_PER_ELEM 2\r\nBEGPARAMDEF\r\nGM \"x\"\r\n"
         "ND 9 9 9 9\r\nENDPARAMDEF\r\nND 1 0 0 -2 0 0\r\nND 2 1 0 -1\r\nND 3 0 1 -3\r\n"
         "E3T 1 1 2 3 1 4 5\r\nNS 1 -2 2 R\xe9gion\r\nBEGCURVE 1\r\n0 1\r\nENDCURVE\r\n"
         "MAT 1 \"mud\"\r\nBEG2DMBC\r\nBC_DEF 1\r\nGP_DEF 1\r\nMAT_DEF 1\r\nEND2DMBC\r\n",
         4,
         1,
         0,
         {{"R\xe9gion", 2, {1, 2}}},
         {"line 12: the boundary name is not valid UTF-8; kept byte for byte",
          "cards of other tools passed over: BEG2DMBC, BEGCURVE, BEGPARAMDEF, MAT"},
         {1, 2, 3, -1}},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.name);
        const MeshReadResult r = Read2dm(c.text, "other.2dm");
        ASSERT_TRUE(r.mesh) << r.error;
        const CMesh& m = *r.mesh;
        EXPECT_EQ(m.NodeCount(), c.nodes);
        EXPECT_EQ(m.TriangleCount(), c.triangles);
        EXPECT_EQ(m.QuadrilateralCount(), c.quads);
        EXPECT_EQ(m.elements[0], c.first);
        ASSERT_EQ(m.boundaries.size(), c.boundaries.size());
        for (size_t i = 0; i < c.boundaries.size(); ++i) {
            EXPECT_EQ(m.boundaries[i].name, c.boundaries[i].name);
            EXPECT_EQ(m.boundaries[i].code, c.boundaries[i].code);
            EXPECT_EQ(m.boundaries[i].nodes, c.boundaries[i].nodes);
        }
        EXPECT_EQ(m.notes, c.notes);
        EXPECT_TRUE(m.HasBedLevel());
    }
    // The quadratic mesh keeps the bed levels of the corners and of the free node only.
    const MeshReadResult q = Read2dm(cases[3].text, "q.2dm");
    EXPECT_EQ(q.mesh->Extent().zMin, -3.0);
    EXPECT_EQ(q.mesh->x, (std::vector<double>{0, 2, 0, 4, 4, 9}));
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
        {"MESH2D\nND 1 0 0 0\nND 2 1 0 0\nE2L 1 1 2 1\n",
         "bad.2dm: no triangles or quadrilaterals (E3T, E4Q), only 1 line element"},
        {"MESH2D\nND 1 0 0 0\nND 2 1 0 0\nND 3 0 1 0\nE6T 1 1 8 2 9 3 10 1\n",
         "bad.2dm:5: element names node 8, which does not exist"},
        {"MESH2D\nND 1 0 0 0\nND 2 1 0 0\nND 3 0 1 0\nE6T 1 1 2 3\n",
         "bad.2dm:5: element 1 needs 6 nodes"},
        {"MESH2D\nND -1 0 0 0\n", "bad.2dm:2: node id -1 is not a whole number from 0"},
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

const char* const kUtm32Wkt =
    "PROJCS[\"WGS 84 / UTM zone 32N\",GEOGCS[\"WGS 84\",DATUM[\"WGS_1984\",SPHEROID[\"WGS 84\","
    "6378137,298.257223563]],PRIMEM[\"Greenwich\",0],UNIT[\"degree\",0.0174532925199433]],"
    "PROJECTION[\"Transverse_Mercator\"],PARAMETER[\"latitude_of_origin\",0],"
    "PARAMETER[\"central_meridian\",9],PARAMETER[\"scale_factor\",0.9996],"
    "PARAMETER[\"false_easting\",500000],PARAMETER[\"false_northing\",0],UNIT[\"metre\",1],"
    "AXIS[\"Easting\",EAST],AXIS[\"Northing\",NORTH]]";

// One small file per kind that other tools write, each a change of the square: the same
// mesh must come out, with the bed level, projection and notes that the file states.
TEST(MeshUgrid, FilesOfOtherTools) {
    using testsupport::UgridSpec;
    const std::string yFirst =
        "node_coordinates lists y first: x is Mesh2_node_x, y is Mesh2_node_y";
    const std::string oneMissing = "bed level missing on 1 of 6 nodes (fill values in Mesh2_depth)";
    struct Case {
        const char* name;
        void (*change)(UgridSpec&);
        double zMin = -5, zMax = 1.5;
        size_t missing = 0;
        std::string projection = "UTM-32";
        std::vector<std::string> notes = {};
    };
    const Case cases[] = {
        {"classic", [](UgridSpec&) {}},
        {"64-bit offset", [](UgridSpec& s) { s.format = NC_64BIT_OFFSET; }},
        {"netCDF-4, int64 table",
         [](UgridSpec& s) { s.format = NC_NETCDF4, s.faceType = NC_INT64; }},
        {"netCDF-4, uint32 table",
         [](UgridSpec& s) { s.format = NC_NETCDF4, s.faceType = NC_UINT; }},
        {"double table with NaN as fill", [](UgridSpec& s) { s.faceType = NC_DOUBLE; }},
        {"start_index as a float", [](UgridSpec& s) { s.startIndexAsFloat = true; }},
        {"no declared fill, -1 for none", [](UgridSpec& s) { s.faceFillAttribute = false; }},
        {"faces the second dimension, said by face_dimension",
         [](UgridSpec& s) { s.transposed = s.faceDimensionAttribute = true; }},
        {"older layout, nodes first", [](UgridSpec& s) { s.transposed = true; }},
        {"latitude listed first",
         [](UgridSpec& s) {
             s.yFirst = true, s.epsg = 0;
             s.xStandardName = "longitude", s.yStandardName = "latitude";
         },
         -5,
         1.5,
         0,
         "LONG/LAT",
         {yFirst}},
        {"units tell x from y",
         [](UgridSpec& s) {
             s.yFirst = true, s.epsg = 0;
             s.xUnits = "degrees_east", s.yUnits = "degree_N";
         },
         -5,
         1.5,
         0,
         "LONG/LAT",
         {yFirst}},
        {"projected, y first",
         [](UgridSpec& s) {
             s.yFirst = true;
             s.xStandardName = "projection_x_coordinate",
             s.yStandardName = "projection_y_coordinate";
         },
         -5,
         1.5,
         0,
         "UTM-32",
         {yFirst}},
        {"bed level _FillValue",
         [](UgridSpec& s) { s.depth[3] = -999, s.depthFill = true; },
         -5,
         -1,
         1,
         "UTM-32",
         {oneMissing}},
        {"bed level missing_value",
         [](UgridSpec& s) { s.depth[3] = -999, s.depthMissing = true; },
         -5,
         -1,
         1,
         "UTM-32",
         {oneMissing}},
        {"bed level the float default fill",
         [](UgridSpec& s) { s.depth[3] = NC_FILL_FLOAT, s.depthType = NC_FLOAT; },
         -5,
         -1,
         1,
         "UTM-32",
         {oneMissing}},
        {"bed level by name, a level",
         [](UgridSpec& s) {
             s.depthName = "mesh2d_node_z", s.depthStandardName = "", s.depthOfMesh = false;
         },
         -1.5, 5},
        {"bed level by name, a depth",
         [](UgridSpec& s) { s.depthName = "bathymetry", s.depthStandardName = ""; }},
        {"a depth said positive up",
         [](UgridSpec& s) {
             s.depthStandardName = "sea_floor_depth_below_sea_surface", s.positive = "up";
         },
         -1.5, 5},
        {"no bed level",
         [](UgridSpec& s) { s.depth.clear(); },
         0,
         0,
         6,
         "UTM-32",
         {"bed level: none found (no node variable of the mesh is a bed level or a depth)"}},
        {"grid_mapping on a data variable, EPSG_code",
         [](UgridSpec& s) {
             s.epsg = 28992, s.crsAttribute = "EPSG_code", s.gridMappingOn = "depth";
         },
         -5, 1.5, 0, "EPSG:28992"},
        {"integer epsg", [](UgridSpec& s) { s.crsAttribute = "epsg"; }},
        {"crs_wkt without a code",
         [](UgridSpec& s) { s.crsAttribute = "crs_wkt", s.crsText = kUtm32Wkt; }},
        {"an unknown EPSG code",
         [](UgridSpec& s) { s.epsg = 999999; },
         -5,
         1.5,
         0,
         "",
         {"projection crs:epsg_code = \"999999\" is not a known EPSG code; none taken"}},
        {"a 1D topology beside the 2D one",
         [](UgridSpec& s) { s.network1d = true; },
         -5,
         1.5,
         0,
         "UTM-32",
         {"2D topology Mesh2 taken; passed over: network (1D)"}},
    };
    const std::string path = Temp("other.nc");
    for (const Case& c : cases) {
        SCOPED_TRACE(c.name);
        UgridSpec s = Square();
        c.change(s);
        ASSERT_TRUE(testsupport::WriteUgrid(path, s));
        const MeshReadResult r = ReadMeshFile(path);
        ASSERT_TRUE(r.mesh) << r.error;
        const CMesh& m = *r.mesh;
        EXPECT_EQ(m.topology, "Mesh2");
        EXPECT_EQ(m.NodeCount(), 6u);
        EXPECT_EQ(m.TriangleCount(), 2u);
        EXPECT_EQ(m.elements[2], (CMesh::Element{1, 4, 5, 2}));
        EXPECT_EQ(m.Extent().xMax, 20.0);
        EXPECT_EQ(m.Extent().yMax, 10.0);
        EXPECT_EQ(m.Extent().zMin, c.zMin);
        EXPECT_EQ(m.Extent().zMax, c.zMax);
        EXPECT_EQ(m.MissingBedLevelCount(), c.missing);
        EXPECT_EQ(m.HasBedLevel(), c.missing < 6);
        if (c.missing == 1) {
            EXPECT_TRUE(m.BedLevelMissing(3));
            EXPECT_FALSE(m.BedLevelMissing(2));
        }
        EXPECT_EQ(m.projection, c.projection);
        EXPECT_EQ(m.notes, c.notes);
        EXPECT_EQ(m.boundaries.size(), 2u);
    }
    std::remove(path.c_str());
}

TEST(MeshUgrid, MissingBedLevelsAreNoDataOnTheMap) {
    testsupport::UgridSpec s = Square();
    s.depth[3] = -999, s.depthFill = true; // the left triangle's top corner
    const std::string path = Temp("nodata.nc");
    ASSERT_TRUE(testsupport::WriteUgrid(path, s));
    const MeshReadResult r = ReadMeshFile(path);
    ASSERT_TRUE(r.mesh) << r.error;
    const std::vector<uint32_t> colours = ElementColours(*r.mesh);
    EXPECT_NE(colours[0], kNoBedLevelColour);
    EXPECT_EQ(colours[1], kNoBedLevelColour);
    EXPECT_NE(colours[2], kNoBedLevelColour);
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
        {"only a 1D topology",
         [](testsupport::UgridSpec& s) { s.topology = false, s.network1d = true; },
         "no 2D mesh topology (only network (1D))"},
        {"a 2D topology without faces", [](testsupport::UgridSpec& s) { s.hasFaces = false; },
         "Mesh2: a 2D topology without faces (no face_node_connectivity)"},
        {"six-node faces",
         [](testsupport::UgridSpec& s) {
             s.maxNodes = 6;
             s.faces = {1, 2, 5, 6, 3, 4, 1, 2, 3, -1, -1, -1};
         },
         "Mesh2_face_nodes: faces of up to 6 nodes: the flow model takes triangles and "
         "quadrilaterals (face 1)"},
        {"node out of range", [](testsupport::UgridSpec& s) { s.faces[2] = 9; },
         "Mesh2_face_nodes: face 1 names node 9, which does not exist (nodes 1 to 6)"},
        {"node below start_index", [](testsupport::UgridSpec& s) { s.faces[4] = 0; },
         "Mesh2_face_nodes: face 2 names node 0, which does not exist (nodes 1 to 6)"},
        {"two-node face", [](testsupport::UgridSpec& s) { s.faces[1] = -1; },
         "Mesh2_face_nodes: face 1 has fewer than 3 nodes"},
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
