// Any bytes as a netCDF file: the header check never crashes and never reads outside the
// bytes; a classic file it accepts, the library opens in bounded memory (the run's
// -rss_limit_mb and -malloc_limit_mb catch a header that still claims gigabytes).
#include "fileio/NetcdfHeader.h"

#include <netcdf.h>
#include <netcdf_mem.h>

#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <string>
#include <vector>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string_view bytes(reinterpret_cast<const char*>(data), size);
    const fileio::NetcdfCheck check = fileio::CheckNetcdfHeader(bytes);
    if (check.size != static_cast<std::int64_t>(size))
        std::abort();
    const bool classic = check.format == fileio::NetcdfFormat::Classic ||
                         check.format == fileio::NetcdfFormat::Offset64 ||
                         check.format == fileio::NetcdfFormat::Data64;
    if (!classic || !check.problem.empty())
        return 0;
    std::vector<char> copy(bytes.begin(), bytes.end());
    int id = 0;
    if (nc_open_mem("fuzz.nc", NC_NOWRITE, copy.size(), copy.data(), &id) == NC_NOERR)
        nc_close(id);
    return 0;
}
