#include "lut/LUT1D.h"

#include <stdexcept>

#include "lut/CurveLookup.h"

namespace Orlith::LUT {

void LUT1D::resize(int n) {
    if (n == sampleCount_) return;
    if (n < 0) throw std::length_error("LUT1D::resize");
    values.resize(static_cast<std::size_t>(n));
    sampleCount_ = n;
}

RGB& LUT1D::get(int i) {
    return values[static_cast<std::size_t>(i)];
}

const RGB& LUT1D::get(int i) const {
    return values[static_cast<std::size_t>(i)];
}

RGB LUT1D::interpolate(const RGB& point, InterpolationMode, bool) const {
    if (values.empty()) return RGB(0.0F, 0.0F, 0.0F);
    const auto count = static_cast<float>(sampleCount_);
    RGB result;
    for (unsigned c = 0; c < 3; ++c) {
        result[c] = interpolateCurve(&values[0], values.size(), c, count, point[c]);
    }
    return result;
}

void LUT1D::minmax(RGB& min, RGB& max) const {
    for (unsigned c = 0; c < 3; ++c) {
        min[c] = transform[3][c];
        max[c] = static_cast<float>(sampleCount_ - 1) * transform[c][c] + transform[3][c];
    }
}

}  // namespace Orlith::LUT
