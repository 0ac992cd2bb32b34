#pragma once

#include <vector>

#include "lut/LUT.h"
#include "report/Facts.h"

namespace report {

/// A line through the colours of a table's domain, and what the table makes of it.
struct Curve {
    unsigned channel = 0;  ///< one that rises along the line: green for the neutral axis
    int stepsPerCell = 1;  ///< from one point of the table to the next, where samples are at points
    std::vector<Orlith::LUT::RGB> inputs;
    std::vector<Orlith::LUT::RGB> outputs;
    /// Change of each output for a change of the channel's input: between the neighbours, at the
    /// ends to the only one. Not finite where the inputs or outputs do not allow it.
    std::vector<Orlith::LUT::RGB> slopes;
};

/// The curve through colours that a channel rises along.
Curve curveThrough(std::vector<Orlith::LUT::RGB> inputs, unsigned channel, const Look& look);

/// The curves of tables have a sample at each point of the table, and as many in between as make
/// this number of steps: enough to draw.
constexpr int kLeastCurveSteps = 256;

/// Equal inputs on all channels, where all of them have a domain: at the points of the green axis;
/// behind a pre-LUT at places evenly spaced along it.
Curve neutralAxis(const Orlith::LUT::LUT& lut, const Look& look);

/// Likewise for one channel alone; the others are at 0, or at the end of their domain next to it.
Curve channelAxis(const Orlith::LUT::LUT& lut, const Look& look, unsigned channel);

}  // namespace report
