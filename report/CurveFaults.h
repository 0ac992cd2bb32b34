#pragma once

#include <array>
#include <vector>

#include "report/Curve.h"
#include "report/Facts.h"
#include "report/Fault.h"

namespace report {

/// Faults that show along the axes: Clip and Tint.
/// @param channels  each channel's own axis; of a curve they are the neutral one's
std::vector<Fault> curveFaults(const Curve& neutral, const std::array<Curve, 3>& channels,
                               const FiniteRange& range);

}  // namespace report
