// Software drawing of a mesh into a pixel buffer, for views where elements are too small to
// draw one by one: every element fills the pixels whose centres it covers, and one pixel at
// its centre at least, so that no element falls between pixels.
#pragma once

#include "MeshIndex.h"

#include <cstdint>

// Colours of bed levels, from deep water to dry land.
uint32_t BedLevelColour(double z, double zMin, double zMax);
// Elements with a node whose bed level is missing.
constexpr uint32_t kNoBedLevelColour = 0xffc8c8c8u;
// One colour per element from the mean bed level of its nodes; no data where any is missing.
std::vector<uint32_t> ElementColours(const CMesh& mesh);

struct RasterView {
    double xLeft = 0, yTop = 0; // world coordinates of the top left corner of the buffer
    double pixel = 1;           // world units per pixel
    int width = 0, height = 0;
};

// Draws the elements that meet the view into buffer (width * height, rows from the top).
void RasteriseMesh(const CMeshIndex& index, const std::vector<uint32_t>& colours,
                   const RasterView& view, uint32_t* buffer);
