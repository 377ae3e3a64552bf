// One guarded way to read and write every file of the product. Readers open without
// blocking (a FIFO would wait for a writer), take regular files only and check the size
// before reading; writers replace only a regular file or a new name, atomically.
#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace fileio {

// Which file was read, to tell later whether another program replaced or changed it.
struct FileIdentity {
    std::uint64_t device = 0, inode = 0;
    std::int64_t size = -1;  // -1: nothing known
    std::int64_t modifiedNs = 0;
    bool Known() const { return size >= 0; }
    friend bool operator==(const FileIdentity&, const FileIdentity&) = default;
};

// What a reader takes: "mesh files" read up to maxBytes.
struct FileKind {
    const char* plural;
    std::int64_t maxBytes;
};

inline constexpr std::int64_t kGB = std::int64_t(1) << 30;
inline constexpr FileKind kSetupFiles{"setup files", 0x7FFFFFFE};
inline constexpr FileKind kMeshFiles{"mesh files", 0x7FFFFFFE};
// netCDF files are handed to the library, which reads only what is asked for.
inline constexpr FileKind kNetcdfFiles{"netCDF files", 256 * kGB};
// Values are read in blocks, so size costs time only.
inline constexpr FileKind kDataFiles{"data files", 256 * kGB};
inline constexpr FileKind kPointFiles{"point files", kGB};
inline constexpr FileKind kCsvFiles{"CSV files", kGB};

// Why a file was not read or written. err is the errno (EISDIR for a folder, 0 for a file
// of the wrong kind or size); reason says it after the file's name: "is a folder",
// "is not a regular file (a FIFO)", "is 3.0 GB; mesh files are read up to 2.0 GB".
struct Failure {
    int err = 0;
    std::string reason;
    // reason where it describes the file, else the system's text ("No such file or
    // directory"), as paths are reported by the setup reader and the writers.
    std::string SystemText() const;
    // "does not exist", "cannot be opened: Permission denied" or reason.
    std::string Text() const;
};

// "3.0 GB", "12.5 MB", "900 bytes".
std::string FormatSize(std::int64_t bytes);

// A file open for reading; closed with the object.
class InFile {
public:
    InFile() = default;
    ~InFile();
    InFile(InFile&& other) noexcept;
    InFile& operator=(InFile&& other) noexcept;
    InFile(const InFile&) = delete;
    InFile& operator=(const InFile&) = delete;

    // Opens without blocking and without taking a terminal, checks that it is a regular file
    // of at most kind.maxBytes, then reads block as usual.
    std::optional<Failure> Open(const std::string& path, const FileKind& kind);
    bool IsOpen() const { return m_fd >= 0; }
    // Up to n bytes (fewer only at the end); -1 on a read error (errno set).
    std::ptrdiff_t Read(void* buffer, std::size_t n);
    // n bytes at offset; false on a short read or an error.
    bool ReadAt(std::int64_t offset, void* buffer, std::size_t n);
    std::int64_t Size() const { return m_identity.size; }
    const FileIdentity& Identity() const { return m_identity; }
    void Close();

private:
    int m_fd = -1;
    FileIdentity m_identity;
};

// The whole file into text; at most kind.maxBytes are held even when the file grows.
std::optional<Failure> ReadWholeFile(const std::string& path, const FileKind& kind,
                                     std::string& text, FileIdentity* identity = nullptr);

// The identity of the file a name stands for now (links followed); unknown when none.
FileIdentity IdentityOf(const std::string& path);

// Replaces a file atomically: the content goes to an unnamed file beside the target (a
// named ".NAME.tmpPID_N" where the file system has none), which is linked in and renamed
// over the target only when everything was written and flushed. A symbolic link's target is
// written; only a regular file or a new name is replaced. Temporaries of saves that died are
// removed. A full file system or a file-size limit (EFBIG) fails the write, the target
// untouched.
class AtomicWriter {
public:
    AtomicWriter() = default;
    ~AtomicWriter();  // abandons what was not committed
    AtomicWriter(const AtomicWriter&) = delete;
    AtomicWriter& operator=(const AtomicWriter&) = delete;

    // expected: the identity the target had when it was read; when the target then differs
    // (another program saved it meanwhile), Commit writes nothing and Changed() is true.
    std::optional<Failure> Open(const std::string& path, const FileIdentity* expected = nullptr);
    std::optional<Failure> Write(std::string_view data);
    std::optional<Failure> Commit();
    bool Changed() const { return m_changed; }
    // The identity of the file written, after Commit.
    const FileIdentity& Written() const { return m_written; }

private:
    void Abandon();

    int m_fd = -1;
    bool m_unnamed = false, m_changed = false;
    std::string m_path, m_dir, m_base, m_tmp;
    FileIdentity m_expected, m_written;
    std::optional<Failure> m_failed;
};

inline constexpr const char* kChangedReason =
    "another program changed it since it was read; nothing was written";

// The whole text at once, as AtomicWriter. On failure error is "cannot write 'PATH': why";
// changed (when given) tells that the target differed from expected.
bool WriteFileAtomic(const std::string& path, std::string_view text, std::string* error,
                     const FileIdentity* expected = nullptr, bool* changed = nullptr,
                     FileIdentity* written = nullptr);

}  // namespace fileio
