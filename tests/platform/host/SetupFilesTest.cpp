// A setup that agrees with its files: saved into another folder it still names the same
// files, and validation holds it against the mesh it names.
#include "TestSupport.h"

#include "common/FileNames.h"
#include "datafile/ZoFileSelector.h"
#include "fem/BoundaryNamesKiv.h"
#include "fem/DomainKiv.h"
#include "hydro/HDSourcesKiv.h"
#include "mesh/MeshIndex.h"
#include "projection/ZoMapProjection.h"

#include <gtest/gtest.h>

#include <cstdio>
#include <filesystem>
#include <fstream>
#include <map>
#include <sstream>

namespace fs = std::filesystem;
using testsupport::Messages;

namespace {

TEST(FileNames, ARebasedNameNamesTheSameFileFromTheNewFolder) {
    const struct {
        const char* name;
        const char* from;
        const char* to;
        const char* expected;
    } cases[] = {
        {"mesh.2dm", "/w/proj", "/w/other", "../proj/mesh.2dm"},
        {"data/a.qrd0", "/w/proj", "/w/proj/runs/one", "../../data/a.qrd0"},
        {"../shared/mesh.2dm", "/w/proj", "/w/proj/sub", "../../shared/mesh.2dm"},
        {"runs/../data/./a.qrd0", "/w/proj", "/w", "proj/data/a.qrd0"},
        {"  padded.qrd0 ", "/w/proj", "/w", "proj/padded.qrd0"},
        // Written on Windows: the separator stays the file's own.
        {"data\\dredger 1.qrd0", "/w/proj", "/w/other", "..\\proj\\data\\dredger 1.qrd0"},
        {"data\\sub/mixed.qrd0", "/w/proj", "/w/other", "../proj/data/sub/mixed.qrd0"},
        // Only the root in common: the way there is the file's absolute name.
        {"mesh.2dm", "/home/me/proj", "/tmp/copy", "/home/me/proj/mesh.2dm"},
        {"..\\..\\x.qrd0", "/home/me/proj", "/tmp", "/home/x.qrd0"},
        // Names that no folder changes.
        {"/srv/meshes/m.2dm", "/w/proj", "/w/other", "/srv/meshes/m.2dm"},
        {"C:\\runs\\wind.qrd0", "/w/proj", "/w/other", "C:\\runs\\wind.qrd0"},
        {"\\\\server\\share\\m.2dm", "/w/proj", "/w/other", "\\\\server\\share\\m.2dm"},
        {"", "/w/proj", "/w/other", ""},
        {"data\\same.qrd0", "/w/proj", "/w/proj/", "data\\same.qrd0"},
    };
    for (const auto& c : cases)
        EXPECT_EQ(RebasedFileName(c.name, c.from, c.to), c.expected)
            << c.name << " from " << c.from << " to " << c.to;
}

std::string ReadFile(const fs::path& p) {
    std::ifstream in(p, std::ios::binary);
    std::stringstream s;
    s << in.rdbuf();
    return s.str();
}

void WriteFile(const fs::path& p, const std::string& text) {
    std::ofstream(p, std::ios::binary) << text;
}

// Every file name a saved setup holds, by its place (sections, keyword, value number), with
// the file it stands for; names that no folder changes as they are written.
std::map<std::string, std::string> FilesNamedBy(const fs::path& setup) {
    paramfile::ParseResult parsed = paramfile::ParseFile(setup.string());
    EXPECT_FALSE(parsed.error) << parsed.error->ToString();
    std::map<std::string, std::string> out;
    if (!parsed.document)
        return out;
    CZoFileSelector resolver;
    resolver.SetBaseFolder(fs::absolute(setup).parent_path().lexically_normal().string());
    auto walk = [&](auto& self, const paramfile::Section& s, const std::string& path) -> void {
        for (int i = 0; i < s.EntryCount(); ++i) {
            if (s.EntryIsSection(i)) {
                self(self, s.SectionAt(i), path + "/" + std::string(s.SectionAt(i).Name()));
                continue;
            }
            const paramfile::Keyword& k = s.KeywordAt(i);
            for (int j = 0; j < k.ParamCount(); ++j) {
                std::string name;
                if (k.ParamAt(j).Type() != paramfile::ParamType::FileName || !k.ParamAt(j).AsString(name))
                    continue;
                out[path + "/" + std::string(k.Name()) + "#" + std::to_string(j)] =
                    IsAbsoluteFileName(name) || name.empty() ? name : resolver.AbsolutePath(name);
            }
        }
    };
    walk(walk, parsed.document->Root(), "");
    return out;
}

// A copy of the example with its mesh and data files in a project folder of its own, and a
// section of another module that names files too.
class SetupFiles : public ::testing::Test {
protected:
    void SetUp() override {
        m_dir = fs::temp_directory_path() /
                ("mudsetup-files-" + std::string(::testing::UnitTest::GetInstance()->current_test_info()->name()));
        fs::remove_all(m_dir);
        m_project = m_dir / "project";
        fs::create_directories(m_project / "data");
        const fs::path examples = MUD_SOURCE_DIR "/examples";
        fs::copy_file(examples / "estuary.2dm", m_project / "estuary.2dm");
        for (const auto& f : fs::directory_iterator(examples / "data"))
            fs::copy_file(f.path(), m_project / "data" / f.path().filename());
        WriteFile(m_project / "estuary.setup",
                  ReadFile(examples / "estuary.setup") +
                      "SPECTRAL_WAVES_MODULE {\n"
                      "    bathymetry = 'data\\dredger_1.qrd0', 'estuary.2dm'\n"
                      "    spectra = '/srv/spectra/north.qrd0'\n"
                      "    wind = 'C:\\runs\\wind.qrd0'\n"
                      "}\n");
    }
    void TearDown() override { fs::remove_all(m_dir); }

    fs::path m_dir, m_project;
};

TEST_F(SetupFiles, SavedIntoAnotherFolderEveryFileNameStillNamesItsFile) {
    const fs::path original = m_project / "estuary.setup";
    CSetupDocument::OpenResult opened = CSetupDocument::Open(original.string());
    ASSERT_TRUE(opened.document);
    CSetupDocument& doc = *opened.document;
    const std::string canonical = doc.ToText();
    const std::map<std::string, std::string> before = FilesNamedBy(original);
    ASSERT_GE(before.size(), 10u);

    fs::create_directories(m_dir / "runs" / "april");
    const fs::path moved = m_dir / "runs" / "april" / "moved.setup";
    std::string error;
    ASSERT_TRUE(doc.SaveAs(moved.string(), &error)) << error;
    EXPECT_EQ(FilesNamedBy(moved), before);
    const std::string text = ReadFile(moved);
    EXPECT_NE(text.find("mesh_file = '../../project/estuary.2dm'"), std::string::npos);
    EXPECT_NE(text.find("bathymetry = '..\\..\\project\\data\\dredger_1.qrd0', "
                        "'../../project/estuary.2dm'"),
              std::string::npos);

    // The document is the file now: its nodes hold the new names, saving again changes
    // nothing, and the moved setup finds its mesh and data files.
    EXPECT_EQ(doc.GetDomain()->MeshFile(), "../../project/estuary.2dm");
    EXPECT_EQ(doc.ToText(), text);
    EXPECT_EQ(doc.ValidateAll(), 1) << ::testing::PrintToString(Messages(doc));
    CSetupDocument::OpenResult reopened = CSetupDocument::Open(moved.string());
    ASSERT_TRUE(reopened.document);
    EXPECT_TRUE(reopened.warnings.empty());
    EXPECT_EQ(reopened.document->ValidateAll(), 1) << ::testing::PrintToString(Messages(*reopened.document));

    // Back in its own folder it is the setup it was.
    ASSERT_TRUE(doc.SaveAs(original.string(), &error)) << error;
    EXPECT_EQ(ReadFile(original), canonical);
}

TEST_F(SetupFiles, ASetupMovedWithoutItsFilesIsNotValid) {
    const fs::path original = m_project / "estuary.setup";
    fs::create_directories(m_dir / "elsewhere");
    fs::copy_file(original, m_dir / "elsewhere" / "estuary.setup");
    CSetupDocument::OpenResult opened = CSetupDocument::Open((m_dir / "elsewhere" / "estuary.setup").string());
    ASSERT_TRUE(opened.document);
    EXPECT_EQ(opened.document->ValidateAll(), 0);
    const std::vector<std::string> messages = Messages(*opened.document);
    ASSERT_FALSE(messages.empty());
    EXPECT_EQ(messages[0].rfind("DOMAIN: The mesh cannot be read: " +
                                    (m_dir / "elsewhere" / "estuary.2dm").string() + ":",
                                0),
              0u)
        << messages[0];
}

// --- validation against the mesh ---------------------------------------------------------

// Two squares side by side, (0, 0) to (20, 10), in UTM zone 32.
const char* const kMesh = R"(MESH2D
E4Q 1 1 2 5 4 1
E4Q 2 2 3 6 5 1
ND 1 500000.0 5000000.0 -5.0
ND 2 500010.0 5000000.0 -5.0
ND 3 500020.0 5000000.0 -5.0
ND 4 500000.0 5000010.0 -5.0
ND 5 500010.0 5000010.0 -5.0
ND 6 500020.0 5000010.0 -5.0
NS 1 -4 2 Sea
NS 3 -6 3 River
)";

// The setup's boundaries, to be replaced by the first alone.
const char* const kBothBoundaries = R"(ZoSEKivListItemCount = 2
        BOUNDARY_1 {
            name = "Sea"
            code = 2
        }
        BOUNDARY_2 {
            name = "River"
            code = 3
        }
)";
const char* const kFirstBoundary = R"(ZoSEKivListItemCount = 1
        BOUNDARY_1 {
            name = "Sea"
            code = 2
        }
)";

const char* const kSetup = R"(DOMAIN {
    mesh_file = 'squares.2dm'
    x_min = 500000.0
    x_max = 500020.0
    y_min = 5000000.0
    y_max = 5000010.0
    z_min = -5.0
    z_max = -5.0
    projection = "UTM-32"
    BOUNDARY_NAMES {
        ZoSEKivListItemCount = 2
        BOUNDARY_1 {
            name = "Sea"
            code = 2
        }
        BOUNDARY_2 {
            name = "River"
            code = 3
        }
    }
}
HYDRODYNAMIC_SOURCES {
    ZoSEKivListItemCount = 2
    SOURCE_1 {
        name = "Outfall"
        x = 500015.0
        y = 5000005.0
    }
    SOURCE_2 {
        name = "Unused"
        include = 0
        x = 0.0
        y = 0.0
    }
}
MUD_TRANSPORT_MODULE {
    OUTPUTS {
        ZoSEKivListItemCount = 1
        number_of_outputs = 1
        OUTPUT_1 {
            title = "Stations"
            file_name = 'stations.qrd0'
            format = 0
            coordinate_type = "UTM-32"
            number_of_points = 2
            POINT_1 {
                name = "Quay"
                x = 500005.0
                y = 5000005.0
            }
            POINT_2 {
                name = "Buoy"
                x = 500019.0
                y = 5000009.0
            }
        }
    }
}
)";

class MeshChecks : public SetupFiles {
protected:
    // Messages that start as expected, one for one (a reader's own words may follow).
    static void ExpectStarts(const std::vector<std::string>& got, const std::vector<std::string>& expected,
                             const std::string& what) {
        ASSERT_EQ(got.size(), expected.size()) << what << ": " << ::testing::PrintToString(got);
        for (size_t i = 0; i < got.size(); ++i)
            EXPECT_EQ(got[i].rfind(expected[i], 0), 0u) << what << ": " << got[i];
    }
    // The messages of the setup with texts replaced, with the mesh beside it.
    std::vector<std::string> Validate(const std::vector<std::pair<std::string, std::string>>& edits = {}) {
        std::string text = kSetup;
        for (const auto& [from, to] : edits) {
            const size_t at = text.find(from);
            EXPECT_NE(at, std::string::npos) << from;
            if (at != std::string::npos)
                text.replace(at, from.size(), to);
        }
        WriteFile(m_project / "squares.setup", text);
        CSetupDocument::OpenResult r = CSetupDocument::Open((m_project / "squares.setup").string());
        EXPECT_TRUE(r.document);
        for (const paramfile::Diagnostic& w : r.warnings)
            ADD_FAILURE() << w.ToString();
        if (!r.document)
            return {};
        r.document->ValidateAll();
        return Messages(*r.document);
    }
    void SetUp() override {
        SetupFiles::SetUp();
        WriteFile(m_project / "squares.2dm", kMesh);
    }
};

TEST_F(MeshChecks, TheSetupIsHeldAgainstItsMesh) {
    using V = std::vector<std::string>;
    EXPECT_EQ(Validate(), V{});
    WriteFile(m_project / "garbage.2dm", "MESH2D\nE3T 1 1 2 3 1\nND 1 0.0 0.0\n");
    const struct {
        const char* from;
        const char* to;
        V expected;
    } cases[] = {
        {"'squares.2dm'", "'gone.2dm'",
         {"DOMAIN: The mesh cannot be read: " + (m_project / "gone.2dm").string() + ":"}},
        {"'squares.2dm'", "'data'",
         {"DOMAIN: The mesh cannot be read: " + (m_project / "data").string() + ": not a regular file"}},
        {"'squares.2dm'", "'garbage.2dm'",
         {"DOMAIN: The mesh cannot be read: " + (m_project / "garbage.2dm").string() + ":"}},
        {kBothBoundaries, kFirstBoundary,
         {"DOMAIN: The mesh has 2 open boundaries, the setup 1 open boundary: open the mesh "
          "again to take its boundaries"}},
        {"name = \"River\"", "name = \"Harbour\"",
         {"DOMAIN: Open boundary 2 is named \"Harbour\" in the setup and \"River\" in the mesh"}},
        // 500 km off: outside every element, though an excluded source may lie anywhere.
        {"x = 500015.0", "x = 1000015.0",
         {"HYDRODYNAMIC_SOURCES/SOURCE_1: The source lies outside the mesh (x 1000015, y 5000005)"}},
        {"y = 5000009.0", "y = 5000010.5",
         {"MUD_TRANSPORT_MODULE/OUTPUTS/OUTPUT_1: Point \"Buoy\" lies outside the mesh"}},
        {"x = 500005.0\n                y = 5000005.0", "x = -1.0\n                y = 5000005.0",
         {"MUD_TRANSPORT_MODULE/OUTPUTS/OUTPUT_1: Point \"Quay\" lies outside the mesh"}},
        // Points in another projection are held against the mesh where they fall on it.
        {"coordinate_type = \"UTM-32\"", "coordinate_type = \"LONG/LAT\"",
         {"MUD_TRANSPORT_MODULE/OUTPUTS/OUTPUT_1: Point \"Quay\" and 1 more points lie outside the mesh"}},
    };
    for (const auto& c : cases)
        ExpectStarts(Validate({{c.from, c.to}}), c.expected, std::string(c.from) + " -> " + c.to);
}

TEST_F(MeshChecks, PointsInAnotherProjectionThatFallOnTheMeshAreInside) {
    // Both points as longitude and latitude (near 9 degrees east, 45 north).
    std::vector<std::pair<std::string, std::string>> edits = {
        {"coordinate_type = \"UTM-32\"", "coordinate_type = \"LONG/LAT\""}};
    for (const char* point : {"x = 500005.0\n                y = 5000005.0",
                              "x = 500019.0\n                y = 5000009.0"}) {
        double x = 0, y = 0;
        ASSERT_EQ(std::sscanf(point, "x = %lf y = %lf", &x, &y), 2);
        ASSERT_TRUE(CZoMapProjection("UTM-32", "LONG/LAT").Transform(x, y));
        edits.push_back({point, FormatString("x = %.17g\n                y = %.17g", x, y)});
    }
    EXPECT_EQ(Validate(edits), std::vector<std::string>{});
}

TEST_F(MeshChecks, TheMeshIsReadOnceAndAgainWhenItsFileChanges) {
    WriteFile(m_project / "squares.setup", kSetup);
    CSetupDocument::OpenResult r = CSetupDocument::Open((m_project / "squares.setup").string());
    ASSERT_TRUE(r.document);
    CDomainKiv* domain = r.document->GetDomain();
    EXPECT_EQ(r.document->ValidateAll(), 1);
    const MeshPtr first = domain->NamedMesh();
    ASSERT_TRUE(first);
    const CMeshIndex* index = domain->NamedMeshIndex();
    EXPECT_EQ(r.document->ValidateAll(), 1);
    EXPECT_EQ(domain->NamedMesh(), first);
    EXPECT_EQ(domain->NamedMeshIndex(), index);

    // The modeller replaces the mesh: one open boundary fewer.
    std::string changed = kMesh;
    changed.erase(changed.find("NS 3 -6 3 River\n"));
    WriteFile(m_project / "squares.2dm", changed);
    EXPECT_EQ(r.document->ValidateAll(), 0);
    EXPECT_NE(domain->NamedMesh(), first);
    EXPECT_EQ(Messages(*r.document),
              std::vector<std::string>{"DOMAIN: The mesh has 1 open boundary, the setup 2 open "
                                       "boundaries: open the mesh again to take its boundaries"});

    // A file that cannot be read is not read again until it changes either.
    fs::remove(m_project / "squares.2dm");
    EXPECT_EQ(r.document->ValidateAll(), 0);
    EXPECT_FALSE(domain->NamedMesh());
    WriteFile(m_project / "squares.2dm", kMesh);
    EXPECT_EQ(r.document->ValidateAll(), 1) << ::testing::PrintToString(Messages(*r.document));
}

}  // namespace
