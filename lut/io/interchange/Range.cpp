#include "lut/io/interchange/Range.h"

#include <cmath>

namespace Orlith::LUT {

bool rises(const Range& range) {
    for (unsigned c = 0; c < 3; ++c) {
        // The distance of the points is a part of the width, and has to be a number as well.
        const float width = range.max[c] - range.min[c];
        if (!(width > 0.0F) || !std::isnormal(width)) return false;
    }
    return true;
}

bool isUnit(const Range& range) {
    return range.min == RGB(0.0F, 0.0F, 0.0F) && range.max == RGB(1.0F, 1.0F, 1.0F);
}

Range domainOf(const LUT& lut) {
    Range range;
    lut.minmax(range.min, range.max);
    return range;
}

void setDomain(LUT& lut, const RGB& min, const RGB& max, const int (&points)[3]) {
    lut.transform.set_identity();
    for (unsigned c = 0; c < 3; ++c) {
        lut.transform[c][c] = (max[c] - min[c]) / static_cast<float>(points[c] - 1);
        lut.transform[3][c] = min[c];
    }
}

bool coversUnit(const LUT& lut) {
    constexpr float kLastBits = 2.5e-7F;  // two units in the last place of 1
    const Range range = domainOf(lut);
    for (unsigned c = 0; c < 3; ++c) {
        if (range.min[c] != 0.0F || !(std::fabs(range.max[c] - 1.0F) <= kLastBits)) return false;
    }
    return true;
}

std::uint64_t pointCount(const LUT& lut) {
    const auto width = static_cast<std::uint64_t>(lut.width());
    return lut.is1D() ? width
                      : width * static_cast<std::uint64_t>(lut.height()) *
                            static_cast<std::uint64_t>(lut.depth());
}

std::string endsEarly(std::uint64_t sampleCount, std::uint64_t points) {
    return "the file ends after " + std::to_string(sampleCount) + " of " + std::to_string(points) +
           " samples";
}

}  // namespace Orlith::LUT
