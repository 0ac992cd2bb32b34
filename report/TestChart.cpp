#include "report/TestChart.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <iterator>

namespace report {
namespace {

using Colour = std::array<float, 3>;

// Two rows of twelve: skins from light to dark and greys of stone; then plants, sky, fabrics.
constexpr Colour kPatches[2][12] = {{{0.95F, 0.82F, 0.74F},
                                     {0.89F, 0.71F, 0.60F},
                                     {0.80F, 0.60F, 0.48F},
                                     {0.66F, 0.46F, 0.35F},
                                     {0.50F, 0.33F, 0.25F},
                                     {0.34F, 0.23F, 0.18F},
                                     {0.22F, 0.15F, 0.12F},
                                     {0.90F, 0.88F, 0.83F},
                                     {0.72F, 0.68F, 0.62F},
                                     {0.50F, 0.50F, 0.50F},
                                     {0.34F, 0.35F, 0.37F},
                                     {0.16F, 0.16F, 0.18F}},
                                    {{0.32F, 0.42F, 0.20F},
                                     {0.52F, 0.62F, 0.28F},
                                     {0.20F, 0.34F, 0.24F},
                                     {0.53F, 0.70F, 0.87F},
                                     {0.30F, 0.48F, 0.72F},
                                     {0.16F, 0.26F, 0.46F},
                                     {0.78F, 0.16F, 0.15F},
                                     {0.93F, 0.55F, 0.14F},
                                     {0.96F, 0.84F, 0.22F},
                                     {0.13F, 0.58F, 0.56F},
                                     {0.49F, 0.27F, 0.58F},
                                     {0.86F, 0.38F, 0.55F}}};

/// A pure hue: 0 red, 1/3 green, 2/3 blue.
Colour hueOf(float turn) {
    const auto channel = [&](float offset) {
        const float place = std::fmod(turn + offset, 1.0F) * 6.0F;
        return std::clamp(std::fabs(place - 3.0F) - 1.0F, 0.0F, 1.0F);
    };
    return {channel(0.0F), channel(2.0F / 3.0F), channel(1.0F / 3.0F)};
}

Colour hueSweep(float x, float y) {
    Colour colour = hueOf(x);
    for (float& value : colour)
        value = y < 0.5F ? 1.0F + (value - 1.0F) * 2.0F * y : value * 2.0F * (1.0F - y);
    return colour;
}

Colour grey(float value) {
    return {value, value, value};
}

Colour steps(float x) {
    constexpr float kCount = 17.0F;  // sixteenths
    return grey(std::min(std::floor(x * kCount), kCount - 1.0F) / (kCount - 1.0F));
}

Colour patch(float x, float y) {
    const auto row = static_cast<std::size_t>(std::min(y * 2.0F, 1.0F));
    const auto column = static_cast<std::size_t>(std::min(x * 12.0F, 11.0F));
    return kPatches[row][column];
}

/// @param x, y  from 0 to 1, from the left and from the top
Colour colourAt(float x, float y) {
    if (y < 0.44F) return hueSweep(x, y / 0.44F);
    if (y < 0.53F) return grey(x);
    if (y < 0.61F) return steps(x);
    if (y < 0.66F) return {x, 0.0F, 0.0F};
    if (y < 0.71F) return {0.0F, x, 0.0F};
    if (y < 0.76F) return {0.0F, 0.0F, x};
    return patch(x, (y - 0.76F) / 0.24F);
}

}  // namespace

Picture testChart(int width, int height) {
    Picture chart{width, height, {}};
    for (int line = 0; line < height; ++line) {
        for (int column = 0; column < width; ++column) {
            const Colour colour =
                colourAt(static_cast<float>(column) / static_cast<float>(width - 1),
                         static_cast<float>(line) / static_cast<float>(height - 1));
            chart.pixels.insert(chart.pixels.end(), colour.begin(), colour.end());
        }
    }
    return chart;
}

}  // namespace report
