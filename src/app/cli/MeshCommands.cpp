// mesh info: what a mesh file holds, without a setup.
#include "Commands.h"
#include "Json.h"

#include "mesh/MeshReader.h"

#include <charconv>
#include <cmath>
#include <iostream>
#include <memory>

namespace cli {
namespace {

const char* const kMeshHelp =
    "usage: mudsetup mesh info FILE [--json]\n"
    "Reads a mesh (.2dm text, or UGRID netCDF .nc) and prints its numbers of nodes and\n"
    "elements, its extent in x, y and z (\"bed level: none found\" when the file has none, and\n"
    "on how many nodes it is missing), the projection the file states, its open boundaries\n"
    "with their codes and names, and notes on what reading passed over or converted.\n"
    "Exit status: 0 read, 2 unreadable (FILE:LINE: message, or the netCDF error).\n"
    "--json prints one JSON document instead (docs/json.md).\n";

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

// JSON has no nan or infinity.
std::string JsonNumber(double v) { return std::isfinite(v) ? Number(v) : std::string("null"); }

// The reader's "FILE:LINE: message" as a message with its line.
std::string ErrorMessage(const std::string& file, const std::string& error) {
    paramfile::Diagnostic d{file, {}, error};
    if (error.rfind(file + ":", 0) == 0) {
        const char* p = error.c_str() + file.size() + 1;
        int line = 0;
        const auto [end, ec] = std::from_chars(p, error.c_str() + error.size(), line);
        if (ec == std::errc() && end[0] == ':' && end[1] == ' ' && line > 0) {
            d.pos.line = line;
            d.message = end + 2;
        } else if (p[0] == ' ') {
            d.message = p + 1;
        }
    }
    return JsonMessage("error", d);
}

int InfoJson(const std::string& file) {
    const MeshReadResult r = ReadMeshFile(file);
    std::cout << "{\n  \"file\": " << JsonString(file) << ",\n";
    if (!r.mesh) {
        std::cout << "  \"messages\": " << JsonArray({ErrorMessage(file, r.error)}, 2) << "\n}\n";
        FlushStdout();
        return kExitError;
    }
    const CMesh& m = *r.mesh;
    const MeshExtent& e = m.Extent();
    std::vector<std::string> boundaries;
    for (const MeshBoundary& b : m.boundaries)
        boundaries.push_back("{\"name\": " + JsonString(b.name) + ", \"code\": " +
                             std::to_string(b.code) + ", \"nodes\": " +
                             std::to_string(b.nodes.size()) + "}");
    // What reading passed over or converted.
    std::vector<std::string> notes;
    for (const std::string& note : m.notes)
        notes.push_back(JsonMessage("warning", paramfile::Diagnostic{file, {}, note}));
    const bool z = m.HasBedLevel();
    std::cout << "  \"messages\": " << JsonArray(notes, 2) << ",\n"
              << "  \"topology\": " << JsonString(m.topology) << ",\n"
              << "  \"nodes\": " << m.NodeCount() << ",\n"
              << "  \"elements\": " << m.ElementCount() << ",\n"
              << "  \"triangles\": " << m.TriangleCount() << ",\n"
              << "  \"quadrilaterals\": " << m.QuadrilateralCount() << ",\n"
              << "  \"extent\": {\"x_min\": " << JsonNumber(e.xMin) << ", \"x_max\": "
              << JsonNumber(e.xMax) << ", \"y_min\": " << JsonNumber(e.yMin)
              << ", \"y_max\": " << JsonNumber(e.yMax) << ", \"z_min\": "
              << (z ? JsonNumber(e.zMin) : "null") << ", \"z_max\": "
              << (z ? JsonNumber(e.zMax) : "null") << "},\n"
              << "  \"bed_level_missing\": " << (z ? m.MissingBedLevelCount() : m.NodeCount())
              << ",\n"
              << "  \"projection\": " << JsonString(m.projection) << ",\n"
              << "  \"open_boundaries\": " << JsonArray(boundaries, 2) << "\n}\n";
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
    auto json = std::make_shared<bool>(false);
    info->add_flag("--json", *json);
    info->callback([file, json, &status] { status = *json ? InfoJson(*file) : Info(*file); });
}

} // namespace cli
