// A setup that agrees with its files: names that follow it into another folder, and
// validation that holds it against the mesh it names.
#include "TestSupport.h"

#include "common/FileNames.h"
#include "fem/DomainKiv.h"
#include "projection/ZoMapProjection.h"

#include <gtest/gtest.h>

#include <cstdio>
#include <filesystem>
#include <fstream>
#include <sstream>

namespace fs = std::filesystem;
using testsupport::Messages;

namespace {

TEST(FileNames, ARebasedNameNamesTheSameFileFromTheNewFolder) {
    const struct {
        const char *name, *from, *to, *expected;
    } cases[] = {
        {"mesh.2dm", "/w/proj", "/w/other", "../proj/mesh.2dm"},
        {"../shared/m.2dm", "/w/proj", "/w/proj/a/b", "../../../shared/m.2dm"},
        {" runs/../data/./a.qrd0 ", "/w/proj", "/w", "proj/data/a.qrd0"},
        // A name written on Windows keeps its separator.
        {"data\\dredger 1.qrd0", "/w/proj", "/w/other", "..\\proj\\data\\dredger 1.qrd0"},
        {"data\\sub/mixed.qrd0", "/w/proj", "/w/other", "../proj/data/sub/mixed.qrd0"},
        // Only the root in common: the absolute name.
        {"..\\..\\x.qrd0", "/home/me/proj", "/tmp/copy", "/home/x.qrd0"},
        // Names no folder changes.
        {"/srv/m.2dm", "/w/proj", "/w/other", "/srv/m.2dm"},
        {"C:\\runs\\wind.qrd0", "/w/proj", "/w/other", "C:\\runs\\wind.qrd0"},
        {"\\\\server\\share\\m.2dm", "/w/proj", "/w/other", "\\\\server\\share\\m.2dm"},
        {"", "/w/proj", "/w/other", ""},
        {"data\\same.qrd0", "/w/proj", "/w/proj/", "data\\same.qrd0"},
    };
    for (const auto& c : cases)
        EXPECT_EQ(RebasedFileName(c.name, c.from, c.to), c.expected) << c.name << " to " << c.to;
}

std::string ReadFile(const fs::path& p) {
    std::stringstream s;
    s << std::ifstream(p, std::ios::binary).rdbuf();
    return s.str();
}

void WriteFile(const fs::path& p, const std::string& text) { std::ofstream(p, std::ios::binary) << text; }

// The example with its mesh and data files in a folder of the test's own.
class ExampleAgainstItsMesh : public ::testing::Test {
protected:
    void SetUp() override {
        m_dir = fs::temp_directory_path() / "mudsetup-mesh-checks";
        fs::remove_all(m_dir);
        fs::create_directories(m_dir);
        fs::copy(MUD_SOURCE_DIR "/examples", m_dir, fs::copy_options::recursive);
        m_mesh = ReadFile(m_dir / "estuary.2dm");
    }
    void TearDown() override { fs::remove_all(m_dir); }

    // The messages of the example with texts replaced (each found once, from the top).
    std::vector<std::string> Validate(const std::vector<std::pair<std::string, std::string>>& edits) {
        std::string text = ReadFile(m_dir / "estuary.setup");
        for (const auto& [from, to] : edits) {
            const size_t at = text.find(from);
            EXPECT_NE(at, std::string::npos) << from;
            if (at != std::string::npos)
                text.replace(at, from.size(), to);
        }
        WriteFile(m_dir / "edited.setup", text);
        CSetupDocument::OpenResult r = CSetupDocument::Open((m_dir / "edited.setup").string());
        EXPECT_TRUE(r.document && r.warnings.empty());
        if (!r.document)
            return {};
        r.document->ValidateAll();
        return Messages(*r.document);
    }

    fs::path m_dir;
    std::string m_mesh;
};

TEST_F(ExampleAgainstItsMesh, MessagesLandOnTheNodesThatDisagree) {
    // The two stations as longitude and latitude.
    const std::string projection = "flood_and_dry = 2\n            coordinate_type = ";
    std::vector<std::pair<std::string, std::string>> geographical = {
        {projection + "\"UTM-32\"", projection + "\"LONG/LAT\""}};
    for (const char* point : {"x = 513000.0\n                y = 5951000.0",
                              "x = 480000.0\n                y = 5974000.0"}) {
        double x = 0, y = 0;
        ASSERT_EQ(std::sscanf(point, "x = %lf y = %lf", &x, &y), 2);
        ASSERT_TRUE(CZoMapProjection("UTM-32", "LONG/LAT").Transform(x, y));
        geographical.push_back({point, FormatString("x = %.17g\n                y = %.17g", x, y)});
    }
    const std::string domain = "DOMAIN: The mesh cannot be read: " + m_dir.string();
    const std::string stations = "MUD_TRANSPORT_MODULE/OUTPUTS/OUTPUT_1: ";
    const struct {
        std::vector<std::pair<std::string, std::string>> edits;
        std::vector<std::string> expected;  // how each message starts
    } cases[] = {
        {{}, {}},
        {{{"'estuary.2dm'", "'gone.2dm'"}}, {domain + "/gone.2dm:"}},
        // A folder (or a device) is never read as a mesh.
        {{{"'estuary.2dm'", "'data'"}}, {domain + "/data: is a folder"}},
        {{{"name = \"River Oste\"", "name = \"Oste\""}},
         {"DOMAIN: Open boundary 3 is named \"Oste\" in the setup and \"River Oste\" in the mesh"}},
        // 500 km off the mesh; a source that is not included is not held against it.
        {{{"x = 513200.0", "x = 1013200.0"}},
         {"HYDRODYNAMIC_SOURCES/SOURCE_1: The source lies outside the mesh (x 1013200, y 5950300)"}},
        {{{"include = 1\n        x = 513200.0", "include = 0\n        x = 1013200.0"}}, {}},
        {{{"y = 5974000.0", "y = 6974000.0"}}, {stations + "Point \"Cuxhaven\" lies outside the mesh"}},
        // Points are taken from their own projection into the mesh's.
        {{geographical[0]}, {stations + "Point \"Brunsbüttel\" and 1 more points lie outside the mesh"}},
        {geographical, {}},
    };
    for (const auto& c : cases) {
        const std::vector<std::string> got = Validate(c.edits);
        const std::string what = c.edits.empty() ? "as it is" : c.edits.back().second;
        ASSERT_EQ(got.size(), c.expected.size()) << what << ": " << ::testing::PrintToString(got);
        for (size_t i = 0; i < got.size(); ++i)
            EXPECT_EQ(got[i].rfind(c.expected[i], 0), 0u) << what << ": " << got[i];
    }
}

TEST_F(ExampleAgainstItsMesh, TheMeshIsReadOnceAndAgainWhenItsFileChanges) {
    CSetupDocument::OpenResult r = CSetupDocument::Open((m_dir / "estuary.setup").string());
    ASSERT_TRUE(r.document);
    CSetupDocument& doc = *r.document;
    CDomainKiv* domain = doc.GetDomain();
    EXPECT_EQ(doc.ValidateAll(), 1);
    const MeshPtr first = domain->NamedMesh();
    const CMeshIndex* index = domain->NamedMeshIndex();
    ASSERT_TRUE(first && index);
    EXPECT_EQ(doc.ValidateAll(), 1);
    EXPECT_EQ(domain->NamedMesh(), first);
    EXPECT_EQ(domain->NamedMeshIndex(), index);

    // The modeller replaces the mesh by one with a boundary fewer, then removes it.
    WriteFile(m_dir / "estuary.2dm", m_mesh.substr(0, m_mesh.find("NS 2198")));
    EXPECT_EQ(doc.ValidateAll(), 0);
    EXPECT_EQ(Messages(doc), std::vector<std::string>{"DOMAIN: The mesh has 2 open boundaries, the setup 3: "
                                                      "open the mesh again to take its boundaries"});
    fs::remove(m_dir / "estuary.2dm");
    EXPECT_EQ(doc.ValidateAll(), 0);
    EXPECT_FALSE(domain->NamedMesh());
    WriteFile(m_dir / "estuary.2dm", m_mesh);
    EXPECT_EQ(doc.ValidateAll(), 1) << ::testing::PrintToString(Messages(doc));
}

}  // namespace
