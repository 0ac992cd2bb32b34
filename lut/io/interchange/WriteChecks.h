#pragma once

#include "lut/LUT.h"

namespace Orlith::LUT {

// What a format cannot hold of a table may not go unsaid when it is written as meant: the file
// would show other colours.

/// Whether a side of the pre-LUT leaves every input from 0 to 1 as it is.
bool isRamp(const Shaper& shaper);

/// @throws Exception  a side of one point, or a domain that does not rise
void expectDomain(const LUT& lut);

/// @throws Exception  a pre-LUT that changes colours
void expectNoPreLUT(const LUT& lut);

/// @throws Exception  another domain than 0 to 1
void expectUnitDomain(const LUT& lut);

}  // namespace Orlith::LUT
