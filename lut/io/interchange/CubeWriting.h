#pragma once

#include "lut/LUT.h"
#include "lut/io/text/LineWriter.h"

namespace Orlith::LUT {

// What a .cube file has for other programs, beside its book.

/// @throws Exception  the format cannot hold the table
void expectHeldByCube(const LUT& lut);

/// The domain, unless it is 0 to 1.
void writeCubeDomain(LineWriter& file, const LUT& lut);

}  // namespace Orlith::LUT
