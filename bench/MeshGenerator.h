// A square mesh of about n triangles as .2dm text, for the benchmarks: nodes on a grid of
// 10 m with a sloping bed, and one open boundary along the bottom edge.
#pragma once

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <string>

inline std::string GridMesh2dm(long elements) {
    const long side = std::max(2L, static_cast<long>(std::sqrt(elements / 2.0)) + 1);
    std::string out = "MESH2D\n";
    out.reserve(static_cast<size_t>(elements) * 60);
    char line[128];
    long id = 0;
    for (long j = 0; j + 1 < side; ++j)
        for (long i = 0; i + 1 < side; ++i) {
            const long a = j * side + i + 1, b = a + 1, c = a + side + 1, d = a + side;
            std::snprintf(line, sizeof line, "E3T %ld %ld %ld %ld 1\nE3T %ld %ld %ld %ld 1\n",
                          id + 1, a, b, c, id + 2, a, c, d);
            out += line;
            id += 2;
        }
    for (long j = 0; j < side; ++j)
        for (long i = 0; i < side; ++i) {
            std::snprintf(line, sizeof line, "ND %ld %.2f %.2f %.3f\n", j * side + i + 1,
                          500000.0 + 10.0 * i, 5900000.0 + 10.0 * j,
                          -20.0 + 22.0 * i / side + std::sin(j * 0.01));
            out += line;
        }
    out += "NS";
    for (long i = 0; i < side; ++i) {
        std::snprintf(line, sizeof line, " %ld", i + 1 == side ? -(i + 1) : i + 1);
        out += line;
    }
    out += " 2 Sea\n";
    return out;
}
