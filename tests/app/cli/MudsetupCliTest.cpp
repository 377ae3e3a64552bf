// The command line run as a user runs it: exit codes, standard output and error, files.
#include "common/FileNames.h"
#include "datafile/ZoFileSelector.h"
#include "paramfile/ParamFile.h"

#include <gtest/gtest.h>

#include <sys/stat.h>
#include <sys/wait.h>

#include <algorithm>
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <map>
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

    // prefix: shell words before the command ("timeout 20 ", "ulimit -f 4; ").
    Result Mudsetup(const std::string& args, const std::string& prefix = "") {
        const fs::path out = dir / "stdout.txt";
        const fs::path err = dir / "stderr.txt";
        const std::string cmd = prefix + std::string(MUDSETUP_EXE) + " " + args + " >" + out.string() +
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

// Every file name a setup holds, by its place (sections, keyword, value number), with the
// file it stands for; names no folder changes as they are written.
std::map<std::string, std::string> FilesNamedBy(const fs::path& setup) {
    paramfile::ParseResult parsed = paramfile::ParseFile(setup.string());
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
                if (k.ParamAt(j).Type() == paramfile::ParamType::FileName && k.ParamAt(j).AsString(name))
                    out[path + "/" + std::string(k.Name()) + "#" + std::to_string(j)] =
                        name.empty() || IsAbsoluteFileName(name) ? name : resolver.AbsolutePath(name);
            }
        }
    };
    walk(walk, parsed.document->Root(), "");
    return out;
}

TEST_F(Cli, FormatIntoAnotherFolderKeepsTheFilesTheSetupNames) {
    fs::create_directories(dir / "project");
    fs::copy(MUD_SOURCE_DIR "/examples", dir / "project", fs::copy_options::recursive);
    // A section of another module names files too.
    std::ofstream(dir / "project" / "estuary.setup", std::ios::app)
        << "SPECTRAL_WAVES_MODULE {\n    bathymetry = 'data\\dredger_1.qrd0', 'estuary.2dm'\n"
           "    spectra = '/srv/north.qrd0', 'C:\\runs\\wind.qrd0'\n}\n";
    const fs::path input = dir / "project" / "estuary.setup";
    const std::map<std::string, std::string> named = FilesNamedBy(input);
    ASSERT_GE(named.size(), 12u);

    fs::create_directories(dir / "runs" / "april");
    Result r = Mudsetup("format " + input.string() + " -o " + P("runs/april/moved.setup"));
    ASSERT_EQ(r.exitCode, 0) << r.err;
    EXPECT_EQ(FilesNamedBy(dir / "runs" / "april" / "moved.setup"), named);
    r = Mudsetup("validate " + P("runs/april/moved.setup"));
    EXPECT_EQ(r.exitCode, 0) << r.out << r.err;
}

TEST_F(Cli, WarningsGoToStandardErrorAndTheFileStillLoads) {
    WriteFile(dir / "odd.setup",
              "MUD_TRANSPORT_MODULE {\n    mode = 2\n    MODEL_DEFINITION {\n"
              "        number_of_fractions = \"two\"\n    }\n}\n");
    Result r = Mudsetup("validate " + P("odd.setup"));
    // The setup itself is valid, but the file does not hold what it says.
    EXPECT_EQ(r.exitCode, 1);
    EXPECT_EQ(r.out, "");
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

// Files that read with warnings: validate lists them and exits 1; format in place writes
// nothing (byte for byte) when it would drop reported content, unless --force.
TEST_F(Cli, WarningsMakeAFileInvalidAndFormatKeepsWhatItWouldDrop) {
    const std::string model = "MUD_TRANSPORT_MODULE {\n    mode = 2\n    MODEL_DEFINITION {\n"
                              "        number_of_fractions = 1\n        number_of_layers = 1\n";
    struct Case {
        const char* name;
        std::string text;
        const char* warning; // on standard error, with FILE:LINE:COLUMN; null for none
        int validate;
        int format;
    };
    const Case cases[] = {
        {"clean", model + "    }\n}\n", nullptr, 0, 0},
        {"unknown section", model + "    }\n    PARTICLE_TRACKING {\n        a = 1\n    }\n}\n",
         ":7:5: unknown section 'PARTICLE_TRACKING'", 1, 1},
        {"nested unknown section",
         model + "    }\n    FORCINGS {\n        TIDES {\n        }\n    }\n}\n",
         ":8:9: unknown section 'TIDES'", 1, 1},
        {"count no setup holds",
         "MUD_TRANSPORT_MODULE {\n    MODEL_DEFINITION {\n"
         "        number_of_fractions = 2000000000\n    }\n}\n",
         ":3:9: ", 1, 0},
        {"counts that disagree",
         model + "    }\n    BED {\n        BED_DENSITY {\n            ZoSEKivListItemCount = 3\n"
                 "        }\n    }\n}\n",
         ":9:13: ZoSEKivListItemCount = 3, but the setup has 1 layer", 1, 0},
        {"empty file", "", ":1:1: no section 'MUD_TRANSPORT_MODULE'", 1, 0},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.name);
        const fs::path file = dir / "case.setup";
        WriteFile(file, c.text);
        Result v = Mudsetup("validate " + file.string());
        EXPECT_EQ(v.exitCode, c.validate) << v.out << v.err;
        if (c.warning)
            EXPECT_NE(v.err.find("warning: " + file.string() + c.warning), std::string::npos)
                << v.err;
        else
            EXPECT_EQ(v.err, "");
        Result f = Mudsetup("format " + file.string());
        EXPECT_EQ(f.exitCode, c.format) << f.err;
        if (c.format == 1) {
            EXPECT_EQ(ReadFile(file), c.text);
            EXPECT_NE(f.err.find("not written: saving would drop the entry reported above; "
                                 "--force writes it anyway"),
                      std::string::npos)
                << f.err;
            EXPECT_EQ(Mudsetup("format " + file.string() + " -o -").exitCode, 0);
            EXPECT_EQ(ReadFile(file), c.text);
            Result forced = Mudsetup("format --force " + file.string());
            EXPECT_EQ(forced.exitCode, 0) << forced.err;
            EXPECT_NE(ReadFile(file), c.text);
        }
    }
    EXPECT_NE(Mudsetup("format --help").out.find("--force"), std::string::npos);
}

// Only regular files are read: a device, a FIFO or a folder is refused at once.
TEST_F(Cli, InputThatIsNoSetupFileIsRefused) {
    ASSERT_EQ(::mkfifo(P("fifo").c_str(), 0600), 0);
    fs::create_directory(dir / "folder");
    WriteFile(dir / "huge.setup", "");
    fs::resize_file(dir / "huge.setup", 3ull << 30);  // sparse: no room taken
    const struct {
        std::string input;
        const char* why;
    } cases[] = {
        {"/dev/zero", "is not a regular file (a character device)"},
        {P("fifo"), "is not a regular file (a FIFO)"},
        {P("folder"), "is a folder"},
        {P("huge.setup"), "is 3.0 GB; setup files are read up to 2.0 GB"},
        {P("nowhere.setup"), "No such file or directory"},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.input);
        // A reader that waited or read on would be stopped by timeout (exit 124).
        Result r = Mudsetup("validate " + c.input, "timeout 20 ");
        EXPECT_EQ(r.exitCode, 2);
        // Without a place in the file to point to, the message has none.
        EXPECT_EQ(r.err, "mudsetup: cannot read '" + c.input + "': " + c.why + "\n");
    }
    // Text that does not start with a section is no setup: a parser's message would not say so.
    const struct {
        const char* name;
        std::string text;
        int line;
    } contents[] = {
        {"picture.png", std::string("\x89PNG\r\n\x1a\n\0\0\0\rIHDR", 16), 1},
        {"series.csv", "time,level\n0,1.5\n", 1},
        {"notes.setup", "# the estuary\n\nmode = 2\nMUD_TRANSPORT_MODULE {\n}\n", 3},
        {"brace.setup", "}\n", 1},
    };
    for (const auto& c : contents) {
        SCOPED_TRACE(c.name);
        WriteFile(dir / c.name, c.text);
        Result r = Mudsetup(std::string("format ") + P(c.name));
        EXPECT_EQ(r.exitCode, 2);
        EXPECT_EQ(r.err, "mudsetup: " + P(c.name) + " is not a setup file: no section at line " +
                             std::to_string(c.line) + "\n");
        EXPECT_EQ(ReadFile(dir / c.name), c.text);
    }
}

// A count of millions with no items behind it is one warning, and the setup saves small.
TEST_F(Cli, AHugeCountOfMissingPointsIsOneWarning) {
    ASSERT_EQ(Mudsetup("new -o " + P("base.setup")).exitCode, 0);
    std::string text = ReadFile(dir / "base.setup");
    const std::string empty = "ZoSEKivListItemCount = 0\n        number_of_outputs = 0\n";
    const size_t at = text.find(empty);
    ASSERT_NE(at, std::string::npos);
    text.replace(at, empty.size(),
                 "number_of_outputs = 1\n        OUTPUT_1 {\n            number_of_points = 2000000\n"
                 "        }\n");
    WriteFile(dir / "big.setup", text);
    Result r = Mudsetup("format " + P("big.setup") + " -o " + P("out.setup"));
    EXPECT_EQ(r.exitCode, 0) << r.err;
    EXPECT_LT(std::count(r.err.begin(), r.err.end(), '\n'), 10) << r.err.substr(0, 2000);
    EXPECT_LT(r.err.size(), 1000u);
    EXPECT_NE(r.err.find("2000000 of 2000000 sections are missing"), std::string::npos) << r.err;
    // The output has no points: it is no bigger than the setup it came from with one output.
    EXPECT_LT(fs::file_size(dir / "out.setup"), text.size() + 20000);
    EXPECT_NE(ReadFile(dir / "out.setup").find("number_of_points = 0"), std::string::npos);
}

// Saving replaces only regular files (through links); a size limit fails the save cleanly,
// and what a killed save left behind goes with the next save.
TEST_F(Cli, OutputGoesOnlyWhereASetupBelongs) {
    WriteFile(dir / "real.setup", "MUD_TRANSPORT_MODULE {\nmode = 2\n}\n");
    const std::string canonical = Mudsetup("format " + P("real.setup") + " -o -").out;
    fs::create_symlink("real.setup", dir / "link.setup");
    Result r = Mudsetup("format " + P("link.setup"));
    EXPECT_EQ(r.exitCode, 0) << r.err;
    EXPECT_TRUE(fs::is_symlink(dir / "link.setup"));
    EXPECT_TRUE(ReadFile(dir / "real.setup") == canonical);

    ASSERT_EQ(::mkfifo(P("fifo").c_str(), 0600), 0);
    for (const std::string& output : {P("fifo"), std::string("/dev/null")}) {
        SCOPED_TRACE(output);
        r = Mudsetup("format " + P("real.setup") + " -o " + output, "timeout 20 ");
        EXPECT_EQ(r.exitCode, 2);
        EXPECT_NE(r.err.find("cannot write '" + output + "': is not a regular file"),
                  std::string::npos)
            << r.err;
    }
    EXPECT_TRUE(fs::is_fifo(dir / "fifo"));
    EXPECT_TRUE(fs::is_character_file("/dev/null"));

    // A pid above any pid_max is of no living process.
    WriteFile(dir / ".real.setup.tmp4194305_0", "half");
    r = Mudsetup("new --fractions 8 --layers 12 -o " + P("real.setup"), "ulimit -f 4; ");
    EXPECT_EQ(r.exitCode, 2);
    EXPECT_NE(r.err.find("cannot write '" + P("real.setup") + "': File too large"),
              std::string::npos)
        << r.err;
    EXPECT_TRUE(ReadFile(dir / "real.setup") == canonical);
    for (const auto& e : fs::directory_iterator(dir))
        EXPECT_EQ(e.path().filename().string().find(".real.setup.tmp"), std::string::npos)
            << e.path();
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
