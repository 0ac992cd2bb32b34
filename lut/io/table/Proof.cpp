#include "lut/io/table/Proof.h"

#include <algorithm>
#include <cmath>
#include <optional>

#include "lut/evaluation/Range.h"

namespace Orlith::LUT {

namespace {

/// What a shaper that is a straight line begins and ends with on a channel.
struct Ends {
    float first = 0.0F;
    float last = 1.0F;

    bool areUnit() const { return first == 0.0F && last == 1.0F; }
    float length() const { return last - first; }
};

/// 0 and 1 where there is no shaper; nothing where it is no straight line upward.
std::optional<Ends> endsOf(const Shaper& shaper, unsigned c) {
    const auto& entries = shaper.entries;
    if (entries.empty()) return Ends();
    if (entries.size() != 2 || shaper.counts[c] != 2.0F) return std::nullopt;
    const Ends ends{entries[0][c], entries[1][c]};
    return ends.length() > 0.0F ? std::optional(ends) : std::nullopt;
}

void dropPreLUT(LUT& lut) {
    lut.inputShaper = {};
    lut.outputShaper = {};
}

}  // namespace

void dropIdentityPreLUT(LUT& lut) {
    for (unsigned c = 0; c < 3; ++c) {
        for (const Shaper* const shaper : {&lut.inputShaper, &lut.outputShaper}) {
            const auto ends = endsOf(*shaper, c);
            if (!ends || !ends->areUnit()) return;
        }
    }
    dropPreLUT(lut);
}

void foldStraightPreLUT(LUT& lut) {
    if (lut.inputShaper.empty() && lut.outputShaper.empty()) return;
    if (lut.is1D()) return dropIdentityPreLUT(lut);
    const int sides[] = {lut.width(), lut.height(), lut.depth()};
    Transform transform = lut.transform;
    for (unsigned c = 0; c < 3; ++c) {
        const auto inputs = endsOf(lut.inputShaper, c);
        const auto points = endsOf(lut.outputShaper, c);
        if (!inputs || !points || sides[c] < 2) return;
        // One that stops within the lattice, or goes on beyond it, is more than a domain.
        const float scale = lut.transform[c][c];
        const float offset = lut.transform[3][c];
        const auto cells = static_cast<float>(sides[c] - 1);
        const float slack = 1e-6F * points->length();
        if (!(std::fabs(points->first - offset) <= slack)) return;
        if (!(std::fabs(points->last - (offset + scale * cells)) <= slack)) return;
        transform[c][c] = inputs->length() / cells;
        transform[3][c] = inputs->first;
    }
    lut.transform = transform;
    dropPreLUT(lut);
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
