// A flexible mesh as read from a file: nodes with bed levels, triangles and quadrilaterals,
// and the open boundaries as lines of nodes. Immutable once read; the domain shares one
// instance with every view that shows it.
#pragma once

#include <array>
#include <cstddef>
#include <memory>
#include <string>
#include <vector>

struct MeshExtent {
    double xMin = 0, xMax = 0, yMin = 0, yMax = 0, zMin = 0, zMax = 0;
};

struct MeshBoundary {
    std::string name;
    int code = 2;           // 1 is the land boundary; open boundaries count from 2
    std::vector<int> nodes; // node indices from 0, in order along the boundary
};

class CMesh {
public:
    // Node indices from 0; the fourth is -1 for a triangle.
    using Element = std::array<int, 4>;

    std::vector<double> x, y, z;
    std::vector<Element> elements;
    std::vector<MeshBoundary> boundaries;
    // The projection the file states (a registry string), empty when it says none.
    std::string projection;
    // The UGRID topology read (empty for .2dm).
    std::string topology;
    // What reading passed over, converted or did not find, one sentence each.
    std::vector<std::string> notes;
    // Nodes without a bed level (fill values, or none in the file): z is 0 there and left out
    // of the extent. Empty when every node has one.
    std::vector<char> zMissing;

    size_t NodeCount() const { return x.size(); }
    size_t ElementCount() const { return elements.size(); }
    size_t TriangleCount() const;
    size_t QuadrilateralCount() const { return ElementCount() - TriangleCount(); }
    static int Corners(const Element& e) { return e[3] < 0 ? 3 : 4; }
    bool BedLevelMissing(size_t node) const { return !zMissing.empty() && zMissing[node]; }
    size_t MissingBedLevelCount() const { return m_missing; }
    bool HasBedLevel() const { return MissingBedLevelCount() < NodeCount(); }
    // Computed once when the mesh is complete (Finish).
    const MeshExtent& Extent() const { return m_extent; }
    void Finish();

private:
    MeshExtent m_extent;
    size_t m_missing = 0;
};

using MeshPtr = std::shared_ptr<const CMesh>;
