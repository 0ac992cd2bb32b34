#include "lut/evaluation/Look.h"

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <limits>
#include <random>
#include <utility>

namespace Orlith::LUT {
namespace {

constexpr std::size_t kBlockColours = 4096;

/// The input at a position from 0 to 1 along a table's pre-LUT or points.
float inputAt(const LUT& lut, const Range& range, unsigned channel, double position) {
    const auto& entries = lut.inputShaper.entries;
    const double last = static_cast<double>(lut.inputShaper.counts[channel]) - 1.0;
    if (entries.empty() || !(last >= 1.0)) {
        const auto min = static_cast<double>(range.min[channel]);
        return static_cast<float>(min + position * (static_cast<double>(range.max[channel]) - min));
    }
    const double place = position * last;
    const std::size_t below = std::min(static_cast<std::size_t>(place), entries.size() - 1);
    const std::size_t above = std::min(below + 1, entries.size() - 1);
    const auto from = static_cast<double>(entries[below][channel]);
    const auto to = static_cast<double>(entries[above][channel]);
    return static_cast<float>(from + (to - from) * (place - static_cast<double>(below)));
}

}  // namespace

Range inputRangeOf(const LUT& lut) {
    const auto& entries = lut.inputShaper.entries;
    if (entries.empty()) return lut.outputShaper.empty() ? domainOf(lut) : unitRange();
    Range range;
    for (unsigned c = 0; c < 3; ++c) {
        const auto count = static_cast<std::size_t>(std::max(lut.inputShaper.counts[c], 1.0F));
        range.min[c] = entries.front()[c];
        range.max[c] = entries[std::min(count, entries.size()) - 1][c];
    }
    return range;
}

ChannelInputs inputsAlong(const LUT& lut, int stepsPerCell) {
    const Range range = inputRangeOf(lut);
    const int sides[] = {lut.width(), lut.is1D() ? lut.width() : lut.height(),
                         lut.is1D() ? lut.width() : lut.depth()};
    ChannelInputs inputs;
    for (unsigned c = 0; c < 3; ++c) {
        const int steps = (sides[c] - 1) * stepsPerCell;
        for (int i = 0; i <= steps; ++i) {
            const double position = steps == 0 ? 0.0 : static_cast<double>(i) / steps;
            inputs[c].push_back(inputAt(lut, range, c, position));
        }
    }
    return inputs;
}

void forEachInput(const LUT& lut, bool withHalfWays, const UseColour& use) {
    const ChannelInputs inputs = inputsAlong(lut, withHalfWays ? 2 : 1);
    if (lut.is1D()) {
        for (std::size_t i = 0; i < inputs[0].size(); ++i)
            use(RGB(inputs[0][i], inputs[1][i], inputs[2][i]));
        return;
    }
    for (const float b : inputs[2]) {
        for (const float g : inputs[1]) {
            for (const float r : inputs[0])
                use(RGB(r, g, b));
        }
    }
}

void forEachRandom(const Range& range, int count, const UseColour& use) {
    std::mt19937 random(1);
    for (int i = 0; i < count; ++i) {
        RGB colour;
        for (unsigned c = 0; c < 3; ++c) {
            const double share = static_cast<double>(random()) / 4294967295.0;  // of 32 bits
            const auto min = static_cast<double>(range.min[c]);
            colour[c] = static_cast<float>(min + share * (static_cast<double>(range.max[c]) - min));
        }
        use(colour);
    }
}

double largestOf(const Differences& differences) {
    return std::max({differences[0].largest, differences[1].largest, differences[2].largest});
}

void addDifference(Difference& difference, float a, float b, const RGB& at) {
    if (a == b || (std::isnan(a) && std::isnan(b))) return;
    double distance = std::fabs(static_cast<double>(a) - static_cast<double>(b));
    if (std::isnan(distance)) distance = std::numeric_limits<double>::infinity();
    if (distance > difference.largest) {
        difference.largest = distance;
        difference.at = at;
    }
    difference.mean += distance;
    difference.rootMeanSquare += distance * distance;
}

void finishDifferences(Differences& differences, std::uint64_t count) {
    if (count == 0) return;
    for (Difference& each : differences) {
        each.mean /= static_cast<double>(count);
        each.rootMeanSquare = std::sqrt(each.rootMeanSquare / static_cast<double>(count));
    }
}

LookComparison::LookComparison(ColourWay a, ColourWay b) : a_(std::move(a)), b_(std::move(b)) {
    colours_.reserve(3 * kBlockColours);
}

LookComparison::LookComparison(const Evaluator& a, const Evaluator& b)
    : LookComparison([&a](float* rgb, std::size_t count) { a.apply(rgb, rgb, count); },
                     [&b](float* rgb, std::size_t count) { b.apply(rgb, rgb, count); }) {}

void LookComparison::add(const RGB& colour) {
    colours_.insert(colours_.end(), {colour[0], colour[1], colour[2]});
    if (colours_.size() == 3 * kBlockColours) flush();
}

void LookComparison::flush() {
    resultsA_ = colours_;
    resultsB_ = colours_;
    a_(resultsA_.data(), colours_.size() / 3);
    b_(resultsB_.data(), colours_.size() / 3);
    for (std::size_t i = 0; i < colours_.size(); ++i) {
        const float* const colour = colours_.data() + i / 3 * 3;
        addDifference(differences_[i % 3], resultsA_[i], resultsB_[i],
                      RGB(colour[0], colour[1], colour[2]));
    }
    count_ += colours_.size() / 3;
    colours_.clear();
}

Differences LookComparison::finish() {
    flush();
    finishDifferences(differences_, count_);
    return differences_;
}

Differences compareLooks(const LUT& a, ColourWay lookA, const LUT& b, ColourWay lookB) {
    LookComparison comparison(std::move(lookA), std::move(lookB));
    const auto add = [&](const RGB& colour) { comparison.add(colour); };
    forEachInput(pointCount(a) >= pointCount(b) ? a : b, false, add);
    forEachRandom(inputRangeOf(a), kRandomColours / 2, add);
    forEachRandom(inputRangeOf(b), kRandomColours / 2, add);
    return comparison.finish();
}

}  // namespace Orlith::LUT
