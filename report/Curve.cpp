#include "report/Curve.h"

#include <algorithm>
#include <utility>

#include "lut/evaluation/Look.h"

namespace report {
namespace {

namespace ol = Orlith::LUT;

int stepsPerCell(const ol::LUT& lut, unsigned channel) {
    const int points = lut.is1D() || channel == 0 ? lut.width()
                       : channel == 1             ? lut.height()
                                                  : lut.depth();
    const int cells = std::max(points - 1, 1);
    return (kLeastCurveSteps + cells - 1) / cells;
}

}  // namespace

Curve curveThrough(std::vector<ol::RGB> inputs, unsigned channel, const Look& look) {
    Curve curve;
    curve.channel = channel;
    curve.inputs = std::move(inputs);
    const std::size_t count = curve.inputs.size();
    curve.outputs = curve.inputs;
    curve.slopes.resize(count);
    if (count == 0) return curve;
    look(curve.outputs.front().data_block(), count);
    for (std::size_t i = 0; i < count; ++i) {
        const std::size_t before = i == 0 ? 0 : i - 1;
        const std::size_t after = std::min(i + 1, count - 1);
        const float width =
            curve.inputs[after][curve.channel] - curve.inputs[before][curve.channel];
        for (unsigned c = 0; c < 3; ++c)
            curve.slopes[i][c] = (curve.outputs[after][c] - curve.outputs[before][c]) / width;
    }
    return curve;
}

Curve neutralAxis(const ol::LUT& lut, const Look& look) {
    constexpr unsigned kGreen = 1;
    const ol::Range domain = inputRangeOf(lut);
    const float least = domain.min.max_value();
    const float most = domain.max.min_value();
    const ol::ChannelInputs inputs = inputsAlong(lut, stepsPerCell(lut, kGreen));
    std::vector<ol::RGB> colours;
    for (const float input : inputs[kGreen]) {
        if (input >= least && input <= most) colours.emplace_back(input, input, input);
    }
    Curve curve = curveThrough(std::move(colours), kGreen, look);
    curve.stepsPerCell = stepsPerCell(lut, kGreen);
    return curve;
}

Curve channelAxis(const ol::LUT& lut, const Look& look, unsigned channel) {
    const ol::Range domain = inputRangeOf(lut);
    ol::RGB colour;
    for (unsigned c = 0; c < 3; ++c)
        colour[c] = std::max(std::min(0.0F, domain.max[c]), domain.min[c]);
    const ol::ChannelInputs inputs = inputsAlong(lut, stepsPerCell(lut, channel));
    std::vector<ol::RGB> colours;
    colours.reserve(inputs[channel].size());
    for (const float input : inputs[channel]) {
        colour[channel] = input;
        colours.push_back(colour);
    }
    Curve curve = curveThrough(std::move(colours), channel, look);
    curve.stepsPerCell = stepsPerCell(lut, channel);
    return curve;
}

}  // namespace report
