#include "report/PageGrid.h"

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <nlohmann/json.hpp>

#include "lut/evaluation/Range.h"
#include "report/Base64.h"
#include "report/PointInputs.h"

namespace report {
namespace {

namespace ol = Orlith::LUT;

// Points a side of one table, and of each of two: with the libraries a page stays below 4 MB.
constexpr std::size_t kMostPoints = 65;
constexpr std::size_t kMostPointsOfTwo = 51;

// Curves have no lattice; this many steps show what they do to colours.
constexpr int kCurveSteps = 16;

/// At most so many of a list, with its first and last: every second, third, ... where that comes
/// out even, otherwise the nearest to even places.
std::vector<float> thinned(const std::vector<float>& list, std::size_t most) {
    if (list.size() <= most) return list;
    const std::size_t steps = list.size() - 1;
    const std::size_t stride = (steps + most - 2) / (most - 1);
    const std::size_t count = steps % stride == 0 ? steps / stride : most - 1;
    std::vector<float> kept;
    kept.reserve(count + 1);
    for (std::size_t i = 0; i <= count; ++i)
        kept.push_back(list[(i * steps + count / 2) / count]);
    return kept;
}

std::uint16_t codeOf(float value, const Extent& extent) {
    constexpr double kCodeMax = 65534.0;
    constexpr std::uint16_t kNoNumber = 65535;
    if (!std::isfinite(value)) return kNoNumber;
    const auto min = static_cast<double>(extent.min);
    const double part =
        (static_cast<double>(value) - min) / (static_cast<double>(extent.max) - min);
    return static_cast<std::uint16_t>(std::lround(std::clamp(part, 0.0, 1.0) * kCodeMax));
}

}  // namespace

PageGrid gridOf(const std::vector<PageTable>& tables) {
    const ol::LUT& first = *tables.front().lut;
    const ol::LUT& last = *tables.back().lut;
    const ol::LUT& lut = pointCount(last) > pointCount(first) && !last.is1D() ? last : first;
    const std::size_t most = tables.size() == 1 ? kMostPoints : kMostPointsOfTwo;
    PageGrid grid;
    if (lut.is1D()) {
        const int steps = (kCurveSteps + lut.width() - 2) / (lut.width() - 1);
        grid.inputs = inputsAlong(lut, steps);
        for (auto& inputs : grid.inputs)
            inputs = thinned(inputs, kCurveSteps + 1);
        return grid;
    }
    grid.inputs = PointInputs(lut).along();
    for (auto& inputs : grid.inputs)
        inputs = thinned(inputs, most);
    return grid;
}

std::vector<ol::RGB> PageGrid::outputs(const Look& look) const {
    std::vector<ol::RGB> colours;
    colours.reserve(inputs[0].size() * inputs[1].size() * inputs[2].size());
    for (const float b : inputs[2]) {
        for (const float g : inputs[1]) {
            for (const float r : inputs[0])
                colours.emplace_back(r, g, b);
        }
    }
    look(colours.front().data_block(), colours.size());
    return colours;
}

nlohmann::json PageGrid::json() const {
    nlohmann::json sizes;
    nlohmann::json least;
    nlohmann::json most;
    for (const auto& channel : inputs) {
        sizes.push_back(channel.size());
        least.push_back(channel.front());
        most.push_back(channel.back());
    }
    return {{"size", sizes}, {"inputs", inputs}, {"min", least}, {"max", most}};
}

Extent extentOf(const std::vector<ol::RGB>& colours) {
    Extent extent{INFINITY, -INFINITY};
    for (const ol::RGB& colour : colours) {
        for (unsigned c = 0; c < 3; ++c) {
            if (!std::isfinite(colour[c])) continue;
            extent.min = std::min(extent.min, colour[c]);
            extent.max = std::max(extent.max, colour[c]);
        }
    }
    if (extent.min > extent.max) return {};
    if (extent.min == extent.max) extent.max = extent.min + 1.0F;
    return extent;
}

std::string codesOf(const std::vector<ol::RGB>& colours, const Extent& extent) {
    std::vector<std::uint16_t> codes;
    codes.reserve(3 * colours.size());
    for (const ol::RGB& colour : colours) {
        for (unsigned c = 0; c < 3; ++c)
            codes.push_back(codeOf(colour[c], extent));
    }
    return base64(codes.data(), codes.size() * sizeof(std::uint16_t));
}

double largestDistance(const std::vector<ol::RGB>& a, const std::vector<ol::RGB>& b) {
    double largest = 0.0;
    for (std::size_t i = 0; i < a.size(); ++i) {
        for (unsigned c = 0; c < 3; ++c) {
            const double distance =
                std::fabs(static_cast<double>(a[i][c]) - static_cast<double>(b[i][c]));
            if (std::isfinite(distance)) largest = std::max(largest, distance);
        }
    }
    return largest;
}

}  // namespace report
