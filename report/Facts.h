#pragma once

#include <array>

#include "lut/LUT.h"
#include "lut/evaluation/Look.h"

namespace report {

/// How colours go through a table: a method of interpolation, a rule for colours outside.
using Look = Orlith::LUT::ColourWay;

/// What the samples of a table say of it as a whole.
struct Facts {
    Orlith::LUT::RGB min;  ///< smallest and largest sample of each channel; NaN is passed over,
    Orlith::LUT::RGB max;  ///< and is the result where there is nothing else
    std::array<bool, 3> isMonotone = {true, true, true};  ///< each channel along its own axis
};

Facts factsOf(const Orlith::LUT::LUT& lut);

/// Smallest and largest finite sample of each channel; 0 for a channel that has none.
struct FiniteRange {
    Orlith::LUT::RGB min = Orlith::LUT::RGB(0.0F, 0.0F, 0.0F);
    Orlith::LUT::RGB max = Orlith::LUT::RGB(0.0F, 0.0F, 0.0F);

    /// Largest less smallest sample of the channel where that is most.
    double extent() const;
};
FiniteRange finiteRange(const Orlith::LUT::LUT& lut);

/// The largest distance of a table's look from its input, at the inputs of its points; infinite
/// where the look is not a number.
double identityDeviation(const Orlith::LUT::LUT& lut, const Look& look);

}  // namespace report
