#include "orlith/pattern/PatchExtent.h"

#include <algorithm>
#include <cmath>
#include <limits>

#include "zefra/PatternLayout.h"

namespace orlith {
namespace {

constexpr int kPatchPixels = zefra::PatternLayout::kPatchPixels;
constexpr double kInfinity = std::numeric_limits<double>::infinity();

/// Pixels of one colour differ by no more than this, or this part of a value above 1: just above
/// the distance of neighbouring halves below 1, which is 1/2048.
constexpr double kTooMuch = 1.0 / 2000.0;

double limitFor(double low, double high) {
    return kTooMuch * std::max({1.0, std::fabs(low), std::fabs(high)});
}

double spreadOf(const PatchExtent::Channel& channel) {
    if (channel.low > channel.high) return 0.0;
    if (channel.wildCount > 0) return kInfinity;
    return channel.high - channel.low;
}

double gapBetween(const PatchExtent::Channel& one, const PatchExtent::Channel& other) {
    const bool isWild = one.low > one.high;
    const bool isOtherWild = other.low > other.high;
    if (isWild || isOtherWild) return isWild == isOtherWild ? 0.0 : kInfinity;
    return std::max({0.0, one.low - other.high, other.low - one.high});
}

}  // namespace

double PatchExtent::unevenness() const {
    double most = 0.0;
    for (const Channel& each : channels)
        most = std::max(most, spreadOf(each) / limitFor(each.low, each.high));
    return most;
}

double PatchExtent::spread() const {
    double most = 0.0;
    for (const Channel& each : channels)
        most = std::max(most, spreadOf(each));
    return most;
}

double PatchExtent::gapTo(const PatchExtent& other) const {
    double most = 0.0;
    for (std::size_t c = 0; c < channels.size(); ++c)
        most = std::max(most, gapBetween(channels[c], other.channels[c]));
    return most;
}

bool PatchExtent::agreesWith(const PatchExtent& other) const {
    for (std::size_t c = 0; c < channels.size(); ++c) {
        const Channel& one = channels[c];
        const double gap = gapBetween(one, other.channels[c]);
        if (gap > 0.0 && gap > limitFor(one.low, one.high)) return false;
    }
    return true;
}

PatchRowExtents::PatchRowExtents(int columns) {
    const auto width = static_cast<std::size_t>(columns) * kPatchPixels;
    for (Channel& each : channels_) {
        each.low.resize(width);
        each.high.resize(width);
        each.wildCounts.resize(width);
    }
    clear();
}

void PatchRowExtents::clear() {
    constexpr float kAboveAll = std::numeric_limits<float>::infinity();
    for (Channel& each : channels_) {
        std::fill(each.low.begin(), each.low.end(), kAboveAll);
        std::fill(each.high.begin(), each.high.end(), -kAboveAll);
        std::fill(each.wildCounts.begin(), each.wildCounts.end(), 0);
    }
}

void PatchRowExtents::add(const zefra::Row& row) {
    auto extent = channels_.begin();
    for (const zefra::Channel channel : {zefra::kRed, zefra::kGreen, zefra::kBlue}) {
        const float* const in = row.pixels(channel);
        float* const low = extent->low.data();
        float* const high = extent->high.data();
        int* const wildCount = extent->wildCounts.data();
        const std::size_t width = extent->low.size();
        ++extent;
        for (std::size_t x = 0; x < width; ++x) {
            const float value = in[x];
            const bool isFinite = value - value == 0.0F;
            low[x] = isFinite && value < low[x] ? value : low[x];
            high[x] = isFinite && value > high[x] ? value : high[x];
            wildCount[x] += isFinite ? 0 : 1;
        }
    }
}

PatchExtent PatchRowExtents::patch(int column) const {
    PatchExtent extent{};
    const auto first = static_cast<std::size_t>(column) * kPatchPixels;
    for (std::size_t c = 0; c < channels_.size(); ++c) {
        const Channel& in = channels_[c];
        PatchExtent::Channel& out = extent.channels[c];
        out = {kInfinity, -kInfinity, 0};
        for (std::size_t x = first; x < first + kPatchPixels; ++x) {
            out.low = std::min(out.low, static_cast<double>(in.low[x]));
            out.high = std::max(out.high, static_cast<double>(in.high[x]));
            out.wildCount += in.wildCounts[x];
        }
    }
    return extent;
}

}  // namespace orlith
