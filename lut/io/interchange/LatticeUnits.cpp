#include "lut/io/interchange/LatticeUnits.h"

#include <cmath>
#include <cstddef>

#include "lut/Exception.h"
#include "lut/io/interchange/WriteChecks.h"

namespace Orlith::LUT {
namespace {

constexpr char kNotHeld[] = "unable to write: the format has no place for the pre-LUT";

/// Inputs reach the outputShaper as they are, and it has as many points on each channel.
bool isHeld(const LUT& lut) {
    const Shaper& shaper = lut.outputShaper;
    const float count = shaper.counts[0];
    return (lut.inputShaper.empty() || isRamp(lut.inputShaper)) && count >= 2.0F &&
           count <= static_cast<float>(shaper.entries.size()) && shaper.counts[1] == count &&
           shaper.counts[2] == count;
}

void expectFinite(const Shaper& shaper) {
    for (const RGB& entry : shaper.entries) {
        for (unsigned c = 0; c < 3; ++c) {
            if (!std::isfinite(entry[c])) throw Exception(kNotHeld);
        }
    }
}

}  // namespace

Shaper preLUTOfTruelight(const LUT& lut) {
    expectDomain(lut);
    if (lut.outputShaper.empty()) {
        expectNoPreLUT(lut);
        expectUnitDomain(lut);
        return {};
    }
    if (!isHeld(lut)) throw Exception(kNotHeld);
    Shaper shaper = lut.outputShaper;
    shaper.entries.resize(static_cast<std::size_t>(shaper.counts[0]));
    for (RGB& entry : shaper.entries) {
        for (unsigned c = 0; c < 3; ++c) {
            entry[c] = (entry[c] - lut.transform[3][c]) / lut.transform[c][c];
        }
    }
    expectFinite(shaper);
    return shaper;
}

Shaper preLUTOfCMS(const LUT& lut) {
    Shaper shaper = preLUTOfTruelight(lut);
    const auto points = static_cast<float>(lut.width());
    if (shaper.empty()) {
        shaper.entries = {RGB(0.0F, 0.0F, 0.0F), RGB(points, points, points)};
        return shaper;
    }
    for (RGB& entry : shaper.entries) {
        for (unsigned c = 0; c < 3; ++c)
            entry[c] = entry[c] * points / (points - 1.0F);
    }
    expectFinite(shaper);
    return shaper;
}

}  // namespace Orlith::LUT
