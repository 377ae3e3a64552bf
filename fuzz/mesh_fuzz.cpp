// Any text as a .2dm mesh: it is read or refused with a message, never crashes, and a mesh
// that is read names only nodes it has; indexing and drawing it stay inside their buffers.
#include "mesh/MeshRaster.h"
#include "mesh/MeshReader.h"

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <string_view>
#include <vector>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string_view text(reinterpret_cast<const char*>(data), size);
    const MeshReadResult r = Read2dm(text, "fuzz.2dm");
    if (!r.mesh) {
        if (r.error.empty()) {
            std::fprintf(stderr, "refused without a message\n");
            std::abort();
        }
        return 0;
    }
    const CMesh& m = *r.mesh;
    const auto bad = [&](int n) { return n < 0 || static_cast<size_t>(n) >= m.NodeCount(); };
    for (const CMesh::Element& e : m.elements)
        for (int i = 0; i < CMesh::Corners(e); ++i)
            if (bad(e[i]))
                std::abort();
    for (const MeshBoundary& b : m.boundaries)
        for (int n : b.nodes)
            if (bad(n))
                std::abort();
    if (!m.zMissing.empty() && m.zMissing.size() != m.NodeCount())
        std::abort();
    for (const std::string& note : m.notes)
        if (note.empty())
            std::abort();
    const CMeshIndex index(m);
    const MeshExtent& ext = m.Extent();
    index.ElementAt((ext.xMin + ext.xMax) / 2, (ext.yMin + ext.yMax) / 2);
    const double w = ext.xMax - ext.xMin, h = ext.yMax - ext.yMin;
    RasterView view{ext.xMin, ext.yMax, std::max({w, h, 1e-6}) / 32, 32, 32};
    if (!std::isfinite(view.pixel) || view.pixel <= 0)
        return 0;
    std::vector<uint32_t> buffer(32 * 32);
    RasteriseMesh(index, ElementColours(m), view, buffer.data());
    return 0;
}
