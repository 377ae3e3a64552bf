#include "MeshRaster.h"

#include <algorithm>
#include <cmath>

uint32_t BedLevelColour(double z, double zMin, double zMax) {
    struct Stop {
        double t;
        int r, g, b;
    };
    // Deep blue through light blue to the waterline, then green to brown on land.
    static const Stop water[] = {
        {0, 8, 29, 88}, {0.5, 34, 94, 168}, {0.8, 65, 182, 196}, {1, 199, 233, 180}};
    static const Stop land[] = {{0, 120, 180, 90}, {1, 140, 100, 60}};
    const Stop* s;
    size_t n;
    double t;
    if (z <= 0 || zMax <= 0) {
        s = water, n = 4;
        const double lo = std::min(zMin, 0.0), hi = std::min(zMax, 0.0);
        t = hi > lo ? (z - lo) / (hi - lo) : 1;
    } else {
        s = land, n = 2;
        const double lo = std::max(zMin, 0.0);
        t = zMax > lo ? (z - lo) / (zMax - lo) : 0;
    }
    t = std::clamp(t, 0.0, 1.0);
    size_t i = 0;
    while (i + 2 < n && t > s[i + 1].t)
        ++i;
    const double f = s[i + 1].t > s[i].t ? (t - s[i].t) / (s[i + 1].t - s[i].t) : 0;
    const auto mix = [f](int a, int b) {
        return static_cast<uint32_t>(std::lround(a + (b - a) * f));
    };
    return 0xff000000u | mix(s[i].r, s[i + 1].r) << 16 | mix(s[i].g, s[i + 1].g) << 8 |
           mix(s[i].b, s[i + 1].b);
}

std::vector<uint32_t> ElementColours(const CMesh& mesh) {
    std::vector<uint32_t> c(mesh.ElementCount());
    const MeshExtent& ext = mesh.Extent();
    for (size_t e = 0; e < c.size(); ++e) {
        const CMesh::Element& el = mesh.elements[e];
        double z = 0;
        bool missing = false;
        const int n = CMesh::Corners(el);
        for (int i = 0; i < n; ++i) {
            z += mesh.z[static_cast<size_t>(el[i])];
            missing = missing || mesh.BedLevelMissing(static_cast<size_t>(el[i]));
        }
        c[e] = missing ? kNoBedLevelColour : BedLevelColour(z / n, ext.zMin, ext.zMax);
    }
    return c;
}

namespace {

// Pixel numbers from coordinates far outside the buffer (or not numbers) stay in range.
int Clamp(double v, int lo, int hi) {
    if (!(v >= lo))
        return lo;
    return v > hi ? hi : static_cast<int>(v);
}

// Fills the pixel centres inside the triangle (pixel coordinates), either orientation.
void FillTriangle(double ax, double ay, double bx, double by, double cx, double cy, uint32_t colour,
                  const RasterView& v, uint32_t* buf) {
    const double area = (bx - ax) * (cy - ay) - (by - ay) * (cx - ax);
    if (area == 0)
        return;
    const double sign = area > 0 ? 1 : -1;
    const double left = std::ceil(std::min({ax, bx, cx}) - 0.5),
                 right = std::floor(std::max({ax, bx, cx}) - 0.5);
    const double top = std::ceil(std::min({ay, by, cy}) - 0.5),
                 bottom = std::floor(std::max({ay, by, cy}) - 0.5);
    if (!(right >= 0 && left < v.width && bottom >= 0 && top < v.height))
        return;
    const int x0 = Clamp(left, 0, v.width - 1), x1 = Clamp(right, 0, v.width - 1);
    const int y0 = Clamp(top, 0, v.height - 1), y1 = Clamp(bottom, 0, v.height - 1);
    for (int y = y0; y <= y1; ++y) {
        const double py = y + 0.5;
        // The span of the row inside all three edges.
        double lo = x0 + 0.5, hi = x1 + 0.5;
        const double ex[3][4] = {{ax, ay, bx, by}, {bx, by, cx, cy}, {cx, cy, ax, ay}};
        bool empty = false;
        for (const auto& e : ex) {
            // sign * ((x2 - x1) * (py - y1) - (y2 - y1) * (px - x1)) >= 0
            const double dy = (e[3] - e[1]) * sign, k = (e[2] - e[0]) * (py - e[1]) * sign;
            if (dy == 0) {
                if (k < 0)
                    empty = true;
                continue;
            }
            const double px = e[0] + k / dy; // where the edge crosses the row
            if (dy > 0)
                hi = std::min(hi, px);
            else
                lo = std::max(lo, px);
        }
        if (empty || lo > hi)
            continue;
        const int a = Clamp(std::ceil(lo - 0.5), x0, x1);
        const int b = Clamp(std::floor(hi - 0.5), x0 - 1, x1);
        uint32_t* row = buf + static_cast<size_t>(y) * static_cast<size_t>(v.width);
        for (int x = a; x <= b; ++x)
            row[x] = colour;
    }
}

} // namespace

void RasteriseMesh(const CMeshIndex& index, const std::vector<uint32_t>& colours,
                   const RasterView& v, uint32_t* buf) {
    const CMesh& m = index.Mesh();
    const double inv = 1 / v.pixel;
    const double xRight = v.xLeft + v.width * v.pixel, yBottom = v.yTop - v.height * v.pixel;
    index.ForEach(v.xLeft, yBottom, xRight, v.yTop, [&](int e) {
        const CMesh::Element& el = m.elements[static_cast<size_t>(e)];
        double px[4], py[4];
        const int n = CMesh::Corners(el);
        double sx = 0, sy = 0;
        for (int i = 0; i < n; ++i) {
            px[i] = (m.x[static_cast<size_t>(el[i])] - v.xLeft) * inv;
            py[i] = (v.yTop - m.y[static_cast<size_t>(el[i])]) * inv;
            sx += px[i], sy += py[i];
        }
        const uint32_t c = colours[static_cast<size_t>(e)];
        FillTriangle(px[0], py[0], px[1], py[1], px[2], py[2], c, v, buf);
        if (n == 4)
            FillTriangle(px[0], py[0], px[2], py[2], px[3], py[3], c, v, buf);
        const double cx = std::floor(sx / n), cy = std::floor(sy / n);
        if (cx >= 0 && cx < v.width && cy >= 0 && cy < v.height)
            buf[static_cast<size_t>(cy) * static_cast<size_t>(v.width) + static_cast<size_t>(cx)] =
                c;
    });
}
