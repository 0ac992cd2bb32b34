#pragma once

#include <cstdint>

#include "lut/LUT.h"

namespace Orlith::LUT {

/// The inputs that a table covers, each channel's own.
struct Range {
    RGB min;
    RGB max;
};

/// 0 to 1 on every channel.
Range unitRange();

/// Whether a range can be a domain: finite, and every channel rises.
bool rises(const Range& range);

/// Whether a range is 0 to 1, but for the last bits that a transform's rounding takes.
bool isUnit(const Range& range);

/// What both have; max is below min where that is nothing.
Range intersection(const Range& a, const Range& b);

/// The inputs of a table's first and last points, as its transform says.
Range domainOf(const LUT& lut);

/// Gives each channel of a table a domain.
/// @param points  along each channel
void setDomain(LUT& lut, const Range& domain, const int (&points)[3]);

/// Points of a lattice, entries of a curve.
std::uint64_t pointCount(const LUT& lut);

}  // namespace Orlith::LUT
