// Every reader and writer of the product over what is not a file it can take: a FIFO, a
// folder, devices, a file far too large; links are followed. Each reader runs in a child
// process, so that one that blocks or reads on fails the test instead of hanging it.
#include "datafile/DataFile.h"
#include "datafile/DataFileCache.h"
#include "fileio/GuardedFile.h"
#include "host/SetupDocument.h"
#include "mesh/MeshReader.h"
#include "paramfile/ParamFile.h"
#include "platform/mesh/UgridTestFile.h"

#include <gtest/gtest.h>

#include <poll.h>
#include <signal.h>
#include <sys/resource.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <chrono>
#include <filesystem>
#include <fstream>
#include <functional>
#include <optional>
#include <sstream>

namespace fs = std::filesystem;

namespace {

// fn's text from a child process; nothing when it did not finish within the time.
std::optional<std::string> Within(int seconds, const std::function<std::string()>& fn) {
    int fds[2];
    if (::pipe(fds) != 0)
        return std::nullopt;
    const pid_t pid = ::fork();
    if (pid == 0) {
        ::close(fds[0]);
        const std::string s = fn();
        for (std::size_t done = 0; done < s.size();) {
            const ssize_t n = ::write(fds[1], s.data() + done, s.size() - done);
            if (n <= 0)
                break;
            done += static_cast<std::size_t>(n);
        }
        ::_exit(0);
    }
    ::close(fds[1]);
    std::string out;
    const auto deadline = std::chrono::steady_clock::now() + std::chrono::seconds(seconds);
    bool finished = false;
    while (!finished) {
        const auto left = std::chrono::duration_cast<std::chrono::milliseconds>(
            deadline - std::chrono::steady_clock::now());
        if (left.count() <= 0)
            break;
        pollfd p{fds[0], POLLIN, 0};
        if (::poll(&p, 1, static_cast<int>(left.count())) <= 0)
            continue;
        char buf[4096];
        const ssize_t n = ::read(fds[0], buf, sizeof buf);
        if (n > 0)
            out.append(buf, static_cast<std::size_t>(n));
        else
            finished = true;
    }
    ::close(fds[0]);
    if (!finished)
        ::kill(pid, SIGKILL);
    int status = 0;
    ::waitpid(pid, &status, 0);
    if (!finished)
        return std::nullopt;
    return out;
}

std::string Slurp(const fs::path& p) {
    std::ifstream in(p, std::ios::binary);
    std::stringstream s;
    s << in.rdbuf();
    return s.str();
}

std::string Shell(const std::string& command) {
    const std::string cmd = command + " 2>&1 </dev/null";
    std::string out;
    if (FILE* f = ::popen(cmd.c_str(), "r")) {
        char buf[4096];
        for (std::size_t n; (n = std::fread(buf, 1, sizeof buf, f)) > 0;)
            out.append(buf, n);
        ::pclose(f);
    }
    return out;
}

const char* const kSeries =
    "qrd0 1\nstart 2024-01-01 00:00:00\nstep 60\nsteps 2\nitems 1\n"
    "item \"Level\" 100000 \"m\"\nvalues\n1\n2\n";
const char* const kSetup = "MUD_TRANSPORT_MODULE {\n    mode = 2\n}\n";
const char* const kMesh = "MESH2D\nND 1 0 0 1\nND 2 10 0 1\nND 3 0 10 1\nE3T 1 1 2 3\n";

datafile::Header SeriesHeader() {
    datafile::Header h;
    h.time.step = 60;
    h.time.steps = 2;
    h.items = {{"Level", 100000, "m"}};
    return h;
}

class GuardedFiles : public ::testing::Test {
protected:
    void SetUp() override {
        dir = fs::temp_directory_path() /
              ("mudsetup-fileio-" +
               std::string(::testing::UnitTest::GetInstance()->current_test_info()->name()));
        fs::remove_all(dir);
        fs::create_directories(dir);
    }
    void TearDown() override { fs::remove_all(dir); }
    std::string P(const std::string& name) const { return (dir / name).string(); }
    std::string Write(const std::string& name, const std::string& text) const {
        std::ofstream(dir / name, std::ios::binary) << text;
        return P(name);
    }
    fs::path dir;
};

}  // namespace

TEST_F(GuardedFiles, EveryReaderRefusesWhatIsNoFileAtOnceAndFollowsLinks) {
    ASSERT_EQ(::mkfifo(P("fifo").c_str(), 0600), 0);
    fs::create_directory(dir / "folder");
    Write("huge", "");
    fs::resize_file(dir / "huge", 3ull << 30);  // sparse: no room taken

    struct Reader {
        const char* name;
        std::string good;  // a file this reader takes, reached through a link
        const char* hugeSays;
        std::function<std::string(const std::string&)> read;  // empty when read
    };
    auto dataError = [](const std::optional<datafile::Error>& e) { return e ? e->ToString() : ""; };
    const Reader readers[] = {
        {"setup", Write("good.setup", kSetup), "is 3.0 GB; setup files are read up to 2.0 GB",
         [](const std::string& p) {
             const paramfile::ParseResult r = paramfile::ParseFile(p);
             return r.error ? r.error->ToString() : "";
         }},
        {"data header", Write("good.qrd0", kSeries), "a header line is longer than",
         [&](const std::string& p) { return dataError(datafile::ReadHeader(p).error); }},
        {"data values", P("good.qrd0"), "a header line is longer than",
         [&](const std::string& p) { return dataError(datafile::ReadValues(p, {}).error); }},
        {"selector's check", P("good.qrd0"), "a header line is longer than",
         [&](const std::string& p) { return dataError(datafile::CachedHeader(p)->error); }},
        {"point file", Write("good.xyz", "1 2 3 A\n"), "is 3.0 GB; point files are read up to 1.0 GB",
         [&](const std::string& p) { return dataError(datafile::ReadXyz(p).error); }},
        {"2dm mesh", Write("good.2dm", kMesh), "is 3.0 GB; mesh files are read up to 2.0 GB",
         [](const std::string& p) { return ReadMeshFile(p).error; }},
        {"UGRID mesh", P("good.nc"), "is not a valid netCDF file",
         [](const std::string& p) { return ReadUgrid(p).error; }},
        {"CSV of datafile new", Write("good.csv", "1\n2\n"), "is 3.0 GB; CSV files are read up to 1.0 GB",
         [&](const std::string& p) {
             const std::string out = Shell(std::string(MUDSETUP_EXE) +
                                           " datafile new qrd0 --item a:100000 --start "
                                           "'2024-01-01 00:00' --step 60 --from " + p + " -o " +
                                           P("from-csv.qrd0"));
             return out;
         }},
    };
    {
        testsupport::UgridSpec s;
        s.x = {0, 10, 0};
        s.y = {0, 0, 10};
        s.faces = {0, 1, 2};
        ASSERT_TRUE(testsupport::WriteUgrid(P("good.nc"), s));
    }
    struct Input {
        std::string path;
        const char* says;  // nullptr: the reader's own words for a huge file
    };
    const Input inputs[] = {
        {P("fifo"), "is not a regular file (a FIFO)"},
        {"/dev/null", "is not a regular file (a character device)"},
        {"/dev/zero", "is not a regular file (a character device)"},
        {P("folder"), "folder"},
        {P("huge"), nullptr},
    };
    for (const Reader& r : readers) {
        for (const Input& in : inputs) {
            SCOPED_TRACE(std::string(r.name) + " of " + in.path);
            const std::optional<std::string> said = Within(20, [&] { return r.read(in.path); });
            ASSERT_TRUE(said) << "did not return";
            EXPECT_NE(said->find(in.says ? in.says : r.hugeSays), std::string::npos) << *said;
            EXPECT_NE(said->find(in.path), std::string::npos) << *said;
        }
        const std::string link = P("link-" + std::to_string(&r - readers) + fs::path(r.good).extension().string());
        fs::create_symlink(r.good, link);
        EXPECT_EQ(r.read(link), "") << r.name;
    }
}

TEST_F(GuardedFiles, EveryWriterReplacesOnlyARegularFileOrWritesThroughALink) {
    ASSERT_EQ(::mkfifo(P("fifo").c_str(), 0600), 0);
    fs::create_directory(dir / "folder");
    struct Writer {
        const char* name;
        std::function<std::string(const std::string&)> write;  // empty when written
    };
    const Writer writers[] = {
        {"setup", [](const std::string& p) {
             CSetupDocument doc;
             std::string error;
             return doc.SaveAs(p, &error) ? std::string() : error;
         }},
        {"data file", [](const std::string& p) {
             std::string error;
             return datafile::WriteDataFile(p, SeriesHeader(), {1, 2}, &error) ? std::string() : error;
         }},
        {"datafile new -o", [](const std::string& p) {
             return Shell(std::string(MUDSETUP_EXE) +
                          " datafile new qrd0 --item a:100000 --start '2024-01-01 00:00' "
                          "--step 60 --steps 1 -o " + p);
         }},
    };
    const struct {
        std::string path;
        const char* says;
    } refused[] = {
        {P("fifo"), "is not a regular file (a FIFO)"},
        {"/dev/null", "is not a regular file (a character device)"},
        {P("folder"), "is a folder"},
    };
    for (const Writer& w : writers) {
        for (const auto& out : refused) {
            SCOPED_TRACE(std::string(w.name) + " to " + out.path);
            const std::optional<std::string> said = Within(20, [&] { return w.write(out.path); });
            ASSERT_TRUE(said) << "did not return";
            EXPECT_NE(said->find(out.says), std::string::npos) << *said;
        }
        // A link's target is written, the link stays; a huge file is simply replaced.
        SCOPED_TRACE(w.name);
        Write("target", "old");
        fs::remove(dir / "link");
        fs::create_symlink("target", dir / "link");
        EXPECT_EQ(w.write(P("link")), "");
        EXPECT_TRUE(fs::is_symlink(dir / "link"));
        EXPECT_NE(Slurp(dir / "target"), "old");
        Write("huge", "");
        fs::resize_file(dir / "huge", 3ull << 30);
        const std::optional<std::string> said = Within(20, [&] { return w.write(P("huge")); });
        ASSERT_TRUE(said);
        EXPECT_EQ(*said, "");
        EXPECT_LT(fs::file_size(dir / "huge"), 1u << 20);
    }
    EXPECT_TRUE(fs::is_fifo(dir / "fifo"));
    EXPECT_TRUE(fs::is_character_file("/dev/null"));
    for (const auto& e : fs::directory_iterator(dir))
        EXPECT_EQ(e.path().filename().string().find(".tmp"), std::string::npos) << e.path();
}

// A file-size limit fails the write (SIGXFSZ ignored, as the programs do) and leaves the
// target as it was; so does a writer abandoned before it committed.
TEST_F(GuardedFiles, FailedOrAbandonedWritesLeaveTheTargetAndNoTemporary) {
    const std::string target = Write("w.qrd0", "old");
    const std::optional<std::string> said = Within(20, [&] {
        ::signal(SIGXFSZ, SIG_IGN);
        const rlimit limit{4096, 4096};
        ::setrlimit(RLIMIT_FSIZE, &limit);
        datafile::Header h = SeriesHeader();
        h.time.steps = 20000;
        std::string error;
        datafile::WriteDataFile(target, h, std::vector<double>(20000, 1.5), &error);
        return error;
    });
    ASSERT_TRUE(said);
    EXPECT_EQ(*said, target + ": File too large");
    EXPECT_EQ(Slurp(target), "old");
    {
        fileio::AtomicWriter w;
        ASSERT_FALSE(w.Open(target));
        ASSERT_FALSE(w.Write("half"));
    }
    EXPECT_EQ(Slurp(target), "old");
    for (const auto& e : fs::directory_iterator(dir))
        EXPECT_EQ(e.path().filename(), "w.qrd0");
}

// Another program's save between the read and the write is not replaced; a file removed
// meanwhile, or the same file unchanged, is written.
TEST_F(GuardedFiles, AWriteWithTheIdentityReadReplacesOnlyTheFileThatWasRead) {
    const std::string path = Write("a.setup", kSetup);
    std::string text, error;
    fileio::FileIdentity read;
    ASSERT_FALSE(fileio::ReadWholeFile(path, fileio::kSetupFiles, text, &read));
    EXPECT_EQ(read, fileio::IdentityOf(path));

    // Saved by another program as editors do: a new file renamed over the old.
    Write("other", "theirs");
    fs::rename(dir / "other", dir / "a.setup");
    bool changed = false;
    EXPECT_FALSE(fileio::WriteFileAtomic(path, "mine", &error, &read, &changed));
    EXPECT_TRUE(changed);
    EXPECT_EQ(error, "cannot write '" + path + "': " + fileio::kChangedReason);
    EXPECT_EQ(Slurp(path), "theirs");

    // Written in place, same size: the time tells.
    read = fileio::IdentityOf(path);
    ::usleep(20000);
    std::ofstream(path, std::ios::binary) << "THEIRS";
    EXPECT_FALSE(fileio::WriteFileAtomic(path, "mine", &error, &read, &changed));
    EXPECT_TRUE(changed);

    read = fileio::IdentityOf(path);
    fileio::FileIdentity written;
    EXPECT_TRUE(fileio::WriteFileAtomic(path, "mine", &error, &read, &changed, &written));
    EXPECT_FALSE(changed);
    EXPECT_EQ(written, fileio::IdentityOf(path));
    fs::remove(path);
    EXPECT_TRUE(fileio::WriteFileAtomic(path, "again", &error, &written));
    EXPECT_EQ(Slurp(path), "again");
}
