// Readers of mesh files: the SMS-style ".2dm" text format and UGRID netCDF (".nc").
// A file that cannot be read gives an error text and no mesh; nothing else happens.
#pragma once

#include "Mesh.h"

#include <string>
#include <string_view>

struct MeshReadResult {
    MeshPtr mesh;       // null when error is set
    std::string error;  // "FILE:LINE: message" for text files, "FILE: message" for netCDF
};

// By content: netCDF (classic, 64-bit offset or HDF5-based) is read as UGRID, anything else
// as .2dm text.
MeshReadResult ReadMeshFile(const std::string& path);
MeshReadResult Read2dm(std::string_view text, const std::string& fileName);
MeshReadResult ReadUgrid(const std::string& path);
