#pragma once

#include <algorithm>
#include <array>
#include <cstddef>
#include <cstdint>

#include "lut/LUT.h"

namespace Orlith::LUT {

/// The lattice as evaluation sees it: sizes, and samples that are read within their bounds only.
class Lattice {
public:
    /// @param lut  no curve; its samples must stay where they are
    explicit Lattice(const LUT& lut)
        : last_{lut.width() - 1, lut.height() - 1, lut.depth() - 1}, samples_(lut.data()) {
        // Only with samples: two huge sides and a third of 0 would overflow.
        if (!empty()) lastElement_ = (last_[0] + 1) * (last_[1] + 1) * (last_[2] + 1) - 1;
    }

    bool empty() const { return samples_ == nullptr; }

    int last(unsigned axis) const { return last_[axis]; }
    int clamp(unsigned axis, int index) const { return std::max(0, std::min(index, last_[axis])); }
    bool inside(unsigned axis, int index) const { return 0 <= index && index <= last_[axis]; }

    /// The three floats of sample (r, g, b). Indices may lie outside the lattice: the element that
    /// they come to, in wrapping 32-bit arithmetic, is limited to those stored.
    const float* sample(int r, int g, int b) const {
        const auto element = static_cast<std::int32_t>(
            (unsigned(b) * unsigned(last_[1] + 1) + unsigned(g)) * unsigned(last_[0] + 1) +
            unsigned(r));
        return samples_ + 3 * static_cast<std::ptrdiff_t>(std::clamp(element, 0, lastElement_));
    }

private:
    std::array<int, 3> last_{};  // index of the last point on each axis
    int lastElement_ = -1;
    const float* samples_ = nullptr;
};

/// A place between lattice points, in cells along red, green and blue.
using LatticePosition = std::array<float, 3>;

/// Where a point in input coordinates lies: x_c = (p_c - offset_c) / scale_c.
inline LatticePosition latticePosition(const LUT& lut, const RGB& point) {
    LatticePosition x;
    for (unsigned c = 0; c < 3; ++c)
        x[c] = (point[c] - lut.transform[3][c]) / lut.transform[c][c];
    return x;
}

// The methods, one colour at a time. The lattice must not be empty. Single precision throughout,
// every operation in the order that the code shows: other code promises the same bits.

/// See StepInterpolate.
RGB stepAt(const Lattice& lattice, const LatticePosition& x);

/// See LinearStaggeredInterpolate.
RGB staggeredAt(const Lattice& lattice, const LatticePosition& x);

/// See TrilinearInterpolate.
RGB trilinearAt(const Lattice& lattice, const LatticePosition& x);

/// See TetrahedralInterpolate.
RGB tetrahedralAt(const Lattice& lattice, const LatticePosition& x);

/// See CubicInterpolate.
RGB cubicAt(const Lattice& lattice, const LatticePosition& x);

/// See Extrapolate.
RGB extrapolatedSample(const Lattice& lattice, int r, int g, int b);

}  // namespace Orlith::LUT
