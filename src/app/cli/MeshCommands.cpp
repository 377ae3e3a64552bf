// mesh info: what a mesh file holds, without a setup.
#include "Commands.h"

#include "mesh/MeshReader.h"

#include <charconv>
#include <iostream>
#include <memory>

namespace cli {
namespace {

const char* const kMeshHelp =
    "usage: mudsetup mesh info FILE\n"
    "Reads a mesh (.2dm text, or UGRID netCDF .nc) and prints its numbers of nodes and\n"
    "elements, its extent in x, y and z (\"bed level: none found\" when the file has none, and\n"
    "on how many nodes it is missing), the projection the file states, its open boundaries\n"
    "with their codes and names, and notes on what reading passed over or converted.\n"
    "Exit status: 0 read, 2 unreadable (FILE:LINE: message, or the netCDF error).\n";

// The shortest text that reads back to the same number.
std::string Number(double v) {
    char buf[32];
    const auto [end, ec] = std::to_chars(buf, buf + sizeof buf, v);
    return ec == std::errc() ? std::string(buf, end) : std::string("?");
}

int Info(const std::string& file) {
    const MeshReadResult r = ReadMeshFile(file);
    if (!r.mesh) {
        std::cerr << r.error << "\n";
        return kExitError;
    }
    const CMesh& m = *r.mesh;
    const MeshExtent& e = m.Extent();
    std::cout << "file: " << file << "\n";
    if (!m.topology.empty())
        std::cout << "topology: " << m.topology << "\n";
    std::cout << "nodes: " << m.NodeCount() << "\n"
              << "elements: " << m.ElementCount() << " (" << m.TriangleCount() << " triangles, "
              << m.QuadrilateralCount() << " quadrilaterals)\n"
              << "x: " << Number(e.xMin) << " to " << Number(e.xMax) << "\n"
              << "y: " << Number(e.yMin) << " to " << Number(e.yMax) << "\n";
    if (!m.HasBedLevel())
        std::cout << "bed level: none found\n";
    else
        std::cout << "z: " << Number(e.zMin) << " to " << Number(e.zMax) << "\n";
    if (m.HasBedLevel() && m.MissingBedLevelCount())
        std::cout << "bed level: missing on " << m.MissingBedLevelCount() << " of " << m.NodeCount()
                  << " nodes\n";
    std::cout << "projection: "
              << (m.projection.empty() ? std::string("(not stated)") : m.projection) << "\n"
              << "open boundaries: " << m.boundaries.size() << "\n";
    for (size_t i = 0; i < m.boundaries.size(); ++i) {
        const MeshBoundary& b = m.boundaries[i];
        std::cout << "  " << i + 1 << ": \"" << b.name << "\", code " << b.code << ", "
                  << b.nodes.size() << " nodes\n";
    }
    if (!m.notes.empty())
        std::cout << "notes:\n";
    for (const std::string& note : m.notes)
        std::cout << "  " << note << "\n";
    return FlushStdout() ? kExitOk : kExitError;
}

} // namespace

void AddMeshCommands(CLI::App& app, int& status) {
    auto file = std::make_shared<std::string>();
    CLI::App* mesh = AddCommand(app, "mesh", kMeshHelp);
    mesh->require_subcommand(1);
    CLI::App* info = AddCommand(*mesh, "info", kMeshHelp);
    info->add_option("FILE", *file)
        ->required()
        ->check(CLI::Validator(
            [](std::string& v) {
                return v.empty() ? std::string("must not be empty") : std::string();
            },
            "FILE"));
    info->callback([file, &status] { status = Info(*file); });
}

} // namespace cli
