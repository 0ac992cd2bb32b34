#pragma once

#include <hwy/aligned_allocator.h>

#include <array>
#include <cstddef>
#include <cstdint>

#include "lut/evaluation/LatticeMethods.h"

namespace Orlith::LUT {

/// A copy of a lattice, laid out for vectors: four floats a sample (the fourth is 0), green
/// fastest, then red, and one sample more below every axis and two more above, so that every
/// neighbour that a method asks for is stored where its index says.
class PaddedLattice {
public:
    /// What stands around the lattice.
    enum class Border {
        Nearest,      ///< the nearest sample
        Extrapolated  ///< see extrapolatedSample
    };

    /// Larger lattices cannot be copied: up to this many floats their places are whole numbers in
    /// single precision. That is 158 points a side and 64 MiB, where 129 points are in use; what a
    /// small file claims beyond is not worth as much memory.
    static constexpr std::size_t kMostFloats = std::size_t{1} << 24;

    /// Floats that the copy of a lattice takes.
    static std::size_t floatCount(const Lattice& lattice);

    /// @param lattice  not empty, of at most kMostFloats
    /// @throws std::bad_alloc
    PaddedLattice(const Lattice& lattice, Border border);

    /// The first sample of the lattice itself.
    const float* first() const { return first_; }

    /// Floats from one sample to the next along red, green or blue.
    std::int32_t stride(unsigned axis) const { return strides_[axis]; }

private:
    std::array<std::int32_t, 3> strides_;
    hwy::AlignedFreeUniquePtr<float[]> floats_;
    const float* first_;
};

}  // namespace Orlith::LUT
