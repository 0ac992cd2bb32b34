#include "report/CurveFaults.h"

#include <algorithm>
#include <cmath>

namespace report {
namespace {

namespace ol = Orlith::LUT;

// A range of video levels, 64 to 940 of 1023 codes, put on the whole range clips 8 and 6 % of it: a
// table that clips as much or more throws picture away.
constexpr double kClipLimit = 1.0 / 16.0;

// At the dark end more is in order: log footage keeps black near 95 of 1023 codes, 9.3 %, and a
// table for it is black below.
constexpr double kDarkClipLimit = 0.1;

// Shorter runs, in cells, are what any table has where it reaches its end.
constexpr std::size_t kLeastClipCells = 2;

// Interpolation between equal samples differs by roundings of single precision.
constexpr double kSameLevel = 1e-6;

// One printer point, the least correction that a lab makes: 0.025 of log exposure, on a print of
// contrast 3 a density of 0.075, takes mid grey, 0.4 on a display of gamma 2.4, to 0.43.
constexpr double kTintLimit = 0.03;

/// Samples of a curve, the first and the last, at which an output stays on a level.
struct Run {
    std::size_t first = 0;
    std::size_t last = 0;
    float level = 0.0F;

    std::size_t steps() const { return last - first; }
};

Run longestRun(const Curve& curve, unsigned channel, float level, double tolerance) {
    Run longest{0, 0, level};
    bool isOn = false;
    std::size_t first = 0;
    for (std::size_t i = 0; i < curve.outputs.size(); ++i) {
        const double off =
            std::fabs(static_cast<double>(curve.outputs[i][channel]) - static_cast<double>(level));
        const bool isHere = off <= tolerance;
        if (isHere && !isOn) first = i;
        isOn = isHere;
        if (isOn && i - first > longest.steps()) longest = {first, i, level};
    }
    return longest;
}

bool isClip(const Curve& curve, const Run& run) {
    const std::size_t all = curve.inputs.size() - 1;
    const double part = static_cast<double>(run.steps()) / static_cast<double>(all);
    const bool isDark = run.first == 0 && run.last < all;
    return run.steps() >= kLeastClipCells * static_cast<std::size_t>(curve.stepsPerCell) &&
           (isDark ? part > kDarkClipLimit : part >= kClipLimit);
}

/// Adds what a channel clips along a curve to faults, those of the same run as one.
void addClips(const Curve& curve, unsigned channel, const FiniteRange& range,
              std::vector<Fault>& faults) {
    if (curve.inputs.size() < 2) return;
    std::vector<float> levels = {0.0F, 1.0F};
    for (const float end : {range.min[channel], range.max[channel]}) {
        if (std::find(levels.begin(), levels.end(), end) == levels.end()) levels.push_back(end);
    }
    for (const float level : levels) {
        const Run run = longestRun(curve, channel, level, kSameLevel * range.extent());
        if (!isClip(curve, run)) continue;
        Fault fault;
        fault.kind = FaultKind::Clip;
        fault.channels[channel] = true;
        fault.from = curve.inputs[run.first];
        fault.to = curve.inputs[run.last];
        fault.level = level;
        fault.amount =
            static_cast<double>(run.steps()) / static_cast<double>(curve.inputs.size() - 1);
        const auto same = std::find_if(faults.begin(), faults.end(), [&](const Fault& other) {
            return other.level == level && other.from == fault.from && other.to == fault.to;
        });
        if (same == faults.end()) {
            faults.push_back(fault);
        } else {
            same->channels[channel] = true;
        }
    }
}

bool hasClip(const std::vector<Fault>& faults, unsigned channel, float level) {
    return std::any_of(faults.begin(), faults.end(), [&](const Fault& fault) {
        return fault.channels[channel] && fault.level == level;
    });
}

/// A channel that is the same along all of its own axis does not depend on it: that is no clip.
bool isWhole(const Curve& curve, const Fault& fault) {
    return fault.from == curve.inputs.front() && fault.to == curve.inputs.back();
}

std::vector<Fault> clips(const Curve& neutral, const std::array<Curve, 3>& channels,
                         const FiniteRange& range) {
    std::vector<Fault> faults;
    for (unsigned c = 0; c < 3; ++c)
        addClips(neutral, c, range, faults);
    const std::vector<Fault> ofNeutral = faults;
    for (unsigned c = 0; c < 3; ++c) {
        std::vector<Fault> own;
        addClips(channels[c], c, range, own);
        for (const Fault& fault : own) {
            if (hasClip(ofNeutral, c, fault.level) || isWhole(channels[c], fault)) continue;
            faults.push_back(fault);
        }
    }
    return faults;
}

void addTint(const Curve& neutral, double extent, std::vector<Fault>& faults) {
    Fault fault;
    fault.kind = FaultKind::Tint;
    for (std::size_t i = 0; i < neutral.outputs.size(); ++i) {
        const ol::RGB& output = neutral.outputs[i];
        if (!output.is_finite()) continue;
        const double most = static_cast<double>(output.max_value());
        const double least = static_cast<double>(output.min_value());
        const double spread = most - least;
        if (spread <= fault.amount) continue;
        fault.amount = spread;
        fault.from = fault.to = neutral.inputs[i];
        for (unsigned c = 0; c < 3; ++c)
            fault.channels[c] = static_cast<double>(output[c]) > 0.5 * (most + least);
    }
    if (fault.amount > kTintLimit * extent) faults.push_back(fault);
}

}  // namespace

std::vector<Fault> curveFaults(const Curve& neutral, const std::array<Curve, 3>& channels,
                               const FiniteRange& range) {
    std::vector<Fault> faults = clips(neutral, channels, range);
    addTint(neutral, range.extent(), faults);
    return faults;
}

}  // namespace report
