#include "report/Facts.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <vector>

#include "lut/evaluation/Range.h"
#include "report/Lines.h"

namespace report {
namespace {

namespace ol = Orlith::LUT;

/// Whether the channel of a line's axis goes one way only; NaN goes no way.
bool isMonotone(const Line& line, unsigned channel) {
    bool rises = true;
    bool falls = true;
    for (int i = 1; i < line.pointCount; ++i) {
        const float before = line.value(i - 1, channel);
        const float here = line.value(i, channel);
        rises = rises && here >= before;
        falls = falls && here <= before;
    }
    return rises || falls;
}

}  // namespace

Facts factsOf(const ol::LUT& lut) {
    Facts facts;
    facts.min.fill(std::numeric_limits<float>::infinity());
    facts.max.fill(-std::numeric_limits<float>::infinity());
    const float* sample = lut.data();
    const std::size_t sampleCount = sample == nullptr ? 0 : ol::pointCount(lut);
    for (std::size_t i = 0; i < sampleCount; ++i) {
        for (unsigned c = 0; c < 3; ++c, ++sample) {
            if (*sample < facts.min[c]) facts.min[c] = *sample;
            if (*sample > facts.max[c]) facts.max[c] = *sample;
        }
    }
    for (unsigned c = 0; c < 3; ++c) {
        if (facts.min[c] > facts.max[c]) {
            facts.min[c] = facts.max[c] = std::numeric_limits<float>::quiet_NaN();
        }
        forEachLine(lut, c, [&](const Line& line) {
            facts.isMonotone[c] = facts.isMonotone[c] && isMonotone(line, c);
        });
    }
    return facts;
}

double FiniteRange::extent() const {
    double extent = 0.0;
    for (unsigned c = 0; c < 3; ++c)
        extent = std::max(extent, static_cast<double>(max[c]) - static_cast<double>(min[c]));
    return extent;
}

FiniteRange finiteRange(const ol::LUT& lut) {
    FiniteRange range;
    const std::size_t sampleCount = lut.data() == nullptr ? 0 : ol::pointCount(lut);
    for (unsigned c = 0; c < 3; ++c) {
        float least = std::numeric_limits<float>::infinity();
        float most = -least;
        for (std::size_t i = 0; i < sampleCount; ++i) {
            const float value = lut.data()[3 * i + c];
            if (!std::isfinite(value)) continue;
            least = std::min(least, value);
            most = std::max(most, value);
        }
        if (least > most) continue;
        range.min[c] = least;
        range.max[c] = most;
    }
    return range;
}

double identityDeviation(const ol::LUT& lut, const Look& look) {
    constexpr std::size_t kBlockFloats = std::size_t{3} * 4096;
    std::vector<float> inputs;
    std::vector<float> outputs;
    double largest = 0.0;
    const auto flush = [&] {
        outputs = inputs;
        look(outputs.data(), outputs.size() / 3);
        for (std::size_t i = 0; i < inputs.size(); ++i) {
            const double deviation =
                std::fabs(static_cast<double>(outputs[i]) - static_cast<double>(inputs[i]));
            if (std::isnan(deviation)) {
                largest = std::numeric_limits<double>::infinity();
            } else {
                largest = std::max(largest, deviation);
            }
        }
        inputs.clear();
    };
    forEachInput(lut, false, [&](const ol::RGB& colour) {
        inputs.insert(inputs.end(), colour.begin(), colour.end());
        if (inputs.size() == kBlockFloats) flush();
    });
    flush();
    return largest;
}

}  // namespace report
