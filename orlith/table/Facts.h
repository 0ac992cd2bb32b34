#pragma once

#include <array>
#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>

#include "lut/LUT.h"

namespace orlith {

/// The input colour that a place of a table stands for: lattice point (r, g, b), or entry i of a
/// curve on all three channels.
Orlith::LUT::RGB inputColour(const Orlith::LUT::LUT& lut, int r, int g, int b);

/// What the samples of a table say of it as a whole.
struct Facts {
    Orlith::LUT::RGB min;  ///< smallest and largest sample of each channel; NaN is passed over,
    Orlith::LUT::RGB max;  ///< and is the result where there is nothing else
    std::array<bool, 3> isMonotone = {true, true, true};  ///< each channel along its own axis
};

/// The largest distance of a table's look from its input, at the inputs of its points; infinite
/// where the look is not a number.
double identityDeviation(const boost::shared_ptr<const Orlith::LUT::LUT>& lut);

Facts factsOf(const Orlith::LUT::LUT& lut);

}  // namespace orlith
