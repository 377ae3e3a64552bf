#include "fileio/NetcdfHeader.h"

#include <algorithm>
#include <cstring>
#include <vector>

namespace fileio {

namespace {

constexpr std::uint64_t kStreaming = 0xFFFFFFFF;  // numrecs of a file still being written
enum Tag : std::uint64_t { kAbsent = 0, kDimension = 10, kVariable = 11, kAttribute = 12 };

// Bytes of one value of an external type; 0 for a type the format does not have.
int TypeSize(std::uint64_t type, bool data64) {
    static const int sizes[] = {0, 1, 1, 2, 4, 4, 8, 1, 2, 4, 8, 8};
    if (type == 0 || type > (data64 ? 11u : 6u))
        return 0;
    return sizes[type];
}

struct Bad {
    std::string why;
};

// Reads the header front to back in blocks; every count is checked against what is left
// of the file before anything is sized by it.
class ClassicParser {
public:
    ClassicParser(const ReadBytes& read, std::int64_t size, int version)
        : m_read(read), m_size(static_cast<std::uint64_t>(size)), m_data64(version == 5),
          m_offset64(version != 1) {}

    void Run() {
        m_pos = 4;
        const std::uint64_t numrecs = m_data64 ? U64() : U32();
        if (numrecs != kStreaming && numrecs > m_size)
            Fail("it claims " + std::to_string(numrecs) + " records");
        m_numrecs = numrecs == kStreaming ? 0 : numrecs;
        Dimensions();
        Attributes("global attributes");
        Variables();
        for (const Var& v : m_vars)
            if (v.begin < m_pos)
                Malformed("variable " + v.name + " begins inside the header");
    }

private:
    struct Var {
        std::string name;
        std::uint64_t begin = 0;
    };

    [[noreturn]] void Fail(const std::string& why) const {
        throw Bad{why + ", more than the file's " + FormatSize(static_cast<std::int64_t>(m_size)) +
                  " hold"};
    }
    [[noreturn]] void Malformed(const std::string& why) const { throw Bad{why}; }

    std::uint64_t Left() const { return m_pos <= m_size ? m_size - m_pos : 0; }

    void Bytes(void* out, std::size_t n) {
        if (n > Left())
            Malformed("the file ends inside the header");
        unsigned char* p = static_cast<unsigned char*>(out);
        while (n > 0) {
            if (m_pos < m_blockStart || m_pos >= m_blockStart + m_block.size()) {
                m_blockStart = m_pos;
                m_block.resize(static_cast<std::size_t>(std::min<std::uint64_t>(Left(), 1 << 16)));
                if (!m_read(static_cast<std::int64_t>(m_pos), m_block.data(), m_block.size()))
                    Malformed("the header cannot be read");
            }
            const std::size_t at = static_cast<std::size_t>(m_pos - m_blockStart);
            const std::size_t k = std::min(n, m_block.size() - at);
            std::memcpy(p, m_block.data() + at, k);
            p += k;
            n -= k;
            m_pos += k;
        }
    }
    std::uint64_t U32() {
        unsigned char b[4];
        Bytes(b, 4);
        return (std::uint64_t(b[0]) << 24) | (std::uint64_t(b[1]) << 16) | (std::uint64_t(b[2]) << 8) | b[3];
    }
    std::uint64_t U64() {
        const std::uint64_t hi = U32();
        return (hi << 32) | U32();
    }
    std::uint64_t Count() { return m_data64 ? U64() : U32(); }
    // Skips n bytes padded to a multiple of four.
    void Skip(std::uint64_t n, const std::string& what) {
        const std::uint64_t padded = n + (4 - n % 4) % 4;
        if (n > m_size || padded > Left())
            Fail(what + " of " + std::to_string(n) + " bytes");
        m_pos += padded;
    }
    std::string Name(const char* what) {
        const std::uint64_t n = Count();
        if (n > Left())
            Fail("a name of " + std::to_string(n) + " bytes");
        if (n == 0)
            Malformed(std::string("a ") + what + " has no name");
        std::string s(static_cast<std::size_t>(n), '\0');
        Bytes(s.data(), s.size());
        const std::uint64_t pad = (4 - n % 4) % 4;
        if (pad > Left())
            Malformed("the file ends inside the header");
        m_pos += pad;
        return s;
    }
    // The list's tag and its number of elements, each of which takes at least minBytes.
    std::uint64_t ListCount(Tag tag, std::uint64_t minBytes, const char* what) {
        const std::uint64_t t = U32();
        const std::uint64_t n = Count();
        if (t == kAbsent) {
            if (n != 0)
                Malformed(std::string("the header's list of ") + what + " is malformed");
            return 0;
        }
        if (t != tag)
            Malformed(std::string("the header's list of ") + what + " is malformed");
        if (n > Left() / minBytes)
            Fail("it claims " + std::to_string(n) + " " + what);
        return n;
    }

    void Dimensions() {
        const std::uint64_t w = m_data64 ? 8 : 4;
        const std::uint64_t n = ListCount(kDimension, 2 * w + 4, "dimensions");
        m_dims.reserve(static_cast<std::size_t>(n));
        for (std::uint64_t i = 0; i < n; ++i) {
            Name("dimension");
            const std::uint64_t len = Count();
            m_dims.push_back(len);
            if (len == 0 && m_recordDim < 0)
                m_recordDim = static_cast<std::int64_t>(i);
        }
    }

    void Attributes(const std::string& of) {
        const std::uint64_t w = m_data64 ? 8 : 4;
        const std::uint64_t n = ListCount(kAttribute, 2 * w + 8, ("attributes of " + of).c_str());
        for (std::uint64_t i = 0; i < n; ++i) {
            const std::string name = Name("attribute");
            const std::uint64_t type = U32();
            const int size = TypeSize(type, m_data64);
            if (size == 0)
                Malformed("attribute " + name + " has an unknown type " + std::to_string(type));
            const std::uint64_t count = Count();
            if (count > m_size / static_cast<std::uint64_t>(size))
                Fail("attribute " + name + " claims " + std::to_string(count) + " values");
            Skip(count * static_cast<std::uint64_t>(size), "attribute " + name);
        }
    }

    void Variables() {
        const std::uint64_t w = m_data64 ? 8 : 4;
        const std::uint64_t n = ListCount(kVariable, 3 * w + 12, "variables");
        for (std::uint64_t i = 0; i < n; ++i) {
            Var v;
            v.name = Name("variable");
            const std::uint64_t rank = Count();
            if (rank > Left() / w)
                Fail("variable " + v.name + " claims " + std::to_string(rank) + " dimensions");
            bool record = false;
            std::uint64_t values = 1;
            for (std::uint64_t k = 0; k < rank; ++k) {
                const std::uint64_t id = Count();
                if (id >= m_dims.size())
                    Malformed("variable " + v.name + " names dimension " + std::to_string(id) +
                              " of " + std::to_string(m_dims.size()));
                if (static_cast<std::int64_t>(id) == m_recordDim) {
                    if (k != 0)
                        Malformed("variable " + v.name + " has the record dimension after the first");
                    record = true;
                    continue;
                }
                const std::uint64_t len = m_dims[static_cast<std::size_t>(id)];
                values = len != 0 && values > m_size / len ? m_size + 1 : values * len;
            }
            Attributes("variable " + v.name);
            const std::uint64_t type = U32();
            const int size = TypeSize(type, m_data64);
            if (size == 0)
                Malformed("variable " + v.name + " has an unknown type " + std::to_string(type));
            const std::uint64_t vsize = m_data64 ? U64() : U32();
            v.begin = m_offset64 ? U64() : U32();
            const std::uint64_t bytes =
                values > m_size ? m_size + 1 : values * static_cast<std::uint64_t>(size);
            // A record variable holds one record's values at begin, the next a record further.
            const bool mustFit = !record || m_numrecs > 0;
            if (v.begin > m_size || (mustFit && bytes > m_size - v.begin))
                Fail("variable " + v.name + " claims " +
                     (bytes > m_size ? std::string("more bytes") : std::to_string(bytes) + " bytes") +
                     " from offset " + std::to_string(v.begin));
            // The largest vsize stands for "too large to say" in the older formats.
            if (vsize > m_size && !(vsize == 0xFFFFFFFF && !m_data64))
                Fail("variable " + v.name + " claims a size of " + std::to_string(vsize) + " bytes");
            m_vars.push_back(std::move(v));
        }
    }

    const ReadBytes& m_read;
    const std::uint64_t m_size;
    const bool m_data64, m_offset64;
    std::uint64_t m_pos = 0, m_numrecs = 0;
    std::uint64_t m_blockStart = 0;
    std::vector<unsigned char> m_block;
    std::vector<std::uint64_t> m_dims;
    std::int64_t m_recordDim = -1;
    std::vector<Var> m_vars;
};

std::uint64_t LittleEndian(const unsigned char* p, int n) {
    std::uint64_t v = 0;
    for (int i = n - 1; i >= 0; --i)
        v = (v << 8) | p[i];
    return v;
}

// The superblock's sizes and addresses: the file must hold what it says it holds.
std::string CheckHdf5(const ReadBytes& read, std::int64_t size, std::int64_t at) {
    unsigned char b[96] = {};
    const std::size_t n = static_cast<std::size_t>(std::min<std::int64_t>(size - at, sizeof b));
    if (!read(at, b, n))
        return "the HDF5 superblock cannot be read";
    const int version = b[8];
    int offsets = 0, fields = 0;
    if (version == 0 || version == 1) {
        offsets = b[13];
        fields = version == 0 ? 24 : 28;
    } else if (version == 2 || version == 3) {
        offsets = b[9];
        fields = 12;
    } else {
        return "the HDF5 superblock has an unknown version " + std::to_string(version);
    }
    if (offsets != 2 && offsets != 4 && offsets != 8)
        return "the HDF5 superblock gives addresses of " + std::to_string(offsets) + " bytes";
    if (static_cast<std::size_t>(fields + 4 * offsets) > n)
        return "the HDF5 superblock is cut short";
    const std::uint64_t base = LittleEndian(b + fields, offsets);
    // Versions 0 and 1: base, free space, end of file; 2 and 3: base, extension, end of file.
    const std::uint64_t eof = LittleEndian(b + fields + 2 * offsets, offsets);
    const std::uint64_t usize = static_cast<std::uint64_t>(size);
    if (base > usize || eof > usize - base)
        return "its HDF5 superblock claims " + std::to_string(eof) + " bytes, more than the file's " +
               FormatSize(size) + " hold";
    return {};
}

}  // namespace

NetcdfCheck CheckNetcdfHeader(const ReadBytes& read, std::int64_t size) {
    NetcdfCheck c;
    c.size = size;
    unsigned char magic[8] = {};
    if (size < 4 || !read(0, magic, 4)) {
        c.problem = "it is too short to be a netCDF file";
        return c;
    }
    if (magic[0] == 'C' && magic[1] == 'D' && magic[2] == 'F' &&
        (magic[3] == 1 || magic[3] == 2 || magic[3] == 5)) {
        c.format = magic[3] == 1 ? NetcdfFormat::Classic
                 : magic[3] == 2 ? NetcdfFormat::Offset64
                                 : NetcdfFormat::Data64;
        try {
            ClassicParser(read, size, magic[3]).Run();
        } catch (const Bad& bad) {
            c.problem = bad.why;
        }
        return c;
    }
    // The HDF5 signature stands at 0, 512, 1024, 2048... (a user block may come first).
    static const unsigned char signature[8] = {0x89, 'H', 'D', 'F', '\r', '\n', 0x1a, '\n'};
    for (std::int64_t at = 0; at + 8 <= size; at = at ? at * 2 : 512) {
        if (read(at, magic, 8) && std::memcmp(magic, signature, 8) == 0) {
            c.format = NetcdfFormat::Hdf5;
            c.problem = CheckHdf5(read, size, at);
            return c;
        }
    }
    c.problem = "it is neither a classic netCDF file nor a netCDF-4 (HDF5) file";
    return c;
}

NetcdfCheck CheckNetcdfHeader(std::string_view bytes) {
    const ReadBytes read = [bytes](std::int64_t offset, void* buffer, std::size_t n) {
        if (offset < 0 || static_cast<std::uint64_t>(offset) > bytes.size() ||
            n > bytes.size() - static_cast<std::size_t>(offset))
            return false;
        std::memcpy(buffer, bytes.data() + offset, n);
        return true;
    };
    return CheckNetcdfHeader(read, static_cast<std::int64_t>(bytes.size()));
}

std::optional<Failure> PrecheckNetcdf(const std::string& path, NetcdfCheck* check) {
    InFile in;
    if (auto failure = in.Open(path, kNetcdfFiles))
        return failure;
    const ReadBytes read = [&in](std::int64_t offset, void* buffer, std::size_t n) {
        return in.ReadAt(offset, buffer, n);
    };
    NetcdfCheck c = CheckNetcdfHeader(read, in.Size());
    std::optional<Failure> failure;
    if (!c.problem.empty())
        failure = Failure{0, "is not a valid netCDF file: " + c.problem};
    if (check)
        *check = std::move(c);
    return failure;
}

}  // namespace fileio
