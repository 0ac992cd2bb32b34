#include "lut/Interpolation.h"

#include <algorithm>

#include "lut/Exception.h"
#include "lut/evaluation/LatticeMethods.h"

namespace Orlith::LUT {
namespace {

using MethodAt = RGB (*)(const Lattice&, const LatticePosition&);

RGB zero() {
    return RGB(0.0F, 0.0F, 0.0F);
}

template <MethodAt kMethod>
RGB interpolate(const LUT& lut, const RGB& point, const char* wrongKind) {
    if (lut.is1D()) throw Exception(wrongKind);
    const Lattice lattice(lut);
    return lattice.empty() ? zero() : kMethod(lattice, latticePosition(lut, point));
}

}  // namespace

RGB StepInterpolate(const LUT& lut, const RGB& point) {
    return interpolate<stepAt>(lut, point, "StepInterpolate: expecting a 3D lut");
}

RGB LinearStaggeredInterpolate(const LUT& lut, const RGB& point) {
    return interpolate<staggeredAt>(lut, point, "LinearStaggeredInterpolate: expecting a 3D lut");
}

RGB TrilinearInterpolate(const LUT& lut, const RGB& point) {
    return interpolate<trilinearAt>(lut, point, "TrilinearInterpolate: expecting a 3D lut");
}

RGB TetrahedralInterpolate(const LUT& lut, const RGB& point) {
    return interpolate<tetrahedralAt>(lut, point, "TetrahedralInterpolate: expecting a 3D lut");
}

RGB CubicInterpolate(const LUT& lut, const RGB& point) {
    return interpolate<cubicAt>(lut, point, "CubicInterpolate: expecting a 3D lut");
}

RGB Extrapolate(const LUT& lut, int r, int g, int b) {
    if (lut.is1D()) throw Exception("Extrapolate: expecting a 3D lut");
    const Lattice lattice(lut);
    return lattice.empty() ? zero() : extrapolatedSample(lattice, r, g, b);
}

RGB interpolateOrContinue(const LUT& lut, const RGB& point, InterpolationMethod method) {
    RGB min;
    RGB max;
    lut.minmax(min, max);
    const auto inside = [&](unsigned c) { return min[c] <= point[c] && point[c] <= max[c]; };
    if (inside(0) && inside(1) && inside(2)) return method(lut, point);

    // The nearest point of the domain, and the way from there to the colour.
    const int sizes[] = {lut.width(), lut.height(), lut.depth()};
    RGB nearest;
    for (unsigned c = 0; c < 3; ++c) {
        const float scale = lut.transform[c][c];
        const float offset = lut.transform[3][c];
        const auto last = static_cast<float>(sizes[c] - 1);
        const float index = std::max(0.0F, std::min((point[c] - offset) / scale, last));
        nearest[c] = index * scale + offset;
    }
    RGB direction = point - nearest;
    const float distance = direction.two_norm();
    direction.normalize();

    // Slope by a backward difference of one red cell, the same step on every axis.
    const float step = 1.0F / static_cast<float>(lut.width());
    const RGB edge = method(lut, nearest);
    const RGB inner = method(lut, nearest - direction * step);
    RGB result;
    for (unsigned c = 0; c < 3; ++c) {
        result[c] = edge[c] + ((edge[c] - inner[c]) / step) * distance;
    }
    return result;
}

}  // namespace Orlith::LUT
