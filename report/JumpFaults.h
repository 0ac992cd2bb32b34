#pragma once

#include <vector>

#include "report/Facts.h"
#include "report/Fault.h"
#include "report/PointInputs.h"

namespace report {

/// The jumps of a table, each row of points' largest, gathered into places; the largest first.
std::vector<Fault> jumpFaults(const Orlith::LUT::LUT& lut, const PointInputs& inputs,
                              const FiniteRange& range);

}  // namespace report
