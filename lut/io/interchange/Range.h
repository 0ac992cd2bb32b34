#pragma once

#include <cstdint>
#include <string>

#include "lut/LUT.h"

namespace Orlith::LUT {

/// The inputs that a table covers, each channel's own.
struct Range {
    RGB min;
    RGB max;
};

/// Whether a range can be a domain: finite, and every channel rises.
bool rises(const Range& range);

/// Whether a range is 0 to 1.
bool isUnit(const Range& range);

Range domainOf(const LUT& lut);

/// Gives each channel of a table the domain from min to max.
/// @param points  along each channel
void setDomain(LUT& lut, const RGB& min, const RGB& max, const int (&points)[3]);

/// Whether a table covers 0 to 1, as its transform says, but for the last bits of it.
bool coversUnit(const LUT& lut);

/// Points of a lattice, entries of a curve.
std::uint64_t pointCount(const LUT& lut);

/// "the file ends after 1 of 8 samples"
std::string endsEarly(std::uint64_t sampleCount, std::uint64_t points);

}  // namespace Orlith::LUT
