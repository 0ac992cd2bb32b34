#include "lut/LUT3D.h"

#include <algorithm>
#include <cstdint>
#include <limits>
#include <stdexcept>

#include "lut/Exception.h"
#include "lut/Interpolation.h"

namespace Orlith::LUT {
namespace {

/// Points of a lattice. Elements are numbered in 32-bit signed arithmetic, so more points than that
/// can count are refused, as is a negative side.
std::size_t pointCount(int width, int height, int depth) {
    constexpr std::int64_t kMost = std::numeric_limits<std::int32_t>::max();
    if (width < 0 || height < 0 || depth < 0) throw std::length_error("LUT3D::resize");
    // With a zero side the product is zero, whatever the partial product would have been.
    if (width == 0 || height == 0 || depth == 0) return 0;
    const std::int64_t plane = std::int64_t{width} * height;
    if (plane > kMost || plane * depth > kMost) throw std::length_error("LUT3D::resize");
    return static_cast<std::size_t>(plane * depth);
}

}  // namespace

void LUT3D::resize(int n) {
    resize(n, n, n);
}

void LUT3D::resize(int width, int height, int depth) {
    if (width == width_ && height == height_ && depth == depth_) return;
    values.resize(pointCount(width, height, depth));
    width_ = width;
    height_ = height;
    depth_ = depth;
}

RGB& LUT3D::get(int r, int g, int b) {
    return values[element(r, g, b)];
}

const RGB& LUT3D::get(int r, int g, int b) const {
    return values[element(r, g, b)];
}

RGB LUT3D::interpolate(const RGB& point, InterpolationMode mode, bool extrapolate) const {
    using Method = RGB (*)(const LUT&, const RGB&);
    // In the order of InterpolationMode.
    static constexpr Method kMethods[] = {StepInterpolate, LinearStaggeredInterpolate,
                                          TrilinearInterpolate, CubicInterpolate};
    if (mode > Cubic) throw Exception("Unknown interpolation mode");
    const Method method = kMethods[mode];
    if (values.empty()) return RGB(0.0F, 0.0F, 0.0F);

    RGB min;
    RGB max;
    minmax(min, max);
    const RGB q = applyShaper(point);
    if (!extrapolate) return method(*this, q);
    const auto inside = [&](unsigned c) { return min[c] <= q[c] && q[c] <= max[c]; };
    if (inside(0) && inside(1) && inside(2)) return method(*this, q);

    // The nearest point of the domain, and the way from there to the colour.
    const int sizes[] = {width_, height_, depth_};
    RGB nearest;
    for (unsigned c = 0; c < 3; ++c) {
        const float scale = transform[c][c];
        const float offset = transform[3][c];
        const auto last = static_cast<float>(sizes[c] - 1);
        const float index = std::max(0.0F, std::min((q[c] - offset) / scale, last));
        nearest[c] = index * scale + offset;
    }
    RGB direction = q - nearest;
    const float distance = direction.two_norm();
    direction.normalize();

    // Slope by a backward difference of one red cell, the same step on every axis.
    const float step = 1.0F / static_cast<float>(width_);
    const RGB edge = method(*this, nearest);
    const RGB inner = method(*this, nearest - direction * step);
    RGB result;
    for (unsigned c = 0; c < 3; ++c) {
        result[c] = edge[c] + ((edge[c] - inner[c]) / step) * distance;
    }
    return result;
}

void LUT3D::minmax(RGB& min, RGB& max) const {
    const int sizes[] = {width_, height_, depth_};
    for (unsigned c = 0; c < 3; ++c) {
        min[c] = transform[3][c];
        max[c] = static_cast<float>(sizes[c] - 1) * transform[c][c] + transform[3][c];
    }
}

}  // namespace Orlith::LUT
