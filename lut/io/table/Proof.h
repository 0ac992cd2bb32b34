#pragma once

#include <cstdint>
#include <string>

#include "lut/LUT.h"
#include "lut/io/table/Options3DL.h"
#include "lut/io/table/Reading.h"

namespace Orlith::LUT {

// What tells whether a file has the look of the table that it was made of; see Deviation.h.

/// Takes a pre-LUT away that changes nothing, such as the one that a .csp file has to have.
void dropIdentityPreLUT(LUT& lut);

/// Makes a pre-LUT in front of a lattice its domain where it is no more than that: straight, from
/// one end of the lattice to the other. Colours beyond it are then the lattice's to continue.
void foldStraightPreLUT(LUT& lut);

/// What the codes of a .3dl file do not reach.
struct Clipping {
    std::uint64_t numberCount = 0;
    float farthest = 0.5F;  ///< from the middle of 0 and 1, of these numbers
};

/// None where all samples fit, and for other formats.
Clipping clippingOf(const LUT& lut, const std::string& extension, const Options3DL& options);

/// How to read a file that was written with these options.
ReadOptions readingOf(const std::string& extension, const Options3DL& options);

/// What half a unit of the format's last digit, and single precision, leave of a look.
double precisionOf(const std::string& extension, const Options3DL& options, const LUT& lut);

}  // namespace Orlith::LUT
