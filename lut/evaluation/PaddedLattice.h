#pragma once

#include <hwy/aligned_allocator.h>

#include <array>
#include <cstddef>
#include <cstdint>

#include "lut/evaluation/LatticeMethods.h"

namespace Orlith::LUT {

/// A copy of a lattice, laid out for vectors: green fastest, then red, and one sample more below
/// every axis and two more above, so that every neighbour that a method asks for is stored where
/// its index says.
class PaddedLattice {
public:
    enum class Layout {
        /// Four floats a sample, the fourth is 0. Around the lattice stands the nearest sample.
        Samples,
        /// Cache lines of five samples and a 0, each of which begins two samples after the one
        /// before it: any four neighbours along green share a line. Around the lattice stands what
        /// extrapolatedSample gives.
        Lines
    };

    static constexpr int kFloatsInSample = 4;
    static constexpr int kFloatsInLine = 16;

    /// Larger lattices cannot be copied: up to this many samples, those around the lattice
    /// included, their places are whole numbers in the mantissa of a float. That is 158 points a
    /// side and 64 MiB (Lines: 128), where 129 points are in use; what a small file claims beyond
    /// is not worth as much memory.
    static constexpr std::size_t kMostSamples = std::size_t{1} << 22;

    /// Samples that the copy of a lattice has, those around it included; some number beyond
    /// kMostSamples when there are more.
    static std::size_t sampleCount(const Lattice& lattice);

    /// @param lattice  not empty, of at most kMostSamples
    /// @throws std::bad_alloc
    PaddedLattice(const Lattice& lattice, Layout layout);

    /// The first sample of the lattice itself; of Lines, the line that begins with the sample below
    /// it along green.
    const float* first() const { return first_; }

    /// Floats from one sample to the next along red, green or blue; of Lines, from one line to the
    /// next.
    std::int32_t stride(unsigned axis) const { return strides_[axis]; }

private:
    std::array<std::int32_t, 3> strides_;
    hwy::AlignedFreeUniquePtr<float[]> floats_;
    const float* first_;
};

}  // namespace Orlith::LUT
