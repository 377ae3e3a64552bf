#include "Mesh.h"

#include <algorithm>

size_t CMesh::TriangleCount() const {
    return static_cast<size_t>(
        std::count_if(elements.begin(), elements.end(), [](const Element& e) { return e[3] < 0; }));
}

void CMesh::Finish() {
    m_extent = {};
    if (x.empty())
        return;
    const auto [xl, xh] = std::minmax_element(x.begin(), x.end());
    const auto [yl, yh] = std::minmax_element(y.begin(), y.end());
    const auto [zl, zh] = std::minmax_element(z.begin(), z.end());
    m_extent = {*xl, *xh, *yl, *yh, *zl, *zh};
}
