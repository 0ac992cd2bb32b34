#pragma once

#include <vector>

#include "lut/LUT.h"

namespace Orlith::LUT {

/// What a table does to one channel before its samples are looked up, its domain included, as one
/// curve of straight lines.
struct ChannelShaper {
    std::vector<float> inputs;   ///< from the lowest on; two neighbours are equal at a step
    std::vector<float> outputs;  ///< place among the samples, from 0, the first, to 1, the last

    /// Whether the inputs go up, from the first to the last by the given amount at least, to places
    /// that are numbers.
    bool rises(float amount) const;

    bool isIdentity() const { return inputs.size() == 2 && inputs == outputs; }
};

/// The curve of a channel: two points where nothing but a domain counts.
ChannelShaper shaperOf(const LUT& lut, unsigned channel);

}  // namespace Orlith::LUT
