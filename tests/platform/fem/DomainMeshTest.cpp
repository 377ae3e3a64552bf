#include "TestSupport.h"
#include "fem/BoundaryNamesKiv.h"
#include "fem/DomainKiv.h"
#include "support/SyncedFollower.h"

#include <gtest/gtest.h>

#include <cstdio>
#include <filesystem>
#include <fstream>

namespace {

std::string WriteFile(const std::string& name, const std::string& text) {
    const std::string path = (std::filesystem::temp_directory_path() / ("muddomain_" + name)).string();
    std::ofstream(path) << text;
    return path;
}

const char* const kMesh = R"(MESH2D
E3T 1 1 2 3 1
E4Q 2 2 4 5 3 1
ND 1 100.0 200.0 -5.0
ND 2 110.0 200.0 -4.0
ND 3 110.0 210.0 -3.0
ND 4 120.0 200.0 -2.0
ND 5 120.0 210.0 2.0
NS 1 -2 2 Sea
NS 4 -5 5 River
)";

const char* const kSetup = R"(DOMAIN {
    mesh_file = 'old.2dm'
    x_min = 1.0
    x_max = 2.0
    projection = "UTM-31"
    BOUNDARY_NAMES {
        ZoSEKivListItemCount = 1
        BOUNDARY_1 {
            name = "Old"
            code = 9
        }
    }
}
)";

TEST(DomainMesh, TakesEverythingFromTheMeshAndTheListsFollow) {
    auto doc = testsupport::Load(kSetup);
    CDomainKiv* d = doc->GetDomain();
    testsupport::Follower<CBoundaryNamesKiv> follower(d->BoundaryNames());
    struct Listener : CFemListener {
        std::vector<int> got;
        void Notify(CFemNotifier*, ENotifyMessage m) override { got.push_back(m); }
    } listener;
    listener.Listen(d);
    const std::string path = WriteFile("good.2dm", kMesh);
    std::string error;
    ASSERT_TRUE(d->LoadMesh("good.2dm", path, &error)) << error;
    EXPECT_EQ(d->MeshFile(), "good.2dm");
    ASSERT_TRUE(d->Mesh());
    EXPECT_EQ(d->Mesh()->ElementCount(), 2u);
    const MeshInfo info = d->GetMeshInfo();
    EXPECT_EQ(info.xMin, 100.0);
    EXPECT_EQ(info.xMax, 120.0);
    EXPECT_EQ(info.yMax, 210.0);
    EXPECT_EQ(info.zMin, -5.0);
    EXPECT_EQ(info.zMax, 2.0);
    // A .2dm file names no projection: the domain keeps its own.
    EXPECT_EQ(d->Projection(), "UTM-31");
    CBoundaryNamesKiv* b = d->BoundaryNames();
    ASSERT_EQ(b->GetItemCount(), 2);
    EXPECT_EQ(b->GetItem(1)->Identifier(), "Sea");
    EXPECT_EQ(b->GetItem(1)->BoundaryCode(), 2);
    EXPECT_EQ(b->GetItem(2)->Identifier(), "River");
    EXPECT_EQ(b->GetItem(2)->BoundaryCode(), 5);
    EXPECT_EQ(follower.GetItemCount(), 2);
    EXPECT_EQ(listener.got, (std::vector<int>{CDomainKiv::kMeshChanged}));
    listener.StopListening(d);

    // What the mesh gave is saved with the setup.
    auto saved = testsupport::Saved(*doc);
    const paramfile::Section* s = testsupport::Find(*saved, {"DOMAIN", "BOUNDARY_NAMES", "BOUNDARY_2"});
    ASSERT_NE(s, nullptr);
    EXPECT_EQ(testsupport::String(*s, "name"), "River");
    std::remove(path.c_str());
}

TEST(DomainMesh, AMeshThatCannotBeReadChangesNothing) {
    auto doc = testsupport::Load(kSetup);
    CDomainKiv* d = doc->GetDomain();
    const std::string before = doc->ToText();
    const std::string path = WriteFile("bad.2dm", "MESH2D\nND 1 0 0 0\nE3T 1 1 2 3 1\n");
    std::string error;
    EXPECT_FALSE(d->LoadMesh("bad.2dm", path, &error));
    EXPECT_EQ(error, path + ":3: element names node 2, which does not exist");
    EXPECT_FALSE(d->Mesh());
    EXPECT_EQ(doc->ToText(), before);
    std::remove(path.c_str());
}

TEST(DomainMesh, TheGeometryOfAStoredMeshIsReadOnceAndKeepsTheStoredData) {
    auto doc = testsupport::Load(kSetup);
    CDomainKiv* d = doc->GetDomain();
    const std::string before = doc->ToText();
    std::string error;
    EXPECT_FALSE(d->EnsureMesh(WriteFile("none.2dm", ""), &error));
    EXPECT_NE(error.find("the file is empty"), std::string::npos) << error;
    const std::string path = WriteFile("good.2dm", kMesh);
    const MeshPtr mesh = d->EnsureMesh(path, &error);
    ASSERT_TRUE(mesh) << error;
    EXPECT_EQ(d->EnsureMesh(path, &error), mesh);  // shared, not read again
    EXPECT_EQ(doc->ToText(), before);
    // Naming another file drops the geometry of the old one.
    d->MeshFile("other.2dm");
    EXPECT_FALSE(d->Mesh());
    std::remove(path.c_str());
}

}  // namespace
