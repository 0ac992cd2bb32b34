#include "lut/CurveLookup.h"

#include <algorithm>
#include <cmath>
#include <cstdint>

#include "lut/FloatToInt.h"

namespace Orlith::LUT {
namespace {

/// One channel of a list of triples, read within its bounds only.
class Column {
public:
    Column(const RGB* entries, std::size_t entryCount, unsigned channel)
        : floats_(entries->data_block() + channel),
          last_(static_cast<std::int64_t>(entryCount) - 1) {}

    float operator[](std::int64_t i) const {
        return floats_[3 * std::clamp<std::int64_t>(i, 0, last_)];
    }

private:
    const float* floats_;
    std::int64_t last_;
};

}  // namespace

float interpolateCurve(const RGB* entries, std::size_t entryCount, unsigned channel, float points,
                       float t) {
    const Column column(entries, entryCount, channel);
    const std::int64_t last = std::int64_t{toInt32(points)} - 1;
    const float x = t * (points - 1.0F);
    const std::int64_t i = toInt32(std::floor(x));
    if (i < 0) return column[0];
    if (i >= last) return column[last];
    return column[i] + (column[i + 1] - column[i]) * (x - static_cast<float>(i));
}

float locateInCurve(const RGB* entries, std::size_t entryCount, unsigned channel, float points,
                    float value) {
    const Column column(entries, entryCount, channel);
    const std::int64_t last = std::int64_t{toInt32(points)} - 1;
    if (column[0] >= value) return 0.0F;
    if (value >= column[last]) return 1.0F;
    // A count may claim more than is stored; there is nothing to find beyond.
    const auto stored = static_cast<std::int64_t>(entryCount);
    std::int64_t i = 1;
    while (i < std::min(last, stored) && !(column[i] > value))
        ++i;
    const float below = column[i - 1];
    return (static_cast<float>(i - 1) + (value - below) / (column[i] - below)) / (points - 1.0F);
}

}  // namespace Orlith::LUT
