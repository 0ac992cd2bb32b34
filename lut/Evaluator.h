#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <cstddef>

#include "lut/LUT.h"

namespace Orlith::LUT {

/// Sends many colours through one table.
///
/// Every colour goes through the pre-LUT, then to a position between the table's points, then
/// through the method:
/// - A lattice: within the domain the result is bit for bit that of LUT::interpolate.
/// - A curve, whatever the method: that of LUT::interpolate for the colour behind the pre-LUT, from
///   0 to 1. A channel whose transform is not exactly that of setUnitDomain
///   (scale 1 / (N - 1) in single precision, offset 0) has a domain of its own, and is looked up at
///   (p - offset) / (scale * (N - 1)) instead.
/// - A table without samples gives zeros.
///
/// Threads  apply may run any number of times at once.
/// Memory   with the first many colours a copy of the table is made, which the Evaluator's copies
///          share: a third larger than the table (cubic: nearly three times as large), or more
///          where sides are short; not of lattices of more than 158 points a side.
class Evaluator {
public:
    enum class Method {
        Step,
        Staggered,
        Trilinear,
        Tetrahedral,  ///< the four corners of the cell's tetrahedron: see TetrahedralInterpolate
        Cubic
    };

    /// What a colour outside the domain, or one that is not a number, gives.
    enum class Outside {
        Clamp,       ///< the colour at the nearest position of the table; NaN counts as its first
        Extrapolate  ///< what LUT::interpolate with its flag gives: curves stay at their ends
    };

    /// @param table  kept alive; must not change from now on
    explicit Evaluator(boost::shared_ptr<const LUT> table, Method method = Method::Trilinear,
                       Outside outside = Outside::Clamp);

    /// @param rgbIn   3 * colourCount floats r, g, b, r, g, b, ...
    /// @param rgbOut  as many; the same array, or one that does not overlap it
    void apply(const float* rgbIn, float* rgbOut, std::size_t colourCount) const;

private:
    struct Preparation;

    boost::shared_ptr<const LUT> table_;
    Method method_;
    Outside outside_;
    boost::shared_ptr<Preparation> preparation_;
};

}  // namespace Orlith::LUT
