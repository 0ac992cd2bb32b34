#pragma once

#include <cstddef>

#include "lut/LUT.h"

namespace Orlith::LUT {

/// Points along red, green and blue.
struct LatticeSize {
    int width = 0;
    int height = 0;
    int depth = 0;

    static LatticeSize of(const LUT& lut) { return {lut.width(), lut.height(), lut.depth()}; }

    bool isCube() const { return width == height && height == depth; }

    /// Without points no loop over the lattice may start, however long the other sides.
    bool hasPoints() const { return width > 0 && height > 0 && depth > 0; }

    /// Of a size that a table has taken: others may not fit.
    std::size_t pointCount() const {
        if (!hasPoints()) return 0;
        return static_cast<std::size_t>(width) * static_cast<std::size_t>(height) *
               static_cast<std::size_t>(depth);
    }
};

/// Calls visit(element) for every point in the order of storage: red fastest, then green, then
/// blue.
template <class Visit>
void forEachRedFastest(const LatticeSize& size, Visit&& visit) {
    const std::size_t pointCount = size.pointCount();
    for (std::size_t element = 0; element < pointCount; ++element)
        visit(element);
}

/// Calls visit(element) for the points, blue fastest, then green, then red, as long as it returns
/// true; element is the point's place in storage.
template <class Visit>
void whileBlueFastest(const LatticeSize& size, Visit&& visit) {
    if (!size.hasPoints()) return;
    const auto width = static_cast<std::size_t>(size.width);
    const auto height = static_cast<std::size_t>(size.height);
    const auto depth = static_cast<std::size_t>(size.depth);
    for (std::size_t r = 0; r < width; ++r) {
        for (std::size_t g = 0; g < height; ++g) {
            for (std::size_t b = 0; b < depth; ++b) {
                if (!visit((b * height + g) * width + r)) return;
            }
        }
    }
}

/// The same for every point, whatever visit(element) returns.
template <class Visit>
void forEachBlueFastest(const LatticeSize& size, Visit&& visit) {
    whileBlueFastest(size, [&](std::size_t element) {
        visit(element);
        return true;
    });
}

/// Moves samples that a blue-fastest file's reader stored one behind the other to their places.
///
/// Storing them in place at once would touch a page of memory for nearly each, however few a file
/// holds of the lattice that it claims.
/// @param sampleCount  how many there are: all of them, unless the lattice is a cube. Behind them
///                     are zeros
void placeBlueFastest(LUT& lut, std::size_t sampleCount);

/// Where the next data line of a file goes, for formats whose data wraps round at the end.
struct LatticePosition {
    int r = 0;
    int g = 0;
    int b = 0;

    /// False after a second, smaller size line, or before any.
    bool isInside(const LatticeSize& size) const {
        return r < size.width && g < size.height && b < size.depth;
    }

    std::size_t element(const LatticeSize& size) const {
        return (static_cast<std::size_t>(b) * static_cast<std::size_t>(size.height) +
                static_cast<std::size_t>(g)) *
                   static_cast<std::size_t>(size.width) +
               static_cast<std::size_t>(r);
    }

    /// Red first, then green, then blue, then from the start again.
    void advanceRedFastest(const LatticeSize& size) {
        if (++r < size.width) return;
        r = 0;
        if (++g < size.height) return;
        g = 0;
        if (++b < size.depth) return;
        b = 0;
    }
};

}  // namespace Orlith::LUT
