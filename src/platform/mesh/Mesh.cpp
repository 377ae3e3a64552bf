#include "Mesh.h"

#include <algorithm>

size_t CMesh::TriangleCount() const {
    return static_cast<size_t>(
        std::count_if(elements.begin(), elements.end(), [](const Element& e) { return e[3] < 0; }));
}

void CMesh::Finish() {
    m_extent = {};
    m_missing = 0;
    if (!zMissing.empty() && zMissing.size() != z.size())
        zMissing.resize(z.size(), 1);
    if (x.empty())
        return;
    const auto [xl, xh] = std::minmax_element(x.begin(), x.end());
    const auto [yl, yh] = std::minmax_element(y.begin(), y.end());
    m_extent = {*xl, *xh, *yl, *yh, 0, 0};
    if (zMissing.empty()) {
        const auto [zl, zh] = std::minmax_element(z.begin(), z.end());
        m_extent.zMin = *zl, m_extent.zMax = *zh;
        return;
    }
    bool any = false;
    for (size_t i = 0; i < z.size(); ++i) {
        if (zMissing[i]) {
            ++m_missing;
            continue;
        }
        m_extent.zMin = any ? std::min(m_extent.zMin, z[i]) : z[i];
        m_extent.zMax = any ? std::max(m_extent.zMax, z[i]) : z[i];
        any = true;
    }
}
