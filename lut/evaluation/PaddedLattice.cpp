#include "lut/evaluation/PaddedLattice.h"

#include <new>

namespace Orlith::LUT {
namespace {

constexpr int kBelow = 1;
constexpr int kAbove = 2;

/// A whole vector is loaded where the last sample is.
constexpr std::size_t kSlack = 16;

std::size_t paddedSide(const Lattice& lattice, unsigned axis) {
    return static_cast<std::size_t>(lattice.last(axis)) + 1 + kBelow + kAbove;
}

}  // namespace

std::size_t PaddedLattice::floatCount(const Lattice& lattice) {
    // Three sides of 31 bits do not fit; two and the bound do.
    const std::size_t plane = paddedSide(lattice, 0) * paddedSide(lattice, 1);
    return plane > kMostFloats ? plane : plane * paddedSide(lattice, 2) * 4;
}

PaddedLattice::PaddedLattice(const Lattice& lattice, Border border)
    : floats_(hwy::AllocateAligned<float>(floatCount(lattice) + kSlack)), first_(floats_.get()) {
    if (!floats_) throw std::bad_alloc();
    const auto sample = [&](int r, int g, int b) {
        if (border == Border::Extrapolated) return extrapolatedSample(lattice, r, g, b);
        return RGB(lattice.sample(lattice.clamp(0, r), lattice.clamp(1, g), lattice.clamp(2, b)));
    };
    float* place = floats_.get();
    for (int b = -kBelow; b <= lattice.last(2) + kAbove; ++b) {
        for (int r = -kBelow; r <= lattice.last(0) + kAbove; ++r) {
            for (int g = -kBelow; g <= lattice.last(1) + kAbove; ++g, place += 4) {
                sample(r, g, b).copy_out(place);
                place[3] = 0.0F;
            }
        }
    }
    std::fill_n(place, kSlack, 0.0F);
    strides_[1] = 4;
    strides_[0] = strides_[1] * static_cast<std::int32_t>(paddedSide(lattice, 1));
    strides_[2] = strides_[0] * static_cast<std::int32_t>(paddedSide(lattice, 0));
    for (const std::int32_t stride : strides_)
        first_ += std::ptrdiff_t{kBelow} * stride;
}

}  // namespace Orlith::LUT
