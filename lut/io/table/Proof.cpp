#include "lut/io/table/Proof.h"

#include <algorithm>
#include <cmath>

#include "lut/evaluation/Range.h"

namespace Orlith::LUT {

void dropIdentityPreLUT(LUT& lut) {
    const Shaper* const shapers[] = {&lut.inputShaper, &lut.outputShaper};
    for (const Shaper* const shaper : shapers) {
        const auto& entries = shaper->entries;
        if (entries.size() != 2) return;
        for (unsigned c = 0; c < 3; ++c) {
            if (shaper->counts[c] != 2.0F || entries[0][c] != 0.0F || entries[1][c] != 1.0F) return;
        }
    }
    lut.inputShaper = {};
    lut.outputShaper = {};
}

Clipping clippingOf(const LUT& lut, const std::string& extension, const Options3DL& options) {
    Clipping clipping;
    if (extension != ".3dl" || !options.clampOutput) return clipping;
    Options3DL unclamped = options;
    unclamped.clampOutput = false;
    const double codeMax = std::ldexp(1.0, options.outputBits) - 1.0;
    const float* const samples = lut.data();
    for (std::uint64_t i = 0; i < 3 * pointCount(lut); ++i) {
        const double code = codeOf(static_cast<double>(samples[i]), unclamped);
        if (code >= -0.5 && code <= codeMax + 0.5) continue;  // half a code is no loss
        ++clipping.numberCount;
        if (!(std::fabs(samples[i] - 0.5F) <= std::fabs(clipping.farthest - 0.5F))) {
            clipping.farthest = samples[i];
        }
    }
    return clipping;
}

ReadOptions readingOf(const std::string& extension, const Options3DL& options) {
    ReadOptions reading;
    reading.from = extension;
    reading.format3DL = options.dialect;
    // A Lustre file says its bits itself, and the reader warns when it is told again.
    reading.outputBitDepth =
        options.dialect == "lustre" ? ReadOptions::kDetect : options.outputBits;
    return reading;
}

double precisionOf(const std::string& extension, const Options3DL& options, const LUT& lut) {
    float largest = 1.0F;
    const float* const samples = lut.data();
    for (std::uint64_t i = 0; i < 3 * pointCount(lut); ++i) {
        if (std::isfinite(samples[i])) largest = std::max(largest, std::fabs(samples[i]));
    }
    // A pre-LUT's six digits are multiplied by the slope of what is behind it.
    const double steepness = lut.inputShaper.empty() && lut.outputShaper.empty()
                                 ? 1.0
                                 : static_cast<double>(std::max(lut.width(), 2));
    const double relative = 1e-6 * static_cast<double>(largest) * steepness;
    if (extension != ".3dl") return 2e-6 + relative;
    return 0.6 / (std::ldexp(1.0, options.outputBits) - 1.0) /
               static_cast<double>(std::fabs(options.scale)) +
           relative;
}

}  // namespace Orlith::LUT
