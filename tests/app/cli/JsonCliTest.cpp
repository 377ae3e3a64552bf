// --json of the commands against the form docs/json.md documents.
#include "support/MiniJson.h"

#include <gtest/gtest.h>

#include <sys/wait.h>

#include <cstdio>
#include <fstream>
#include <initializer_list>
#include <string>
#include <utility>

using minijson::Value;
using T = Value::Type;

namespace {

struct CliRun {
    int exitCode = -1;
    std::string out;
    std::string err;
    Value doc;
};

// Runs mudsetup and parses its standard output as one JSON document.
CliRun Mudsetup(const std::string& args) {
    CliRun r;
    const std::string errFile = ::testing::TempDir() + "json-cli-stderr.txt";
    FILE* p = popen((std::string(MUDSETUP_EXE) + " " + args + " 2>" + errFile).c_str(), "r");
    if (!p)
        return r;
    char buf[4096];
    for (size_t n; (n = std::fread(buf, 1, sizeof buf, p)) > 0;)
        r.out.append(buf, n);
    const int status = pclose(p);
    r.exitCode = WIFEXITED(status) ? WEXITSTATUS(status) : -1;
    std::ifstream err(errFile);
    std::getline(err, r.err, '\0');
    minijson::Parser parser(r.out);
    EXPECT_TRUE(parser.Parse(r.doc)) << args << ": not JSON at " << parser.Offset() << ":\n" << r.out;
    return r;
}

void ExpectFields(const Value& v, std::initializer_list<std::pair<const char*, T>> fields,
                  const std::string& what) {
    ASSERT_EQ(v.type, T::Object) << what;
    for (const auto& [name, type] : fields) {
        ASSERT_TRUE(v.Has(name)) << what << " lacks " << name;
        EXPECT_EQ(v[name].type, type) << what << "." << name;
    }
}

// Every message as documented: severity and text, and either a node's path and titles or
// a file with its line.
void ExpectMessages(const Value& doc) {
    ASSERT_TRUE(doc.Has("messages"));
    ASSERT_EQ(doc["messages"].type, T::Array);
    for (const Value& m : doc["messages"].array) {
        ExpectFields(m, {{"severity", T::String}, {"text", T::String}}, "message");
        const std::string& severity = m["severity"].string;
        EXPECT_TRUE(severity == "error" || severity == "warning") << severity;
        if (m.Has("path")) {
            ExpectFields(m, {{"path", T::String}, {"title_path", T::Array}}, m["text"].string);
            for (const Value& t : m["title_path"].array)
                EXPECT_EQ(t.type, T::String);
        } else {
            ExpectFields(m, {{"file", T::String}}, m["text"].string);
        }
        if (m.Has("line")) {
            EXPECT_GE(m["line"].number, 1);
        }
    }
}

std::string Write(const char* name, const std::string& text) {
    const std::string path = ::testing::TempDir() + name;
    std::ofstream(path, std::ios::binary) << text;
    return path;
}

}  // namespace

TEST(JsonCli, ValidateListsWarningsAndErrorsWithTheirPlaces) {
    const CliRun r = Mudsetup("validate --json " MUD_SOURCE_DIR "/fuzz/corpus-setup/reported.setup");
    EXPECT_EQ(r.exitCode, 1);
    EXPECT_EQ(r.err, "");
    ExpectFields(r.doc, {{"file", T::String}, {"valid", T::Bool}, {"messages", T::Array}}, "validate");
    EXPECT_FALSE(r.doc["valid"].boolean);
    ExpectMessages(r.doc);
    bool warningWithColumn = false, errorWithTitles = false;
    for (const Value& m : r.doc["messages"].array) {
        warningWithColumn |= m["severity"].string == "warning" && m.Has("column");
        errorWithTitles |= m["severity"].string == "error" && m.Has("title_path") &&
                           !m["title_path"].array.empty();
    }
    EXPECT_TRUE(warningWithColumn);
    EXPECT_TRUE(errorWithTitles);

    const CliRun valid = Mudsetup("validate --json " MUD_SOURCE_DIR "/examples/estuary.setup");
    EXPECT_EQ(valid.exitCode, 0);
    EXPECT_TRUE(valid.doc["valid"].boolean);
    EXPECT_TRUE(valid.doc["messages"].array.empty());
}

TEST(JsonCli, FilesThatCannotBeReadAreOneErrorWithTheirLine) {
    const std::string setup = Write("json-bad.setup", "A {\n  x = \"open\n}\n");
    const std::string mesh = Write("json-bad.2dm", "MESH2D\nND 1 0 0\n");
    const std::string data = Write("json-bad.qrd0", "x\n");
    for (const std::string& args : {"validate --json " + setup, "show --json " + setup,
                                    "mesh info --json " + mesh, "datafile info --json " + data}) {
        const CliRun r = Mudsetup(args);
        EXPECT_EQ(r.exitCode, 2) << args;
        ExpectMessages(r.doc);
        ASSERT_EQ(r.doc["messages"].array.size(), 1u) << args;
        const Value& m = r.doc["messages"].array[0];
        EXPECT_EQ(m["severity"].string, "error");
        EXPECT_TRUE(m.Has("line")) << args;
    }
    const CliRun text = Mudsetup("mesh info --json /nonexistent/mesh.2dm");
    EXPECT_EQ(text.exitCode, 2);
    ExpectMessages(text.doc);
}

TEST(JsonCli, ShowGivesTheTreeAsTheTextDoes) {
    const CliRun r = Mudsetup("show --json " MUD_SOURCE_DIR "/examples/estuary.setup");
    EXPECT_EQ(r.exitCode, 0);
    ExpectMessages(r.doc);
    ASSERT_EQ(r.doc["nodes"].type, T::Array);
    for (const Value& n : r.doc["nodes"].array)
        ExpectFields(n, {{"depth", T::Number}, {"title", T::String}, {"path", T::String}, {"used", T::Bool}},
                     "node");
    FILE* p = popen(MUDSETUP_EXE " show " MUD_SOURCE_DIR "/examples/estuary.setup", "r");
    size_t lines = 0;
    for (int c; (c = std::fgetc(p)) != EOF;)
        lines += c == '\n';
    pclose(p);
    EXPECT_EQ(r.doc["nodes"].array.size(), lines);
    EXPECT_EQ(r.doc["nodes"].array[0]["path"].string, "MUD_TRANSPORT_MODULE");
}

TEST(JsonCli, MeshAndDataFileInfoHoldTheDocumentedFields) {
    const CliRun mesh = Mudsetup("mesh info --json " MUD_SOURCE_DIR "/examples/estuary.2dm");
    EXPECT_EQ(mesh.exitCode, 0);
    ExpectMessages(mesh.doc);
    ExpectFields(mesh.doc, {{"topology", T::String}, {"bed_level_missing", T::Number}, {"nodes", T::Number}, {"elements", T::Number}, {"triangles", T::Number},
                            {"quadrilaterals", T::Number}, {"extent", T::Object},
                            {"projection", T::String}, {"open_boundaries", T::Array}},
                 "mesh");
    ExpectFields(mesh.doc["extent"], {{"x_min", T::Number}, {"z_max", T::Number}}, "extent");
    ASSERT_EQ(mesh.doc["open_boundaries"].array.size(), 3u);
    ExpectFields(mesh.doc["open_boundaries"].array[0],
                 {{"name", T::String}, {"code", T::Number}, {"nodes", T::Number}}, "boundary");
    EXPECT_EQ(mesh.doc["open_boundaries"].array[0]["name"].string, "Sea boundary");

    const CliRun series = Mudsetup("datafile info --json " MUD_SOURCE_DIR "/examples/data/waves_mouth.qrd0");
    EXPECT_EQ(series.exitCode, 0);
    ExpectMessages(series.doc);
    ExpectFields(series.doc, {{"kind", T::String}, {"kind_name", T::String}, {"title", T::String},
                              {"time", T::Object}, {"values", T::String}, {"items", T::Array}},
                 "datafile");
    ExpectFields(series.doc["time"], {{"start", T::String}, {"step", T::Number}, {"steps", T::Number}}, "time");
    EXPECT_EQ(series.doc["time"]["steps"].number, 145);
    ASSERT_EQ(series.doc["items"].array.size(), 3u);
    ExpectFields(series.doc["items"].array[0], {{"name", T::String}, {"unit_type", T::Number},
                                                {"quantity", T::String}, {"unit", T::String}},
                 "item");
    EXPECT_EQ(series.doc["items"].array[0]["quantity"].string, "Wave height");

    const CliRun points = Mudsetup("datafile info --json " MUD_SOURCE_DIR "/examples/data/stations.xyz");
    EXPECT_EQ(points.exitCode, 0);
    ExpectFields(points.doc, {{"kind", T::String}, {"points", T::Number}, {"extent", T::Object},
                              {"named", T::Number}},
                 "xyz");
}

TEST(JsonCli, KeywordsEntriesHoldTheDocumentedFields) {
    const CliRun r = Mudsetup("keywords --json");
    EXPECT_EQ(r.exitCode, 0);
    ASSERT_EQ(r.doc["keywords"].type, T::Array);
    ASSERT_GT(r.doc["keywords"].array.size(), 200u);
    for (const Value& k : r.doc["keywords"].array) {
        ExpectFields(k, {{"path", T::String}, {"keyword", T::String}, {"type", T::String},
                         {"default", T::String}, {"range", T::String}, {"choices", T::String},
                         {"description", T::String}},
                     "keyword");
        if (k.Has("unit_type"))
            ExpectFields(k, {{"unit", T::String}, {"quantity", T::String}}, k["keyword"].string);
    }
}
