#include "MeshIndex.h"

#include <algorithm>
#include <cmath>

namespace {
void Box(const CMesh& m, const CMesh::Element& e, double& x0, double& y0, double& x1, double& y1) {
    x0 = x1 = m.x[static_cast<size_t>(e[0])];
    y0 = y1 = m.y[static_cast<size_t>(e[0])];
    for (int i = 1; i < CMesh::Corners(e); ++i) {
        const double x = m.x[static_cast<size_t>(e[i])], y = m.y[static_cast<size_t>(e[i])];
        x0 = std::min(x0, x), x1 = std::max(x1, x);
        y0 = std::min(y0, y), y1 = std::max(y1, y);
    }
}
}  // namespace

CMeshIndex::CMeshIndex(const CMesh& mesh) : m_mesh(mesh) {
    const MeshExtent& ext = mesh.Extent();
    const size_t n = mesh.ElementCount();
    const double w = std::max(ext.xMax - ext.xMin, 1e-9), h = std::max(ext.yMax - ext.yMin, 1e-9);
    // About four elements a cell.
    const double cells = std::max(1.0, static_cast<double>(n) / 4.0);
    m_cell = std::sqrt(w * h / cells);
    m_cols = static_cast<int>(std::clamp(w / m_cell + 1, 1.0, 16384.0));
    m_rows = static_cast<int>(std::clamp(h / m_cell + 1, 1.0, 16384.0));
    // A long thin mesh must not make more cells than elements.
    while (static_cast<double>(m_cols) * m_rows > 4.0 * static_cast<double>(n) + 64) {
        if (m_cols >= m_rows)
            m_cols = std::max(1, m_cols / 2);
        else
            m_rows = std::max(1, m_rows / 2);
    }
    m_cell = std::max(w / (m_cols - 0.5), h / (m_rows - 0.5));
    m_x0 = ext.xMin;
    m_y0 = ext.yMin;
    std::vector<uint32_t> cellOf(n);
    m_start.assign(static_cast<size_t>(m_cols) * static_cast<size_t>(m_rows) + 1, 0);
    for (size_t e = 0; e < n; ++e) {
        double x0, y0, x1, y1;
        Box(mesh, mesh.elements[e], x0, y0, x1, y1);
        m_halfW = std::max(m_halfW, (x1 - x0) / 2);
        m_halfH = std::max(m_halfH, (y1 - y0) / 2);
        const int c = static_cast<int>(std::clamp(((x0 + x1) / 2 - m_x0) / m_cell, 0.0, m_cols - 1.0));
        const int r = static_cast<int>(std::clamp(((y0 + y1) / 2 - m_y0) / m_cell, 0.0, m_rows - 1.0));
        cellOf[e] = static_cast<uint32_t>(r) * static_cast<uint32_t>(m_cols) + static_cast<uint32_t>(c);
        ++m_start[cellOf[e] + 1];
    }
    for (size_t i = 1; i < m_start.size(); ++i)
        m_start[i] += m_start[i - 1];
    m_items.resize(n);
    std::vector<uint32_t> fill(m_start.begin(), m_start.end() - 1);
    for (size_t e = 0; e < n; ++e)
        m_items[fill[cellOf[e]]++] = static_cast<uint32_t>(e);
}

bool CMeshIndex::Cells(double x0, double y0, double x1, double y1, int& c0, int& r0, int& c1,
                       int& r1) const {
    if (m_items.empty() || !(x0 <= x1) || !(y0 <= y1))
        return false;
    const double a = (x0 - m_halfW - m_x0) / m_cell, b = (x1 + m_halfW - m_x0) / m_cell;
    const double c = (y0 - m_halfH - m_y0) / m_cell, d = (y1 + m_halfH - m_y0) / m_cell;
    if (b < 0 || a >= m_cols || d < 0 || c >= m_rows)
        return false;
    c0 = static_cast<int>(std::max(a, 0.0));
    c1 = static_cast<int>(std::min(b, m_cols - 1.0));
    r0 = static_cast<int>(std::max(c, 0.0));
    r1 = static_cast<int>(std::min(d, m_rows - 1.0));
    return true;
}

size_t CMeshIndex::CountIn(double x0, double y0, double x1, double y1) const {
    int c0, r0, c1, r1;
    if (!Cells(x0, y0, x1, y1, c0, r0, c1, r1))
        return 0;
    size_t count = 0;
    for (int r = r0; r <= r1; ++r) {
        const size_t row = static_cast<size_t>(r) * static_cast<size_t>(m_cols);
        count += m_start[row + static_cast<size_t>(c1) + 1] - m_start[row + static_cast<size_t>(c0)];
    }
    return count;
}

int CMeshIndex::ElementAt(double x, double y) const {
    int found = -1;
    ForEach(x, y, x, y, [&](int e) {
        if (found < 0 && ElementContains(m_mesh, e, x, y))
            found = e;
    });
    return found;
}

bool ElementContains(const CMesh& m, int element, double x, double y) {
    const CMesh::Element& e = m.elements[static_cast<size_t>(element)];
    const int n = CMesh::Corners(e);
    // Inside a convex or concave ring: an odd number of crossings.
    bool inside = false;
    for (int i = 0, j = n - 1; i < n; j = i++) {
        const double xi = m.x[static_cast<size_t>(e[i])], yi = m.y[static_cast<size_t>(e[i])];
        const double xj = m.x[static_cast<size_t>(e[j])], yj = m.y[static_cast<size_t>(e[j])];
        // On an edge counts as inside.
        const double cross = (xj - xi) * (y - yi) - (yj - yi) * (x - xi);
        if (std::abs(cross) <= 1e-12 * (std::abs(xj - xi) + std::abs(yj - yi)) * (1 + std::abs(x) + std::abs(y)) &&
            x >= std::min(xi, xj) && x <= std::max(xi, xj) && y >= std::min(yi, yj) && y <= std::max(yi, yj))
            return true;
        if ((yi > y) != (yj > y) && x < (xj - xi) * (y - yi) / (yj - yi) + xi)
            inside = !inside;
    }
    return inside;
}
