#pragma once

#include <vector>

#include "lut/LUT.h"
#include "report/Fault.h"

namespace report {

/// Faults that show in a table's own samples: NotFinite, Fold and Jump. The pre-LUT counts for the
/// inputs at which they are.
std::vector<Fault> sampleFaults(const Orlith::LUT::LUT& lut);

}  // namespace report
