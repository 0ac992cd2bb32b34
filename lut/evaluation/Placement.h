#pragma once

#include <array>

#include "lut/evaluation/LatticeMethods.h"

namespace Orlith::LUT {

/// Finds colours behind the pre-LUT in a lattice, and limits them to it.
struct Placement {
    /// @param lut  a lattice that is not empty
    explicit Placement(const LUT& lut);

    /// (p - offset) / scale, but 0 for what is less or NaN, and `last` for what is more.
    LatticePosition operator()(const RGB& point) const {
        LatticePosition x;
        for (unsigned c = 0; c < 3; ++c) {
            x[c] = (point[c] - offset[c]) / scale[c];
            if (!(x[c] >= 0.0F)) x[c] = 0.0F;
            if (x[c] > last[c]) x[c] = last[c];
        }
        return x;
    }

    std::array<float, 3> offset;
    std::array<float, 3> scale;

    /// The last index on each axis. Where dividing the last point's input by the scale rounds
    /// upwards, it is that quotient: such a colour is within the domain and evaluated where it
    /// falls.
    LatticePosition last;

    /// Whether every colour within the domain is evaluated where it falls: not where the domain's
    /// last point rounds a cell or more beyond the lattice.
    bool holdsDomain = true;
};

/// Finds colours behind the pre-LUT in a curve: 0 is its first point, 1 the last.
class CurvePlacement {
public:
    /// @param lut         a curve that is not empty
    /// @param replaceNaN  by the first point
    CurvePlacement(const LUT& lut, bool replaceNaN);

    /// The input itself, if the transform is that of setUnitDomain on this channel; otherwise
    /// (p - offset) / (scale * (N - 1)). Not limited to the curve.
    float operator()(unsigned channel, float input) const;

private:
    std::array<bool, 3> isUnit_;
    std::array<float, 3> offset_;
    std::array<float, 3> length_;
    bool replaceNaN_;
};

}  // namespace Orlith::LUT
