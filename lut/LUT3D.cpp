#include "lut/LUT3D.h"

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
    // In the order of InterpolationMode.
    static constexpr InterpolationMethod kMethods[] = {StepInterpolate, LinearStaggeredInterpolate,
                                                       TrilinearInterpolate, CubicInterpolate};
    if (mode > Cubic) throw Exception("Unknown interpolation mode");
    if (values.empty()) return RGB(0.0F, 0.0F, 0.0F);
    const RGB position = applyShaper(point);
    return extrapolate ? interpolateOrContinue(*this, position, kMethods[mode])
                       : kMethods[mode](*this, position);
}

void LUT3D::minmax(RGB& min, RGB& max) const {
    const int sizes[] = {width_, height_, depth_};
    for (unsigned c = 0; c < 3; ++c) {
        min[c] = transform[3][c];
        max[c] = static_cast<float>(sizes[c] - 1) * transform[c][c] + transform[3][c];
    }
}

}  // namespace Orlith::LUT
