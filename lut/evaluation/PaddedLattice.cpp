#include "lut/evaluation/PaddedLattice.h"

#include <algorithm>
#include <new>
#include <vector>

namespace Orlith::LUT {
namespace {

constexpr int kBelow = 1;
constexpr int kAbove = 2;

constexpr std::size_t kSamplesInLine = 5;

std::size_t paddedSide(const Lattice& lattice, unsigned axis) {
    return static_cast<std::size_t>(lattice.last(axis)) + 1 + kBelow + kAbove;
}

}  // namespace

std::size_t PaddedLattice::sampleCount(const Lattice& lattice) {
    // Three sides of 31 bits do not fit; two and the bound do.
    const std::size_t plane = paddedSide(lattice, 0) * paddedSide(lattice, 1);
    return plane > kMostSamples ? plane : plane * paddedSide(lattice, 2);
}

PaddedLattice::PaddedLattice(const Lattice& lattice, Layout layout) {
    const bool inLines = layout == Layout::Lines;
    const std::size_t samples = paddedSide(lattice, 1);
    // A unit is a sample, or a line. The last line begins with the last sample's lower neighbour or
    // with the one below that.
    const std::size_t units = inLines ? static_cast<std::size_t>(lattice.last(1)) / 2 + 1 : samples;
    const std::size_t unit = inLines ? kFloatsInLine : kFloatsInSample;
    const std::size_t samplesInUnit = inLines ? kSamplesInLine : 1;
    const std::size_t row = units * unit;
    const std::size_t plane = row * paddedSide(lattice, 0);
    const std::size_t size = plane * paddedSide(lattice, 2);
    floats_ = hwy::AllocateAligned<float>(size);
    if (!floats_) throw std::bad_alloc();
    std::fill_n(floats_.get(), size, 0.0F);

    // One more, for a line that ends behind the row.
    std::vector<RGB> along(samples + 1, RGB(0.0F, 0.0F, 0.0F));
    float* place = floats_.get();
    for (int b = -kBelow; b <= lattice.last(2) + kAbove; ++b) {
        for (int r = -kBelow; r <= lattice.last(0) + kAbove; ++r) {
            auto next = along.begin();
            for (int g = -kBelow; g <= lattice.last(1) + kAbove; ++g) {
                *next++ = inLines ? extrapolatedSample(lattice, r, g, b)
                                  : RGB(lattice.sample(lattice.clamp(0, r), lattice.clamp(1, g),
                                                       lattice.clamp(2, b)));
            }
            for (std::size_t i = 0; i < units; ++i, place += unit) {
                const RGB* const first = &along[inLines ? 2 * i : i];
                for (std::size_t k = 0; k < samplesInUnit; ++k)
                    first[k].copy_out(place + 3 * k);
            }
        }
    }
    strides_ = {static_cast<std::int32_t>(row), static_cast<std::int32_t>(unit),
                static_cast<std::int32_t>(plane)};
    first_ = floats_.get() + kBelow * (plane + row + (inLines ? 0 : unit));
}

}  // namespace Orlith::LUT
