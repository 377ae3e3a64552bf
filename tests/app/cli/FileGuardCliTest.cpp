// mudsetup format while another program saves the same file: strace stops format at its
// first fsync (its new text complete, nothing renamed yet), another save replaces the file,
// and format, continued, must leave that save in place. Skipped where strace cannot trace.
#include <gtest/gtest.h>

#include <signal.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <sstream>
#include <string>

namespace fs = std::filesystem;

namespace {

std::string Slurp(const fs::path& p) {
    std::ifstream in(p, std::ios::binary);
    std::stringstream s;
    s << in.rdbuf();
    return s.str();
}

// The process state letter of pid ('T' or 't' when stopped), or 0 when it is gone.
char State(pid_t pid) {
    std::ifstream in("/proc/" + std::to_string(pid) + "/stat");
    std::string line;
    std::getline(in, line);
    const std::size_t close = line.rfind(')');
    return close == std::string::npos || close + 2 >= line.size() ? 0 : line[close + 2];
}

// The first child of pid, 0 while it has none.
pid_t ChildOf(pid_t pid) {
    std::ifstream in("/proc/" + std::to_string(pid) + "/task/" + std::to_string(pid) + "/children");
    pid_t child = 0;
    in >> child;
    return child;
}

// Whether pid holds the temporary of a save in dir open: unnamed ("#123 (deleted)") or not.
bool HoldsTemporary(pid_t pid, const fs::path& dir) {
    std::error_code ec;
    for (const auto& e : fs::directory_iterator("/proc/" + std::to_string(pid) + "/fd", ec)) {
        const fs::path target = fs::read_symlink(e.path(), ec);
        const std::string name = target.filename().string();
        if (!ec && target.parent_path() == dir && (name[0] == '#' || name.find(".tmp") != std::string::npos))
            return true;
    }
    return false;
}

}  // namespace

TEST(FileGuardCli, FormatLeavesASaveThatAnotherProgramMadeMeanwhile) {
    if (std::system("strace -f -o /dev/null -e trace=fsync true >/dev/null 2>&1") != 0)
        GTEST_SKIP() << "strace cannot trace here";
    const fs::path dir = fs::temp_directory_path() / "mudsetup-format-race";
    fs::remove_all(dir);
    fs::create_directories(dir);
    const fs::path file = dir / "a.setup";
    std::ofstream(file) << "MUD_TRANSPORT_MODULE {\n  mode = 2\n}\n";
    const std::string theirs = "MUD_TRANSPORT_MODULE {\n    mode = 1\n}\n";

    const pid_t tracer = ::fork();
    if (tracer == 0) {
        const std::string err = (dir / "err").string();
        if (!std::freopen(err.c_str(), "w", stderr))
            ::_exit(127);
        // LeakSanitizer stops the process's threads by ptrace, which a traced process cannot.
        ::setenv("ASAN_OPTIONS", "detect_leaks=0", 1);
        ::execlp("strace", "strace", "-f", "-o", "/dev/null", "-e", "trace=fsync",
                 "-e", "inject=fsync:signal=SIGSTOP:when=1", MUDSETUP_EXE, "format",
                 file.c_str(), static_cast<char*>(nullptr));
        ::_exit(127);
    }
    // Stopped while its temporary is open: the file has been read, nothing renamed yet.
    auto stopped = [&](pid_t pid) {
        const char state = State(pid);
        return (state == 't' || state == 'T') && HoldsTemporary(pid, dir);
    };
    // strace's first children only probe what the kernel offers: the last one is format.
    pid_t format = 0;
    bool done = false;
    struct Reap {
        pid_t& format;
        pid_t tracer;
        bool& done;
        ~Reap() {
            if (done)
                return;
            if (format > 0)
                ::kill(format, SIGKILL);
            ::kill(tracer, SIGKILL);
            ::waitpid(tracer, nullptr, 0);
        }
    } reap{format, tracer, done};
    for (int i = 0; i < 20000 && !(format && stopped(format)); ++i) {
        if (const pid_t child = ChildOf(tracer))
            format = child;
        ::usleep(1000);
    }
    ASSERT_TRUE(format && stopped(format));
    std::ofstream(dir / "theirs") << theirs;
    fs::rename(dir / "theirs", file);
    // The stop may still be on its way: continue format until it is done.
    int status = 0;
    while (::waitpid(tracer, &status, WNOHANG) == 0) {
        ::kill(format, SIGCONT);
        ::usleep(10000);
    }
    done = true;
    ASSERT_TRUE(WIFEXITED(status));
    EXPECT_EQ(WEXITSTATUS(status), 2);
    EXPECT_EQ(Slurp(file), theirs);
    EXPECT_NE(Slurp(dir / "err").find("cannot write '" + file.string() +
                                      "': another program changed it since it was read; "
                                      "nothing was written"),
              std::string::npos)
        << Slurp(dir / "err");
    fs::remove_all(dir);
}
