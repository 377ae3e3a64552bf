// Headers of data files, kept by path, size and modification time: a validation in which
// many items name the same file reads its header once, and a changed file is read again.
#pragma once

#include "DataFile.h"

#include <cstdint>
#include <memory>
#include <string>

namespace datafile {

// The header of the file at path (read from disk only when the file is new or changed).
// A file that does not exist, a folder or a file that cannot be opened is never kept.
std::shared_ptr<const HeaderResult> CachedHeader(const std::string& path);

// Headers read from disk since the program started.
std::uint64_t HeaderReadCount();
void ClearHeaderCache();

}  // namespace datafile
