#pragma once

#include <array>
#include <cstddef>
#include <vector>

#include "lut/io/Lattice.h"

namespace report {

/// Index of a point along red, green and blue; of entry i of a curve, i on all three.
using Point = std::array<int, 3>;

/// A row of samples along one axis of a table, one float for each channel.
struct Line {
    const float* first = nullptr;  ///< sample of its first point
    std::size_t stride = 0;        ///< floats from one point to the next
    int pointCount = 0;
    Point start = {0, 0, 0};
    unsigned axis = 0;
    bool isCurve = false;

    float value(int index, unsigned channel) const {
        return first[static_cast<std::size_t>(index) * stride + channel];
    }
    Point point(int index) const {
        if (isCurve) return {index, index, index};
        Point place = start;
        place[axis] = index;
        return place;
    }
};

/// Calls visit(line) for every row of points along an axis. A curve is one row, along any axis.
template <class Visit>
void forEachLine(const Orlith::LUT::LUT& lut, unsigned axis, Visit&& visit) {
    if (lut.data() == nullptr) return;
    if (lut.is1D()) {
        visit(Line{lut.data(), 3, lut.width(), {0, 0, 0}, axis, true});
        return;
    }
    const auto size = Orlith::LUT::LatticeSize::of(lut);
    if (!size.hasPoints()) return;
    const int counts[] = {size.width, size.height, size.depth};
    const std::size_t strides[] = {
        3, 3 * static_cast<std::size_t>(size.width),
        3 * static_cast<std::size_t>(size.width) * static_cast<std::size_t>(size.height)};
    const unsigned inner = axis == 0 ? 1 : 0;
    const unsigned outer = axis == 2 ? 1 : 2;
    Point start = {0, 0, 0};
    for (start[outer] = 0; start[outer] < counts[outer]; ++start[outer]) {
        for (start[inner] = 0; start[inner] < counts[inner]; ++start[inner]) {
            const float* const first = lut.data() +
                                       static_cast<std::size_t>(start[outer]) * strides[outer] +
                                       static_cast<std::size_t>(start[inner]) * strides[inner];
            visit(Line{first, strides[axis], counts[axis], start, axis, false});
        }
    }
}

}  // namespace report
