#pragma once

#include <array>
#include <cstddef>

#include "lut/evaluation/PaddedLattice.h"
#include "lut/evaluation/Placement.h"

namespace Orlith::LUT {

/// One method, many colours at once: to the bit what the method's function in LatticeMethods gives
/// where the placement finds the point.
///
/// @param points   3 * count floats behind the pre-LUT
/// @param results  as many; the same array, or one that does not overlap it
using LatticeVectorMethod = void (*)(const PaddedLattice& lattice, const Placement& placement,
                                     const float* points, float* results, std::size_t count);

/// In the order of Evaluator::Method. The cubic method takes Lines, the others Samples.
using LatticeVectors = std::array<LatticeVectorMethod, 5>;

/// Samples beyond this, and what is no number, are not for the cubic method in vectors: it skips
/// roundings that only a number near the greatest one shows.
constexpr float kMostForCubicVectors = 1e36F;

/// The methods in vectors of this processor, or null when it has none that are worth it.
const LatticeVectors* latticeVectors();

}  // namespace Orlith::LUT
