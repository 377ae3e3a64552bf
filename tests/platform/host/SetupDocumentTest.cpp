#include "TestSupport.h"
#include "core/MudTransportModuleKiv.h"
#include "fem/DomainKiv.h"
#include "host/ModuleSelection.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <sstream>

using namespace testsupport;
namespace fs = std::filesystem;

namespace {

std::string ReadFile(const fs::path& p) {
    std::ifstream in(p, std::ios::binary);
    std::stringstream s;
    s << in.rdbuf();
    return s.str();
}

TEST(SetupDocument, ForeignSectionsKeepTheirContentAndPlace) {
    const std::string text =
        "OTHER_MODULE {\n    alpha = 1, 2.5, \"x\"\n    NESTED {\n        path = 'C:\\data\\a.qrd0'\n    }\n}\n"
        "MUD_TRANSPORT_MODULE {\n    mode = 2\n}\n"
        "LAST_MODULE {\n    beta = true\n}\n";
    auto doc = Load(text);
    const std::string out = doc->ToText();
    auto saved = paramfile::ParseText(out, "out");
    ASSERT_FALSE(saved.error);
    const paramfile::Section& root = saved.document->Root();
    std::vector<std::string> names;
    for (int i = 0; i < root.EntryCount(); ++i)
        names.push_back(std::string(root.SectionAt(i).Name()));
    // The module stays between the foreign sections; the host's new sections follow.
    ASSERT_GE(names.size(), 3u);
    EXPECT_EQ(names[0], "OTHER_MODULE");
    EXPECT_EQ(names[1], "MUD_TRANSPORT_MODULE");
    EXPECT_EQ(names[2], "LAST_MODULE");
    EXPECT_NE(out.find("OTHER_MODULE {\n    alpha = 1, 2.5, \"x\"\n    NESTED {\n        path = "
                       "'C:\\data\\a.qrd0'\n    }\n}\n"),
              std::string::npos)
        << out;
    // Saving what was saved changes nothing.
    auto again = Load(out);
    EXPECT_EQ(again->ToText(), out);
}

TEST(SetupDocument, ModuleAloneTakesTheHostDefaults) {
    auto doc = Load("MUD_TRANSPORT_MODULE {\n}\n");
    EXPECT_EQ(doc->GetModuleSelection()->Mode(), 2);
    EXPECT_FALSE(doc->GetDomain()->MeshExist());
    EXPECT_FALSE(doc->GetDomain()->Is3D());
}

TEST(SetupDocument, SyntaxErrorLoadsNothingAndSaysWhere) {
    CSetupDocument::OpenResult r =
        CSetupDocument::FromText("MUD_TRANSPORT_MODULE {\n  mode = = 2\n}\n", "bad.setup");
    EXPECT_FALSE(r.document);
    ASSERT_TRUE(r.error);
    EXPECT_EQ(r.error->ToString().rfind("bad.setup:2:", 0), 0u) << r.error->ToString();
}

TEST(SetupDocument, FailedSaveLeavesTheFileAndReportsWhy) {
    const fs::path dir = fs::temp_directory_path() / "mudsetup-save-test";
    fs::remove_all(dir);
    fs::create_directories(dir);
    const fs::path file = dir / "a.setup";
    {
        std::ofstream(file) << "MUD_TRANSPORT_MODULE {\n    mode = 2\n}\n";
    }
    auto opened = CSetupDocument::Open(file.string());
    ASSERT_TRUE(opened.document);
    std::string error;
    // A directory in the way of the target cannot be replaced by a file.
    fs::create_directories(dir / "taken.setup");
    EXPECT_FALSE(opened.document->SaveAs((dir / "taken.setup").string(), &error));
    EXPECT_FALSE(error.empty());
    EXPECT_FALSE(opened.document->SaveAs((dir / "missing" / "b.setup").string(), &error));
    EXPECT_EQ(opened.document->FileName(), file.string());
    EXPECT_EQ(ReadFile(file), "MUD_TRANSPORT_MODULE {\n    mode = 2\n}\n");

    ASSERT_TRUE(opened.document->SaveAs(file.string(), &error)) << error;
    EXPECT_NE(ReadFile(file).find("MODEL_DEFINITION"), std::string::npos);
    // Nothing is left beside the file.
    int entries = 0;
    for ([[maybe_unused]] auto& e : fs::directory_iterator(dir))
        ++entries;
    EXPECT_EQ(entries, 2);  // a.setup and taken.setup
    fs::remove_all(dir);
}

}  // namespace
