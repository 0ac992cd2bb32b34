#pragma once

#include <cstddef>

#include "lut/RGB.h"

namespace Orlith::LUT {

// One channel of a list of triples as a curve. What a count claims and what is stored may differ:
// no element beyond those stored is read.

/// Looks t in [0, 1] up in one channel of a curve by linear interpolation; clamps outside.
///
/// @param entries     the curve; at least one
/// @param entryCount  entries stored; no element beyond is read
/// @param channel     0 to 2
/// @param points      points of the curve on this channel, which may differ from entryCount
float interpolateCurve(const RGB* entries, std::size_t entryCount, unsigned channel, float points,
                       float t);

/// Finds a value among the ascending entries of a curve, by a search from the first one on.
/// @return its position from 0, at or below the first entry, to 1, at or above the last. The
///         parameters are those of interpolateCurve.
float locateInCurve(const RGB* entries, std::size_t entryCount, unsigned channel, float points,
                    float value);

}  // namespace Orlith::LUT
