#pragma once

#include "lut/LUT.h"

namespace Orlith::LUT {

// The pre-LUT of .cub and .cms files leads inputs from 0 to 1 to places in the lattice.

/// A table's pre-LUT in units of the lattice, 0 to N - 1 on each channel; empty for a table that
/// has none and covers 0 to 1.
/// @throws Exception  it cannot be held: inputs other than 0 to 1, or other counts on each channel
Shaper preLUTOfTruelight(const LUT& lut);

/// The same in units of 0 to N, which the format's readers divide by N; a line from 0 to N for a
/// table without a pre-LUT.
/// @param lut         of equal sides
/// @throws Exception  as above
Shaper preLUTOfCMS(const LUT& lut);

}  // namespace Orlith::LUT
