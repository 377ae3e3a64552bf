#include "fileio/GuardedFile.h"

#include <atomic>
#include <cerrno>
#include <charconv>
#include <cstdio>
#include <cstring>

#include <dirent.h>
#include <fcntl.h>
#include <signal.h>
#include <sys/stat.h>
#include <unistd.h>

namespace fileio {

namespace {

Failure FromErrno(int err) { return Failure{err, {}}; }

FileIdentity IdentityOfStat(const struct stat& st) {
    FileIdentity id;
    id.device = static_cast<std::uint64_t>(st.st_dev);
    id.inode = static_cast<std::uint64_t>(st.st_ino);
    id.size = static_cast<std::int64_t>(st.st_size);
    id.modifiedNs = static_cast<std::int64_t>(st.st_mtim.tv_sec) * 1000000000 + st.st_mtim.tv_nsec;
    return id;
}

const char* WhatItIs(mode_t mode) {
    if (S_ISFIFO(mode))
        return "a FIFO";
    if (S_ISCHR(mode))
        return "a character device";
    if (S_ISBLK(mode))
        return "a block device";
    if (S_ISSOCK(mode))
        return "a socket";
    return "neither a file nor a folder";
}

// Anything but a regular file, said as what it is.
Failure NotRegular(mode_t mode) {
    if (S_ISDIR(mode))
        return Failure{EISDIR, "is a folder"};
    return Failure{0, std::string("is not a regular file (") + WhatItIs(mode) + ")"};
}

Failure TooLarge(std::int64_t size, const FileKind& kind) {
    return Failure{0, "is " + FormatSize(size) + "; " + kind.plural + " are read up to " +
                          FormatSize(kind.maxBytes)};
}

}  // namespace

std::string Failure::SystemText() const {
    return reason.empty() ? std::string(std::strerror(err)) : reason;
}

std::string Failure::Text() const {
    if (!reason.empty())
        return reason;
    if (err == ENOENT)
        return "does not exist";
    return std::string("cannot be read: ") + std::strerror(err);
}

std::string FormatSize(std::int64_t bytes) {
    static const char* const units[] = {"KB", "MB", "GB", "TB"};
    if (bytes < 1024)
        return std::to_string(bytes) + " bytes";
    double v = static_cast<double>(bytes) / 1024;
    int u = 0;
    for (; v >= 1024 && u < 3; ++u)
        v /= 1024;
    char buf[32];
    std::snprintf(buf, sizeof buf, "%.1f %s", v, units[u]);
    return buf;
}

// --- reading ---------------------------------------------------------------------------

InFile::~InFile() { Close(); }

InFile::InFile(InFile&& other) noexcept : m_fd(other.m_fd), m_identity(other.m_identity) {
    other.m_fd = -1;
}

InFile& InFile::operator=(InFile&& other) noexcept {
    if (this != &other) {
        Close();
        m_fd = other.m_fd;
        m_identity = other.m_identity;
        other.m_fd = -1;
    }
    return *this;
}

void InFile::Close() {
    if (m_fd >= 0)
        ::close(m_fd);
    m_fd = -1;
}

std::optional<Failure> InFile::Open(const std::string& path, const FileKind& kind) {
    Close();
    const int fd = ::open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK | O_NOCTTY);
    if (fd < 0)
        return FromErrno(errno);
    struct stat st {};
    std::optional<Failure> failure;
    if (::fstat(fd, &st) != 0)
        failure = FromErrno(errno);
    else if (!S_ISREG(st.st_mode))
        failure = NotRegular(st.st_mode);
    else if (st.st_size > kind.maxBytes)
        failure = TooLarge(st.st_size, kind);
    else if (const int flags = ::fcntl(fd, F_GETFL);
             flags < 0 || ::fcntl(fd, F_SETFL, flags & ~O_NONBLOCK) != 0)
        failure = FromErrno(errno);
    if (failure) {
        ::close(fd);
        return failure;
    }
    m_fd = fd;
    m_identity = IdentityOfStat(st);
    return std::nullopt;
}

std::ptrdiff_t InFile::Read(void* buffer, std::size_t n) {
    char* p = static_cast<char*>(buffer);
    std::size_t got = 0;
    while (got < n) {
        const ssize_t r = ::read(m_fd, p + got, n - got);
        if (r < 0 && errno == EINTR)
            continue;
        if (r < 0)
            return -1;
        if (r == 0)
            break;
        got += static_cast<std::size_t>(r);
    }
    return static_cast<std::ptrdiff_t>(got);
}

bool InFile::ReadAt(std::int64_t offset, void* buffer, std::size_t n) {
    char* p = static_cast<char*>(buffer);
    std::size_t got = 0;
    while (got < n) {
        const ssize_t r = ::pread(m_fd, p + got, n - got, static_cast<off_t>(offset) + static_cast<off_t>(got));
        if (r < 0 && errno == EINTR)
            continue;
        if (r <= 0)
            return false;
        got += static_cast<std::size_t>(r);
    }
    return true;
}

std::optional<Failure> ReadWholeFile(const std::string& path, const FileKind& kind,
                                     std::string& text, FileIdentity* identity) {
    InFile in;
    if (auto failure = in.Open(path, kind))
        return failure;
    text.clear();
    text.reserve(static_cast<std::size_t>(in.Size()));
    char buf[65536];
    for (;;) {
        const std::ptrdiff_t n = in.Read(buf, sizeof buf);
        if (n < 0)
            return FromErrno(errno);
        if (n == 0)
            break;
        text.append(buf, static_cast<std::size_t>(n));
        // A file that grows while it is read is held only up to the limit.
        if (static_cast<std::int64_t>(text.size()) > kind.maxBytes)
            return TooLarge(static_cast<std::int64_t>(text.size()), kind);
    }
    if (identity)
        *identity = in.Identity();
    return std::nullopt;
}

FileIdentity IdentityOf(const std::string& path) {
    struct stat st {};
    if (::stat(path.c_str(), &st) != 0 || !S_ISREG(st.st_mode))
        return {};
    return IdentityOfStat(st);
}

// --- writing ---------------------------------------------------------------------------

namespace {

// The file a save replaces: symbolic links followed to the file they name. A failure for a
// name that holds anything but a regular file.
std::optional<Failure> ResolveTarget(std::string& path) {
    for (int hops = 0;; ++hops) {
        struct stat st {};
        if (::lstat(path.c_str(), &st) != 0) {
            if (errno == ENOENT)
                return std::nullopt;  // a new name
            return FromErrno(errno);
        }
        if (S_ISREG(st.st_mode))
            return std::nullopt;
        if (!S_ISLNK(st.st_mode))
            return NotRegular(st.st_mode);
        if (hops == 40)
            return FromErrno(ELOOP);
        std::string target(static_cast<std::size_t>(st.st_size > 0 ? st.st_size : 255) + 1, '\0');
        const ssize_t n = ::readlink(path.c_str(), target.data(), target.size());
        if (n < 0)
            return FromErrno(errno);
        target.resize(static_cast<std::size_t>(n));
        const std::size_t slash = path.rfind('/');
        if (!target.empty() && target[0] != '/' && slash != std::string::npos)
            target = path.substr(0, slash + 1) + target;
        path = std::move(target);
    }
}

// Temporaries of saves killed before they finished: ".NAME.tmpPID_N" of processes gone.
void RemoveStaleTemporaries(const std::string& dir, const std::string& base) {
    DIR* d = ::opendir(dir.empty() ? "." : dir.c_str());
    if (!d)
        return;
    const std::string prefix = "." + base + ".tmp";
    while (const dirent* e = ::readdir(d)) {
        const std::string_view name(e->d_name);
        if (name.size() <= prefix.size() || name.substr(0, prefix.size()) != prefix)
            continue;
        const std::string_view rest = name.substr(prefix.size());
        long pid = 0;
        const auto [end, ec] = std::from_chars(rest.data(), rest.data() + rest.size(), pid);
        if (ec != std::errc() || end == rest.data() + rest.size() || *end != '_' || pid <= 0)
            continue;
        bool digits = end + 1 < rest.data() + rest.size();
        for (const char* c = end + 1; c < rest.data() + rest.size(); ++c)
            digits = digits && *c >= '0' && *c <= '9';
        if (!digits || pid == ::getpid())
            continue;
        if (::kill(static_cast<pid_t>(pid), 0) != 0 && errno == ESRCH)
            ::unlink((dir + std::string(name)).c_str());
    }
    ::closedir(d);
}

std::atomic<unsigned> g_counter{0};

}  // namespace

AtomicWriter::~AtomicWriter() { Abandon(); }

void AtomicWriter::Abandon() {
    if (m_fd >= 0)
        ::close(m_fd);
    m_fd = -1;
    if (!m_tmp.empty())
        ::unlink(m_tmp.c_str());
    m_tmp.clear();
}

std::optional<Failure> AtomicWriter::Open(const std::string& path, const FileIdentity* expected) {
    Abandon();
    m_changed = false;
    m_failed.reset();
    m_written = {};
    m_expected = expected ? *expected : FileIdentity{};
    m_path = path;
    if (auto failure = ResolveTarget(m_path))
        return m_failed = failure;
    // The temporary lives beside the target: rename is atomic only within one file system.
    const std::size_t slash = m_path.rfind('/');
    m_dir = slash == std::string::npos ? std::string() : m_path.substr(0, slash + 1);
    m_base = slash == std::string::npos ? m_path : m_path.substr(slash + 1);
    RemoveStaleTemporaries(m_dir, m_base);
    // Unnamed until complete, so that a process killed while writing leaves nothing.
    m_fd = ::open(m_dir.empty() ? "." : m_dir.c_str(), O_TMPFILE | O_WRONLY | O_CLOEXEC, 0666);
    m_unnamed = m_fd >= 0;
    for (int attempt = 0; m_fd < 0; ++attempt) {
        m_tmp = m_dir + "." + m_base + ".tmp" + std::to_string(::getpid()) + "_" +
                std::to_string(g_counter++);
        m_fd = ::open(m_tmp.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, 0666);
        if (m_fd < 0 && (errno != EEXIST || attempt == 100)) {
            const int err = errno;
            m_tmp.clear();
            return m_failed = FromErrno(err);
        }
    }
    struct stat st {};
    if (::stat(m_path.c_str(), &st) == 0 && S_ISREG(st.st_mode))
        ::fchmod(m_fd, st.st_mode & 07777);  // keep the target's permissions
    return std::nullopt;
}

std::optional<Failure> AtomicWriter::Write(std::string_view data) {
    if (m_failed)
        return m_failed;
    if (m_fd < 0)
        return m_failed = FromErrno(EBADF);
    const char* p = data.data();
    std::size_t left = data.size();
    while (left > 0) {
        // SIGXFSZ is ignored by the programs, so a file-size limit shows here as EFBIG.
        const ssize_t n = ::write(m_fd, p, left);
        if (n < 0 && errno == EINTR)
            continue;
        if (n < 0) {
            m_failed = FromErrno(errno);
            Abandon();
            return m_failed;
        }
        p += n;
        left -= static_cast<std::size_t>(n);
    }
    return std::nullopt;
}

std::optional<Failure> AtomicWriter::Commit() {
    if (m_failed)
        return m_failed;
    if (m_fd < 0)
        return m_failed = FromErrno(EBADF);
    auto fail = [&](int err) {
        m_failed = FromErrno(err);
        Abandon();
        return m_failed;
    };
    if (::fsync(m_fd) != 0)
        return fail(errno);
    struct stat written {};
    if (::fstat(m_fd, &written) != 0)
        return fail(errno);
    if (m_unnamed) {
        const std::string self = "/proc/self/fd/" + std::to_string(m_fd);
        for (int attempt = 0;; ++attempt) {
            m_tmp = m_dir + "." + m_base + ".tmp" + std::to_string(::getpid()) + "_" +
                    std::to_string(g_counter++);
            if (::linkat(AT_FDCWD, self.c_str(), AT_FDCWD, m_tmp.c_str(), AT_SYMLINK_FOLLOW) == 0)
                break;
            if (errno != EEXIST || attempt == 100) {
                const int err = errno;
                m_tmp.clear();
                return fail(err);
            }
        }
    }
    const int closed = ::close(m_fd);
    m_fd = -1;
    if (closed != 0)
        return fail(errno);
    // Another program's save between the read and now is not replaced. (A file removed
    // meanwhile is written again: nothing is lost.)
    if (m_expected.Known()) {
        const FileIdentity now = IdentityOf(m_path);
        if (now.Known() && now != m_expected) {
            m_changed = true;
            Abandon();
            return m_failed = Failure{0, kChangedReason};
        }
    }
    if (::rename(m_tmp.c_str(), m_path.c_str()) != 0)
        return fail(errno);
    m_tmp.clear();
    m_written = IdentityOfStat(written);
    // Best effort: makes the rename itself survive a crash.
    const int dfd = ::open(m_dir.empty() ? "." : m_dir.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
    if (dfd >= 0) {
        ::fsync(dfd);
        ::close(dfd);
    }
    return std::nullopt;
}

bool WriteFileAtomic(const std::string& path, std::string_view text, std::string* error,
                     const FileIdentity* expected, bool* changed, FileIdentity* written) {
    AtomicWriter w;
    std::optional<Failure> failure = w.Open(path, expected);
    if (!failure)
        failure = w.Write(text);
    if (!failure)
        failure = w.Commit();
    if (changed)
        *changed = w.Changed();
    if (failure) {
        if (error)
            *error = "cannot write '" + path + "': " + failure->SystemText();
        return false;
    }
    if (written)
        *written = w.Written();
    return true;
}

}  // namespace fileio
