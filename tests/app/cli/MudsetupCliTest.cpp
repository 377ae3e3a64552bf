// The command line run as a user runs it: exit codes, standard output and error, files.
#include <gtest/gtest.h>

#include <sys/wait.h>

#include <cstdio>
#include <filesystem>
#include <fstream>
#include <sstream>
#include <string>

namespace fs = std::filesystem;

namespace {

struct Result {
    int exitCode;
    std::string out;
    std::string err;
};

std::string ReadFile(const fs::path& p) {
    std::ifstream in(p, std::ios::binary);
    std::stringstream s;
    s << in.rdbuf();
    return s.str();
}

void WriteFile(const fs::path& p, const std::string& text) { std::ofstream(p, std::ios::binary) << text; }

class Cli : public ::testing::Test {
protected:
    void SetUp() override {
        dir = fs::temp_directory_path() /
              ("mudsetup-cli-" + std::string(::testing::UnitTest::GetInstance()->current_test_info()->name()));
        fs::remove_all(dir);
        fs::create_directories(dir);
    }
    void TearDown() override { fs::remove_all(dir); }

    Result Mudsetup(const std::string& args) {
        const fs::path out = dir / "stdout.txt";
        const fs::path err = dir / "stderr.txt";
        const std::string cmd = std::string(MUDSETUP_EXE) + " " + args + " >" + out.string() +
                                " 2>" + err.string() + " </dev/null";
        const int status = std::system(cmd.c_str());
        return {WIFEXITED(status) ? WEXITSTATUS(status) : -1, ReadFile(out), ReadFile(err)};
    }
    std::string P(const char* name) const { return (dir / name).string(); }

    fs::path dir;
};

TEST_F(Cli, NewWritesAValidSetupWithTheCountsAsked) {
    Result r = Mudsetup("new --fractions 3 --layers 2 -o " + P("estuary.setup"));
    ASSERT_EQ(r.exitCode, 0) << r.err;
    const std::string text = ReadFile(dir / "estuary.setup");
    EXPECT_NE(text.find("MUD_TRANSPORT_MODULE {\n    mode = 2\n    EQUATION {"), std::string::npos);
    EXPECT_NE(text.find("number_of_fractions = 3\n        number_of_layers = 2\n"), std::string::npos);

    r = Mudsetup("validate " + P("estuary.setup"));
    EXPECT_EQ(r.exitCode, 0) << r.out << r.err;
    EXPECT_EQ(r.out, "");

    Result toStdout = Mudsetup("new --fractions 3 --layers 2");
    EXPECT_EQ(toStdout.exitCode, 0);
    EXPECT_EQ(toStdout.out, text);
}

TEST_F(Cli, ValidateReportsEachMessageWithItsPathAndExitsOne) {
    WriteFile(dir / "bad.setup",
              "MUD_TRANSPORT_MODULE {\n mode = 2\n MODEL_DEFINITION {\n  number_of_fractions = 9\n"
              "  number_of_layers = 13\n }\n}\n");
    Result r = Mudsetup("validate " + P("bad.setup"));
    EXPECT_EQ(r.exitCode, 1);
    EXPECT_EQ(r.out, "MUD_TRANSPORT_MODULE/MODEL_DEFINITION: Values out of range\n");
}

TEST_F(Cli, SyntaxErrorExitsTwoWithPlaceAndChangesNothing) {
    const std::string broken = "MUD_TRANSPORT_MODULE {\n    mode = 2\n    MODEL_DEFINITION {\n";
    WriteFile(dir / "broken.setup", broken);
    for (const char* command : {"validate", "format", "show"}) {
        Result r = Mudsetup(std::string(command) + " " + P("broken.setup"));
        EXPECT_EQ(r.exitCode, 2) << command;
        EXPECT_EQ(r.err.rfind(P("broken.setup") + ":", 0), 0u) << r.err;
        EXPECT_EQ(ReadFile(dir / "broken.setup"), broken);
    }
    Result missing = Mudsetup("validate " + P("nowhere.setup"));
    EXPECT_EQ(missing.exitCode, 2);
    EXPECT_NE(missing.err.find("nowhere.setup"), std::string::npos);
}

TEST_F(Cli, FormatIsIdempotentAndKeepsValues) {
    WriteFile(dir / "messy.setup",
              "# hand-written\nMUD_TRANSPORT_MODULE{\nmode=2\n  MODEL_DEFINITION {\nnumber_of_fractions = 2\n"
              "number_of_layers=3\n}\n}\nOTHER {\n x = 1.50, 'a b'\n}\n");
    ASSERT_EQ(Mudsetup("format " + P("messy.setup") + " -o " + P("once.setup")).exitCode, 0);
    ASSERT_EQ(Mudsetup("format " + P("once.setup") + " -o " + P("twice.setup")).exitCode, 0);
    const std::string once = ReadFile(dir / "once.setup");
    EXPECT_EQ(once, ReadFile(dir / "twice.setup"));
    EXPECT_NE(once.find("number_of_layers = 3"), std::string::npos);
    EXPECT_NE(once.find("OTHER {\n    x = 1.5, 'a b'\n}"), std::string::npos) << once;

    ASSERT_EQ(Mudsetup("format " + P("once.setup")).exitCode, 0);
    EXPECT_EQ(ReadFile(dir / "once.setup"), once);
    Result toStdout = Mudsetup("format " + P("once.setup") + " -o -");
    EXPECT_EQ(toStdout.out, once);
}

TEST_F(Cli, WarningsGoToStandardErrorAndTheFileStillLoads) {
    WriteFile(dir / "odd.setup",
              "MUD_TRANSPORT_MODULE {\n    mode = 2\n    MODEL_DEFINITION {\n"
              "        number_of_fractions = \"two\"\n    }\n}\n");
    Result r = Mudsetup("validate " + P("odd.setup"));
    EXPECT_EQ(r.exitCode, 0);
    EXPECT_EQ(r.err.rfind("warning: " + P("odd.setup") + ":4:", 0), 0u) << r.err;
}

TEST_F(Cli, ShowPrintsTheTreeIndented) {
    ASSERT_EQ(Mudsetup("new -o " + P("a.setup")).exitCode, 0);
    Result r = Mudsetup("show " + P("a.setup"));
    EXPECT_EQ(r.exitCode, 0);
    EXPECT_EQ(r.out.rfind("Mud Transport Module\n  Parameter Selection\n  Solution technique\n", 0), 0u)
        << r.out;
}

TEST_F(Cli, OutputThatCannotBeWrittenIsAFailure) {
    if (!fs::exists("/dev/full"))
        GTEST_SKIP() << "no /dev/full";
    ASSERT_EQ(Mudsetup("new -o " + P("a.setup")).exitCode, 0);
    WriteFile(dir / "bad.setup",
              "MUD_TRANSPORT_MODULE {\n mode = 2\n MODEL_DEFINITION {\n  number_of_fractions = 9\n }\n}\n");
    for (const std::string& args : {std::string("new"), "show " + P("a.setup"),
                                   "format " + P("a.setup") + " -o -", "validate " + P("bad.setup")}) {
        const std::string cmd = std::string(MUDSETUP_EXE) + " " + args + " >/dev/full 2>/dev/null";
        const int status = std::system(cmd.c_str());
        ASSERT_TRUE(WIFEXITED(status)) << args;
        EXPECT_EQ(WEXITSTATUS(status), 2) << args;
    }
}

TEST_F(Cli, HelpAndBadArguments) {
    for (const char* command : {"--help", "new --help", "validate --help", "format --help", "show --help"}) {
        Result r = Mudsetup(command);
        EXPECT_EQ(r.exitCode, 0) << command;
        EXPECT_NE(r.out.find("usage: mudsetup"), std::string::npos) << command;
    }
    for (const char* command : {"", "frobnicate", "new --fractions 9", "new --layers x",
                                "validate", "validate a b", "validate ''", "format",
                                "format a.setup -o ''", "new -o ''"}) {
        Result r = Mudsetup(command);
        EXPECT_EQ(r.exitCode, 2) << command;
        EXPECT_NE(r.err.find("usage:"), std::string::npos) << command;
    }
}

}  // namespace
