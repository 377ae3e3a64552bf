// mudsetup mesh info over the example mesh, a UGRID file and files that cannot be read.
#include "platform/mesh/UgridTestFile.h"

#include <gtest/gtest.h>

#include <sys/wait.h>

#include <filesystem>
#include <fstream>
#include <sstream>

namespace fs = std::filesystem;

namespace {

struct Result {
    int exitCode;
    std::string out, err;
};

std::string Read(const fs::path& p) {
    std::stringstream s;
    s << std::ifstream(p).rdbuf();
    return s.str();
}

Result Mudsetup(const std::string& args) {
    const fs::path dir = fs::temp_directory_path();
    const fs::path out = dir / "mudsetup-mesh-out.txt", err = dir / "mudsetup-mesh-err.txt";
    const std::string cmd = std::string(MUDSETUP_EXE) + " " + args + " >" + out.string() + " 2>" +
                            err.string() + " </dev/null";
    const int status = std::system(cmd.c_str());
    return {WIFEXITED(status) ? WEXITSTATUS(status) : -1, Read(out), Read(err)};
}

TEST(MeshCli, InfoOfTheExampleMesh) {
    const std::string file = MUD_SOURCE_DIR "/examples/estuary.2dm";
    const Result r = Mudsetup("mesh info " + file);
    EXPECT_EQ(r.exitCode, 0) << r.err;
    EXPECT_EQ(r.err, "");
    EXPECT_NE(r.out.find("nodes: 2202\nelements: 3496 (2920 triangles, 576 quadrilaterals)\n"),
              std::string::npos)
        << r.out;
    EXPECT_NE(
        r.out.find("open boundaries: 3\n  1: \"Sea boundary\", code 2, 17 nodes\n"
                   "  2: \"River Elbe\", code 3, 17 nodes\n  3: \"River Oste\", code 4, 5 nodes\n"),
        std::string::npos)
        << r.out;
}

TEST(MeshCli, InfoOfAUgridFile) {
    const std::string path = (fs::temp_directory_path() / "mudsetup-mesh.nc").string();
    testsupport::UgridSpec s;
    s.x = {0, 10, 10, 0};
    s.y = {0, 0, 10, 10};
    s.faces = {0, 1, 2, 0, 2, 3};
    s.epsg = 4326;
    ASSERT_TRUE(testsupport::WriteUgrid(path, s));
    const Result r = Mudsetup("mesh info " + path);
    EXPECT_EQ(r.exitCode, 0) << r.err;
    EXPECT_NE(r.out.find("elements: 2 (2 triangles, 0 quadrilaterals)\nx: 0 to 10\n"),
              std::string::npos)
        << r.out;
    // No bed level in the file: said so, not a flat bed at 0 m.
    EXPECT_NE(r.out.find("topology: Mesh2\n"), std::string::npos) << r.out;
    EXPECT_NE(r.out.find("y: 0 to 10\nbed level: none found\nprojection: LONG/LAT\n"
                         "open boundaries: 0\nnotes:\n  bed level: none found"),
              std::string::npos)
        << r.out;
    fs::remove(path);
}

TEST(MeshCli, InfoSaysWhereTheBedLevelIsMissingAndWhatWasPassedOver) {
    const std::string nc = (fs::temp_directory_path() / "mudsetup-fill.nc").string();
    testsupport::UgridSpec s;
    s.x = {0, 10, 10, 0};
    s.y = {0, 0, 10, 10};
    s.faces = {0, 1, 2, 0, 2, 3};
    s.depth = {2, 3, NC_FILL_DOUBLE, 4};
    Result r;
    ASSERT_TRUE(testsupport::WriteUgrid(nc, s));
    r = Mudsetup("mesh info " + nc);
    EXPECT_EQ(r.exitCode, 0) << r.err;
    EXPECT_NE(r.out.find("z: -4 to -2\nbed level: missing on 1 of 4 nodes\n"), std::string::npos)
        << r.out;
    EXPECT_NE(r.out.find("notes:\n  bed level missing on 1 of 4 nodes (fill values in "
                         "Mesh2_depth)\n"),
              std::string::npos)
        << r.out;
    fs::remove(nc);

    const fs::path text = fs::temp_directory_path() / "mudsetup-lines.2dm";
    std::ofstream(text) << "MESH2D\nND 1 0 0 0\nND 2 1 0 0\nND 3 0 1 0\nE3T 1 1 2 3 1\n"
                           "E2L 2 1 2 1\nMAT 1 \"mud\"\n";
    r = Mudsetup("mesh info " + text.string());
    EXPECT_EQ(r.exitCode, 0) << r.err;
    EXPECT_NE(r.out.find("notes:\n  1 line element (E2L, E3L) passed over\n"
                         "  cards of other tools passed over: MAT\n"),
              std::string::npos)
        << r.out;
    fs::remove(text);
}

TEST(MeshCli, AFileThatCannotBeReadExitsTwoWithThePlace) {
    const fs::path bad = fs::temp_directory_path() / "mudsetup-bad.2dm";
    std::ofstream(bad) << "MESH2D\nND 1 0 0 0\nND 2 1 0 0\nE3T 1 1 2 3 1\n";
    Result r = Mudsetup("mesh info " + bad.string());
    EXPECT_EQ(r.exitCode, 2);
    EXPECT_EQ(r.out, "");
    EXPECT_EQ(r.err, bad.string() + ":4: element names node 3, which does not exist\n");
    fs::remove(bad);
    r = Mudsetup("mesh info");
    EXPECT_EQ(r.exitCode, 2);
    EXPECT_NE(r.err.find("usage: mudsetup mesh info FILE"), std::string::npos);
    r = Mudsetup("mesh info --help");
    EXPECT_EQ(r.exitCode, 0);
    EXPECT_NE(r.out.find("usage: mudsetup mesh info FILE"), std::string::npos);
}

} // namespace
