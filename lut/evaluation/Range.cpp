#include "lut/evaluation/Range.h"

#include <algorithm>
#include <cmath>

namespace Orlith::LUT {

Range unitRange() {
    return {RGB(0.0F, 0.0F, 0.0F), RGB(1.0F, 1.0F, 1.0F)};
}

bool rises(const Range& range) {
    for (unsigned c = 0; c < 3; ++c) {
        // The distance of the points is a part of the width, and has to be a number as well.
        const float width = range.max[c] - range.min[c];
        if (!(width > 0.0F) || !std::isnormal(width)) return false;
    }
    return true;
}

bool isUnit(const Range& range) {
    // 1 / (N - 1), times N - 1, may miss 1 by two units in its last place.
    constexpr float kLastBits = 2.5e-7F;
    for (unsigned c = 0; c < 3; ++c) {
        if (range.min[c] != 0.0F || !(std::fabs(range.max[c] - 1.0F) <= kLastBits)) return false;
    }
    return true;
}

Range intersection(const Range& a, const Range& b) {
    Range both;
    for (unsigned c = 0; c < 3; ++c) {
        both.min[c] = std::max(a.min[c], b.min[c]);
        both.max[c] = std::min(a.max[c], b.max[c]);
    }
    return both;
}

Range domainOf(const LUT& lut) {
    Range range;
    lut.minmax(range.min, range.max);
    return range;
}

void setDomain(LUT& lut, const Range& domain, const int (&points)[3]) {
    lut.transform.set_identity();
    for (unsigned c = 0; c < 3; ++c) {
        lut.transform[c][c] = (domain.max[c] - domain.min[c]) / static_cast<float>(points[c] - 1);
        lut.transform[3][c] = domain.min[c];
    }
}

std::uint64_t pointCount(const LUT& lut) {
    const auto width = static_cast<std::uint64_t>(lut.width());
    return lut.is1D() ? width
                      : width * static_cast<std::uint64_t>(lut.height()) *
                            static_cast<std::uint64_t>(lut.depth());
}

}  // namespace Orlith::LUT
