// A cheap look at a netCDF file before the library opens it. The library trusts the counts
// and sizes of a header and allocates by them, so a file of a few bytes can claim gigabytes.
// Classic, 64-bit-offset and 64-bit-data headers are short and published: every count, size
// and offset they hold must fit within the file. Of an HDF5-based (netCDF-4) file the
// signature and the superblock's end-of-file address are checked.
#pragma once

#include "fileio/GuardedFile.h"

#include <cstdint>
#include <functional>
#include <string>
#include <string_view>

namespace fileio {

enum class NetcdfFormat { Unknown, Classic, Offset64, Data64, Hdf5 };

struct NetcdfCheck {
    NetcdfFormat format = NetcdfFormat::Unknown;
    std::int64_t size = 0;  // bytes in the file
    std::string problem;    // empty when the header fits the file
};

// n bytes at offset into buffer; false where the file has fewer.
using ReadBytes = std::function<bool(std::int64_t offset, void* buffer, std::size_t n)>;

// The header of a file of size bytes, read through read.
NetcdfCheck CheckNetcdfHeader(const ReadBytes& read, std::int64_t size);
NetcdfCheck CheckNetcdfHeader(std::string_view bytes);

// Opens path as any reader does (regular file, size) and checks its header; a failure says
// why the file must not be handed to the library ("is not a valid netCDF file: ...").
std::optional<Failure> PrecheckNetcdf(const std::string& path, NetcdfCheck* check = nullptr);

}  // namespace fileio
