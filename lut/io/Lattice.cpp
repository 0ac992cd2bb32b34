#include "lut/io/Lattice.h"

#include <algorithm>
#include <vector>

namespace Orlith::LUT {
namespace {

void swapSamples(float* samples, std::size_t a, std::size_t b) {
    std::swap_ranges(samples + 3 * a, samples + 3 * a + 3, samples + 3 * b);
}

/// In a cube, samples change places in pairs. What is behind the samples are zeros, and those that
/// come to the front in exchange belong there.
void placeInCube(float* samples, const LatticeSize& size, std::size_t sampleCount) {
    std::size_t index = 0;
    whileBlueFastest(size, [&](std::size_t element) {
        if (index == sampleCount) return false;
        if (element > index) swapSamples(samples, index, element);
        ++index;
        return true;
    });
}

/// Elsewhere they change places round circles of any length.
void placeInAny(float* samples, const LatticeSize& size) {
    const auto height = static_cast<std::size_t>(size.height);
    const auto depth = static_cast<std::size_t>(size.depth);
    const auto placeOf = [&](std::size_t index) {
        const std::size_t b = index % depth;
        const std::size_t g = index / depth % height;
        const std::size_t r = index / depth / height;
        return (b * height + g) * static_cast<std::size_t>(size.width) + r;
    };
    std::vector<bool> isPlaced(size.pointCount());
    for (std::size_t start = 0; start < isPlaced.size(); ++start) {
        if (isPlaced[start]) continue;
        // The sample in hand lies at the start of the circle, which closes with the one for there.
        for (std::size_t index = placeOf(start); index != start; index = placeOf(index)) {
            swapSamples(samples, start, index);
            isPlaced[index] = true;
        }
    }
}

}  // namespace

void placeBlueFastest(LUT& lut, std::size_t sampleCount) {
    const LatticeSize size = LatticeSize::of(lut);
    if (size.isCube()) {
        placeInCube(lut.data(), size, sampleCount);
    } else {
        placeInAny(lut.data(), size);
    }
}

}  // namespace Orlith::LUT
