// A uniform grid over the mesh that finds the elements in a rectangle without looking at
// the others: each element sits in the cell of its centre, and a query widens the
// rectangle by the largest element's half size. Built in one pass over the elements.
#pragma once

#include "Mesh.h"

#include <cstdint>

class CMeshIndex {
public:
    explicit CMeshIndex(const CMesh& mesh);

    const CMesh& Mesh() const { return m_mesh; }
    // Calls visit(element index) for every element whose box may meet the rectangle (and a
    // few near it).
    template <class Visit>
    void ForEach(double x0, double y0, double x1, double y1, Visit&& visit) const {
        int c0, r0, c1, r1;
        if (!Cells(x0, y0, x1, y1, c0, r0, c1, r1))
            return;
        for (int r = r0; r <= r1; ++r) {
            const size_t row = static_cast<size_t>(r) * static_cast<size_t>(m_cols);
            for (size_t i = m_start[row + static_cast<size_t>(c0)];
                 i < m_start[row + static_cast<size_t>(c1) + 1]; ++i)
                visit(static_cast<int>(m_items[i]));
        }
    }
    // How many elements ForEach would visit, from the cell counts alone.
    size_t CountIn(double x0, double y0, double x1, double y1) const;
    // The element that holds the point, or -1.
    int ElementAt(double x, double y) const;

private:
    bool Cells(double x0, double y0, double x1, double y1, int& c0, int& r0, int& c1, int& r1) const;

    const CMesh& m_mesh;
    double m_x0 = 0, m_y0 = 0, m_cell = 1;
    int m_cols = 1, m_rows = 1;
    double m_halfW = 0, m_halfH = 0;
    std::vector<uint32_t> m_start;  // per cell, the first of its items; one more at the end
    std::vector<uint32_t> m_items;  // element indices, cell by cell
};

// Whether the point lies in the element (its edges included).
bool ElementContains(const CMesh& mesh, int element, double x, double y);
