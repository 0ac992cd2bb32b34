#pragma once

#include "lut/LUT.h"
#include "lut/evaluation/Look.h"

namespace orlith {

/// A look, and the table whose domain it has and whose points are where it may bend.
struct TableLook {
    Orlith::LUT::ColourWay look;
    const Orlith::LUT::LUT& points;
};

/// How far the look of a written table is from that of what it was made of: at the points of both,
/// half-way between the written one's, and at random colours, within the domain that both have.
double largestDeviation(const TableLook& source, const TableLook& written);

}  // namespace orlith
