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
    int code = 2;            // 1 is the land boundary; open boundaries count from 2
    std::vector<int> nodes;  // node indices from 0, in order along the boundary
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

    size_t NodeCount() const { return x.size(); }
    size_t ElementCount() const { return elements.size(); }
    size_t TriangleCount() const;
    size_t QuadrilateralCount() const { return ElementCount() - TriangleCount(); }
    static int Corners(const Element& e) { return e[3] < 0 ? 3 : 4; }
    // Computed once when the mesh is complete (Finish).
    const MeshExtent& Extent() const { return m_extent; }
    void Finish();

private:
    MeshExtent m_extent;
};

using MeshPtr = std::shared_ptr<const CMesh>;
