#include "report/PointInputs.h"

#include <algorithm>

namespace report {
namespace {

namespace ol = Orlith::LUT;

constexpr int kLeastSearchSteps = 4096;

/// What a pre-LUT sends to the points of a channel, found among inputs along it.
std::vector<float> behindShaper(const ol::LUT& lut, unsigned channel,
                                const std::vector<float>& along, int pointCount) {
    // From a position behind the pre-LUT to an index.
    const float scale = lut.transform[channel][channel];
    const float offset = lut.transform[3][channel];
    const auto indexAt = [&](std::size_t i) {
        const ol::RGB grey(along[i], along[i], along[i]);
        return (lut.applyShaper(grey)[channel] - offset) / scale;
    };
    std::vector<float> inputs;
    std::size_t above = 0;
    float index = indexAt(0);
    float indexBefore = index;
    for (int point = 0; point < pointCount; ++point) {
        const auto wanted = static_cast<float>(point);
        while (!(index >= wanted) && above + 1 < along.size()) {
            indexBefore = index;
            index = indexAt(++above);
        }
        const float from = along[above == 0 ? 0 : above - 1];
        const float width = index - indexBefore;
        const float part = width > 0.0F ? (wanted - indexBefore) / width : 1.0F;
        inputs.push_back(from + (along[above] - from) * std::clamp(part, 0.0F, 1.0F));
    }
    return inputs;
}

}  // namespace

PointInputs::PointInputs(const ol::LUT& lut) : inputs_(inputsAlong(lut, 1)) {
    if (lut.inputShaper.empty() && lut.outputShaper.empty()) return;
    for (unsigned c = 0; c < 3; ++c) {
        const int pointCount = static_cast<int>(inputs_[c].size());
        if (pointCount < 2) continue;
        const int steps = (kLeastSearchSteps + pointCount - 2) / (pointCount - 1);
        inputs_[c] = behindShaper(lut, c, inputsAlong(lut, steps)[c], pointCount);
    }
}

ol::RGB PointInputs::at(const Point& point) const {
    ol::RGB colour;
    for (unsigned c = 0; c < 3; ++c)
        colour[c] = inputs_[c][static_cast<std::size_t>(point[c])];
    return colour;
}

}  // namespace report
