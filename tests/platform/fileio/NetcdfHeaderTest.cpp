// The look at a netCDF header before the library opens the file: every count, size and
// offset must fit within the file, so a corrupt header is refused before nc_open.
#include "fileio/NetcdfHeader.h"
#include "mesh/MeshReader.h"
#include "platform/mesh/UgridTestFile.h"

#include <netcdf.h>
#include <netcdf_mem.h>

#include <gtest/gtest.h>

#include <cstdint>
#include <filesystem>
#include <fstream>
#include <sstream>
#include <vector>

namespace fs = std::filesystem;

namespace {

// A classic file field by field: dimension "node", a global text attribute "title" and a
// double variable "x(node)" after the header; each field can be spoilt on its own.
struct Classic {
    std::uint32_t numrecs = 0, dims = 1, nameLength = 4, dimLength = 4, attValues = 2;
    std::uint32_t vars = 1, rank = 1, dimId = 0, type = 6, vsize = 32;
    std::int64_t begin = -1;  // -1: right after the header

    std::string Bytes() const {
        std::string b = std::string("CDF\x01", 4);
        auto u32 = [&b](std::uint32_t v) {
            for (int s = 24; s >= 0; s -= 8)
                b += static_cast<char>((v >> s) & 0xFF);
        };
        auto name = [&](const std::string& n, std::uint32_t length) {
            u32(length);
            b += n;
            b.append((4 - n.size() % 4) % 4, '\0');
        };
        u32(numrecs);
        u32(10), u32(dims), name("node", nameLength), u32(dimLength);
        u32(12), u32(1), name("title", 5), u32(2), u32(attValues), b += "ab", b.append(2, '\0');
        u32(11), u32(vars), name("x", 1), u32(rank), u32(dimId), u32(0), u32(0), u32(type), u32(vsize);
        const std::size_t at = b.size();
        u32(0);
        const auto start = static_cast<std::uint32_t>(begin < 0 ? b.size() : begin);
        b.resize(at);
        u32(start);
        for (int i = 0; i < 4; ++i)
            b.append("\x3f\xf0\0\0\0\0\0\0", 8);  // 1.0
        return b;
    }
};

std::string Problem(const Classic& c) { return fileio::CheckNetcdfHeader(c.Bytes()).problem; }

std::string TempPath(const std::string& name) { return (fs::temp_directory_path() / name).string(); }

std::string Slurp(const std::string& p) {
    std::ifstream in(p, std::ios::binary);
    std::stringstream s;
    s << in.rdbuf();
    return s.str();
}

}  // namespace

TEST(NetcdfHeader, ASoundClassicHeaderPassesAndTheLibraryAgrees) {
    std::string bytes = Classic().Bytes();
    const fileio::NetcdfCheck c = fileio::CheckNetcdfHeader(bytes);
    EXPECT_EQ(c.problem, "");
    EXPECT_EQ(c.format, fileio::NetcdfFormat::Classic);
    int id = 0;
    ASSERT_EQ(nc_open_mem("sound.nc", NC_NOWRITE, bytes.size(), bytes.data(), &id), NC_NOERR);
    nc_close(id);
    // Cut anywhere, the file no longer holds what its header claims.
    for (std::size_t n = 0; n < bytes.size(); ++n)
        EXPECT_NE(fileio::CheckNetcdfHeader(std::string_view(bytes).substr(0, n)).problem, "") << n;
}

TEST(NetcdfHeader, EachFieldThatClaimsMoreThanTheFileHoldsIsRefused) {
    struct Case {
        const char* name;
        void (*spoil)(Classic&);
        const char* problem;
    };
    const Case cases[] = {
        {"records", [](Classic& c) { c.numrecs = 1u << 31; }, "it claims 2147483648 records, more than the file's"},
        {"dimensions", [](Classic& c) { c.dims = 0x7FFFFFFF; }, "it claims 2147483647 dimensions"},
        {"name length", [](Classic& c) { c.nameLength = 1u << 30; }, "a name of 1073741824 bytes"},
        {"attribute values", [](Classic& c) { c.attValues = 0xFFFFFFF0; }, "attribute title claims 4294967280 values"},
        {"variables", [](Classic& c) { c.vars = 1u << 28; }, "it claims 268435456 variables"},
        {"rank", [](Classic& c) { c.rank = 1u << 29; }, "variable x claims 536870912 dimensions"},
        {"dimension id", [](Classic& c) { c.dimId = 7; }, "variable x names dimension 7 of 1"},
        {"dimension length", [](Classic& c) { c.dimLength = 1u << 30; }, "variable x claims more bytes"},
        {"begin", [](Classic& c) { c.begin = 1 << 20; }, "variable x claims 32 bytes from offset 1048576"},
        {"begin in header", [](Classic& c) { c.begin = 8; }, "variable x begins inside the header"},
        {"vsize", [](Classic& c) { c.vsize = 1u << 30; }, "variable x claims a size of 1073741824 bytes"},
        {"type", [](Classic& c) { c.type = 99; }, "variable x has an unknown type 99"},
    };
    for (const Case& k : cases) {
        Classic c;
        k.spoil(c);
        EXPECT_NE(Problem(c).find(k.problem), std::string::npos) << k.name << ": " << Problem(c);
    }
}

// Files the library wrote, in each of its formats, pass; spoilt, they are refused by the
// mesh reader before the library sees them.
TEST(NetcdfHeader, FilesOfEveryFormatPassAndSpoiltOnesNeverReachTheLibrary) {
    const struct {
        int mode;
        fileio::NetcdfFormat format;
    } formats[] = {
        {NC_CLOBBER, fileio::NetcdfFormat::Classic},
        {NC_CLOBBER | NC_64BIT_OFFSET, fileio::NetcdfFormat::Offset64},
        {NC_CLOBBER | NC_64BIT_DATA, fileio::NetcdfFormat::Data64},
        {NC_CLOBBER | NC_NETCDF4, fileio::NetcdfFormat::Hdf5},
    };
    const std::string path = TempPath("mudsetup-header.nc");
    for (const auto& f : formats) {
        int nc = 0, dim = 0, var = 0;
        ASSERT_EQ(nc_create(path.c_str(), f.mode, &nc), NC_NOERR);
        nc_def_dim(nc, "n", 3, &dim);
        nc_def_var(nc, "v", NC_DOUBLE, 1, &dim, &var);
        const double v[3] = {1, 2, 3};
        nc_enddef(nc);
        nc_put_var_double(nc, var, v);
        ASSERT_EQ(nc_close(nc), NC_NOERR);
        fileio::NetcdfCheck check;
        EXPECT_FALSE(fileio::PrecheckNetcdf(path, &check)) << check.problem;
        EXPECT_EQ(check.format, f.format);
    }
    // A netCDF-4 file cut short: the superblock says where the file ended.
    const std::string whole = Slurp(path);
    std::ofstream(path, std::ios::binary | std::ios::trunc) << whole.substr(0, whole.size() / 2);
    const auto cut = fileio::PrecheckNetcdf(path);
    ASSERT_TRUE(cut);
    EXPECT_NE(cut->reason.find("its HDF5 superblock claims " + std::to_string(whole.size()) + " bytes"),
              std::string::npos)
        << cut->reason;

    // One byte of a mesh's dimension count changed.
    testsupport::UgridSpec s;
    s.x = {0, 10, 0};
    s.y = {0, 0, 10};
    s.faces = {0, 1, 2};
    ASSERT_TRUE(testsupport::WriteUgrid(path, s));
    ASSERT_TRUE(ReadMeshFile(path).mesh);
    std::string bytes = Slurp(path);
    bytes[12] = '\x7F';
    std::ofstream(path, std::ios::binary | std::ios::trunc) << bytes;
    const std::string size = fileio::FormatSize(static_cast<std::int64_t>(bytes.size()));
    EXPECT_EQ(ReadMeshFile(path).error,
              path + ": is not a valid netCDF file: it claims 2130706435 dimensions, more than the file's " +
                  size + " hold");
    std::remove(path.c_str());
}
