// mudsetup datafile info and new, run as a user runs them.
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

class DatafileCli : public ::testing::Test {
protected:
    void SetUp() override {
        dir = fs::temp_directory_path() /
              ("mudsetup-datafile-cli-" +
               std::string(::testing::UnitTest::GetInstance()->current_test_info()->name()));
        fs::remove_all(dir);
        fs::create_directories(dir);
    }
    void TearDown() override { fs::remove_all(dir); }

    Result Mudsetup(const std::string& args) {
        const fs::path out = dir / "stdout.txt";
        const fs::path err = dir / "stderr.txt";
        const std::string cmd = "cd " + dir.string() + " && " + MUDSETUP_EXE + " " + args + " >" +
                                out.string() + " 2>" + err.string() + " </dev/null";
        const int status = std::system(cmd.c_str());
        return {WIFEXITED(status) ? WEXITSTATUS(status) : -1, ReadFile(out), ReadFile(err)};
    }
    void Write(const char* name, const std::string& text) { std::ofstream(dir / name, std::ios::binary) << text; }

    fs::path dir;
};

}  // namespace

TEST_F(DatafileCli, NewFromACsvWithTimesAndInfoShowsIt) {
    Write("tide.csv",
          "Time;Level;Speed\n"
          "2024-03-01 00:00:00;1.25;3\n"
          "2024-03-01 00:30:00;-0.5;4\n"
          "2024-03-01 01:00:00;0;5\n");
    Result r = Mudsetup("datafile new qrd0 --title Tide --item level:100000:cm "
                        "--item 'speed:wind speed' --from tide.csv -o tide.qrd0");
    ASSERT_EQ(r.exitCode, 0) << r.err;
    EXPECT_EQ(ReadFile(dir / "tide.qrd0"),
              "qrd0 1\ntitle \"Tide\"\nstart 2024-03-01 00:00:00\nstep 1800\nsteps 3\nitems 2\n"
              "item \"level\" 100000 \"cm\"\nitem \"speed\" 100274 \"m/s\"\nvalues\n1.25 3\n-0.5 4\n0 5\n");
    r = Mudsetup("datafile info tide.qrd0");
    EXPECT_EQ(r.exitCode, 0) << r.err;
    EXPECT_EQ(r.out,
              "kind: time series (qrd0)\n"
              "title: Tide\n"
              "time: 3 time steps of 30 min from 2024-03-01 00:00:00 to 2024-03-01 01:00:00\n"
              "values: one value per item and time step\n"
              "items: 2\n"
              "  1  level  Water level (100000)  [cm]\n"
              "  2  speed  Wind speed (100274)  [m/s]\n");
}

TEST_F(DatafileCli, NewForEachLayoutWritesFilesThatReadBack) {
    struct Case {
        const char* args;
        const char* file;
        const char* values;
    };
    const Case cases[] = {
        {"qrd1 --points 3", "l.qrd1", "values: 3 points on the line\n"},
        {"qrd2 --grid 4,2 --origin 100,200 --cell-size 50,25", "g.qrd2",
         "values: 4 x 2 cells from (100, 200), cells of 50 x 25\n"},
        {"kx2 --grid 1,1", "g.kx2", "values: 1 x 1 cells from (0, 0), cells of 1 x 1\n"},
        {"qrdu --elements 7", "m.qrdu", "values: 7 elements of the mesh\n"},
    };
    for (const Case& c : cases) {
        Result r = Mudsetup(std::string("datafile new ") + c.args +
                            " --item h:100084 --start 2024-01-01T06:00 --step 600 --steps 4 -o " + c.file);
        ASSERT_EQ(r.exitCode, 0) << c.args << ": " << r.err;
        r = Mudsetup(std::string("datafile info ") + c.file);
        EXPECT_EQ(r.exitCode, 0) << r.err;
        EXPECT_NE(r.out.find(c.values), std::string::npos) << r.out;
        EXPECT_NE(r.out.find("time: 4 time steps of 10 min from 2024-01-01 06:00:00"), std::string::npos) << r.out;
    }
}

TEST_F(DatafileCli, BadFilesAndBadArgumentsExitTwoWithWhy) {
    Write("cut.qrd0", "qrd0 1\nstart 2024-01-01 00:00\nstep 60\nsteps 2\nitems 1\nitem a 100084\nvalues\n1\n");
    Write("odd.csv", "1,2\n3\n");
    Write("points.xyz", "1 2 3 A\n4 5 6\n");
    Write("bad.xyz", "1 2 3 A\n4 5\n");
    struct Case {
        const char* args;
        const char* err;
    };
    const Case cases[] = {
        {"datafile info cut.qrd0", "cut.qrd0:9:1: the file ends after 1 of 2 values (in time step 2, item 1)\n"},
        {"datafile info missing.qrd0", "missing.qrd0: the file does not exist\n"},
        {"datafile info .", ".: this is a folder, not a data file\n"},
        {"datafile info bad.xyz", "bad.xyz:2:4: expected \"x y z name\" (name optional): the z value is missing\n"},
        {"datafile new qrd9 --item a:100084 -o x.qrd0", "mudsetup: unknown kind \"qrd9\" (qrd0, qrd1, qrd2, qrdu, kx0, kx2)\n"},
        {"datafile new qrd0 --item a -o x.qrd0", "mudsetup: --item a: expected NAME:UNITTYPE or NAME:UNITTYPE:UNIT\n"},
        {"datafile new qrd0 --item a:100084:km --start '2024-01-01 00:00' --step 1 --steps 1 -o x.qrd0",
         "mudsetup: --item a:100084:km: \"km\" is not a unit of Wave height (m, cm, ft)\n"},
        {"datafile new qrd0 --item a:100084 --start '2024-01-01 00:00' --step 1 --steps 2 --points 3 -o x.qrd0",
         "mudsetup: --points belongs to qrd1 files\n"},
        {"datafile new qrd1 --item a:100084 --start '2024-01-01 00:00' --step 1 --steps 2 -o x.qrd1",
         "mudsetup: a line series needs --points N\n"},
        {"datafile new qrd0 --item a:100084 --item b:100084 --start '2024-01-01 00:00' --step 1 --from odd.csv -o x.qrd0",
         "mudsetup: odd.csv:2: 1 values where a time step holds 2\n"},
        {"datafile new qrd0 --item a:100084 --start tomorrow --step 1 --steps 1 -o x.qrd0",
         "mudsetup: --start tomorrow: expected a date and time, yyyy-MM-dd HH:mm:ss\n"},
        {"datafile new qrd0 --item a:100084 --start '2024-01-01 00:00' --step 1 -o x.qrd0",
         "mudsetup: --steps is needed without --from\n"},
        {"datafile new qrd0 --item a:100084 --start '2024-01-01 00:00' --step 1 --steps 1 -o x.qrdu",
         "mudsetup: x.qrdu: the name ends in the extension of a mesh data, not of a time series\n"},
    };
    for (const Case& c : cases) {
        const Result r = Mudsetup(c.args);
        EXPECT_EQ(r.exitCode, 2) << c.args;
        EXPECT_EQ(r.err, c.err) << c.args;
        EXPECT_EQ(r.out, "") << c.args;
    }
    EXPECT_FALSE(fs::exists(dir / "x.qrd0"));

    const Result xyz = Mudsetup("datafile info points.xyz");
    EXPECT_EQ(xyz.exitCode, 0);
    EXPECT_EQ(xyz.out, "kind: point file (xyz)\npoints: 2\nx: 1 to 4\ny: 2 to 5\nz: 3 to 6\nnamed: 1\n");

    for (const char* args : {"datafile --help", "datafile info --help", "datafile new --help"}) {
        const Result r = Mudsetup(args);
        EXPECT_EQ(r.exitCode, 0) << args;
        EXPECT_EQ(r.out.rfind("usage: mudsetup datafile", 0), 0u) << args << ": " << r.out;
    }
    const Result none = Mudsetup("datafile");
    EXPECT_EQ(none.exitCode, 2);
}

TEST_F(DatafileCli, TheExampleDataFilesAreValidAndCoverTheExamplePeriod) {
    for (const char* name : {"dredger_1.qrd0", "waves_mouth.qrd0", "boundary_sea.qrd0", "stations.xyz"}) {
        const Result r = Mudsetup(std::string("datafile info ") + MUD_SOURCE_DIR + "/examples/data/" + name);
        EXPECT_EQ(r.exitCode, 0) << name << ": " << r.err;
        if (std::string(name).ends_with(".qrd0")) {
            EXPECT_NE(r.out.find("145 time steps of 1 h from 2021-06-01 00:00:00 to 2021-06-07 00:00:00"),
                      std::string::npos)
                << r.out;
        }
    }
}
