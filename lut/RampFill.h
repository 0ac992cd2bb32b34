#pragma once

#include <vector>

#include "lut/RGB.h"

namespace Orlith::LUT {

/// Fills an array with n entries of a ramp from 0 to max, the same on all three channels.
/// With t = i / (n - 1): fillLinearRamp gives t * max, fillSmoothRamp the smoothstep curve
/// (3t^2 - 2t^3) * max. n below 1 leaves the array empty; n = 1 gives NaN (0/0). The counts of a
/// Shaper that holds the array are the caller's to set.
void fillLinearRamp(std::vector<RGB>& entries, int n, int max);
void fillSmoothRamp(std::vector<RGB>& entries, int n, int max);

}  // namespace Orlith::LUT
