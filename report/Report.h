#pragma once

#include <array>
#include <boost/smart_ptr/shared_ptr.hpp>
#include <vector>

#include "lut/LUT.h"
#include "lut/evaluation/Range.h"
#include "report/Curve.h"
#include "report/Facts.h"
#include "report/Fault.h"

namespace report {

/// What there is to see of a table.
struct Report {
    Orlith::LUT::Range domain;  ///< the inputs that it tells apart
    Facts facts;
    double identityDeviation = 0.0;  ///< see there; of the look
    Curve neutral;
    std::array<Curve, 3> channels;  ///< each channel's own axis, the others at 0
    std::vector<Fault> faults;      ///< by kind, the largest jump first
};

/// Looks at a table. Samples that are not finite are a fault, and hide no other.
/// @param look  how colours go through it; for the curves, clips, tints and the deviation
Report reportOn(const Orlith::LUT::LUT& lut, const Look& look);

/// Likewise, as its maker means it: trilinear, colours outside clamped to the domain.
Report reportOn(const boost::shared_ptr<const Orlith::LUT::LUT>& lut);

}  // namespace report
