#include "lut/io/interchange/ChannelShaper.h"

#include <algorithm>
#include <cmath>
#include <cstddef>

#include "lut/CurveLookup.h"
#include "lut/FloatToInt.h"

namespace Orlith::LUT {
namespace {

/// Points in use, no more than are stored.
std::size_t pointCount(const Shaper& shaper, unsigned channel) {
    const auto claimed = static_cast<std::size_t>(std::max(toInt32(shaper.counts[channel]), 0));
    return std::min(claimed, shaper.entries.size());
}

/// The bends of a shaper, as positions from 0 to 1.
void addBends(const Shaper& shaper, unsigned channel, std::vector<float>& positions) {
    const std::size_t count = pointCount(shaper, channel);
    for (std::size_t i = 1; i + 1 < count; ++i)
        positions.push_back(static_cast<float>(i) / static_cast<float>(count - 1));
}

/// A shaper's entry at a position; without a shaper the position itself.
float entryAt(const Shaper& shaper, unsigned channel, float position) {
    if (shaper.empty()) return position;
    return interpolateCurve(shaper.entries.data(), shaper.entries.size(), channel,
                            shaper.counts[channel], position);
}

/// From an input of the transform to a place from 0 to 1.
class Domain {
public:
    Domain(const LUT& lut, unsigned channel)
        : offset_(lut.transform[3][channel]), scale_(lut.transform[channel][channel]) {
        const int points = lut.is1D()     ? lut.width()
                           : channel == 0 ? lut.width()
                           : channel == 1 ? lut.height()
                                          : lut.depth();
        cells_ = static_cast<float>(points - 1);
    }

    bool isUnit() const { return scale_ == 1.0F / cells_ && offset_ == 0.0F; }
    float min() const { return isUnit() ? 0.0F : offset_; }
    float max() const { return isUnit() ? 1.0F : offset_ + scale_ * cells_; }
    float place(float input) const {
        return isUnit() ? input : (input - offset_) / (scale_ * cells_);
    }

private:
    float offset_;
    float scale_;
    float cells_;
};

}  // namespace

bool ChannelShaper::rises(float amount) const {
    const auto isFinite = [](float number) { return std::isfinite(number); };
    return std::all_of(inputs.begin(), inputs.end(), isFinite) &&
           std::all_of(outputs.begin(), outputs.end(), isFinite) &&
           std::is_sorted(inputs.begin(), inputs.end()) && inputs.back() - inputs.front() >= amount;
}

ChannelShaper shaperOf(const LUT& lut, unsigned channel) {
    const Domain domain(lut, channel);
    if (lut.inputShaper.empty() && lut.outputShaper.empty()) {
        return {{domain.min(), domain.max()}, {0.0F, 1.0F}};
    }
    // Both shapers bend at the positions of their points, which need not be as many.
    std::vector<float> positions{0.0F, 1.0F};
    addBends(lut.inputShaper, channel, positions);
    addBends(lut.outputShaper, channel, positions);
    std::sort(positions.begin(), positions.end());
    positions.erase(std::unique(positions.begin(), positions.end()), positions.end());

    ChannelShaper curve;
    for (const float position : positions) {
        curve.inputs.push_back(entryAt(lut.inputShaper, channel, position));
        curve.outputs.push_back(domain.place(entryAt(lut.outputShaper, channel, position)));
    }
    return curve;
}

}  // namespace Orlith::LUT
