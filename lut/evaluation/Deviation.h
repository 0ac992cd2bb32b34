#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>

#include "lut/LUT.h"
#include "lut/evaluation/Look.h"

namespace Orlith::LUT {

/// A look, and the table whose domain it has and whose points are where it may bend.
struct TableLook {
    ColourWay look;
    const LUT& points;
};

/// How far the look of a written table is from that of what it was made of: at the points of both,
/// half-way between the written one's, and at random colours, within the domain that both have.
double largestDeviation(const TableLook& source, const TableLook& written);

/// The same for the looks that two tables have.
double lookDeviation(const boost::shared_ptr<const LUT>& source,
                     const boost::shared_ptr<const LUT>& written);

}  // namespace Orlith::LUT
