#pragma once

#include <cmath>
#include <cstdint>

namespace zefra {

/// The test pattern: an N x N x N colour cube as flat square patches, laid in rows from the bottom
/// left.
///
///     row 13  +-------+-------+-------+--         patch index i = row * columns + column
///       ...   | i = c | c + 1 | c + 2 |             r = i mod N              red fastest
///     row  7  +-------+-------+-------+--           g = (i div N) mod N
///       ...   | i = 0 | i = 1 | i = 2 |             b = i div N^2            blue slowest
///     row  0  +-------+-------+-------+--         colour (r, g, b) / (N - 1)
///             x = 0   7      14      21
///
/// A row holds ceil(sqrt(N^3)) patches; those past the last colour pad the top row.
struct PatternLayout {
    static constexpr int kPatchPixels = 7;  ///< side of a patch
    static constexpr int kPatchCentre = 3;  ///< the one pixel of it that is read, on both axes

    /// Patches in a row of the pattern of N points: the least width whose square holds them all.
    static int columns(int points) {
        const double patchCount = static_cast<double>(std::int64_t{points} * points * points);
        return static_cast<int>(std::ceil(std::sqrt(patchCount)));
    }

    /// Rows of patches of the pattern of N points.
    static int rows(int points) {
        const std::int64_t patchCount = std::int64_t{points} * points * points;
        const int width = columns(points);
        return width == 0 ? 0 : static_cast<int>((patchCount + width - 1) / width);
    }

    /// Points of the cube whose pattern is that many patches wide: the cube root of the square, put
    /// right where it was rounded to the wrong side.
    static int points(int columns) {
        const double square = static_cast<double>(std::int64_t{columns} * columns);
        const int rounded = static_cast<int>(std::floor(std::pow(square, 1.0 / 3.0)));
        const int width = PatternLayout::columns(rounded);
        if (columns > width) return rounded + 1;
        return columns < width ? rounded - 1 : rounded;
    }
};

}  // namespace zefra
