#pragma once

#include <cstddef>

#include "lut/evaluation/Range.h"
#include "lut/io/BLUTLayout.h"
#include "lut/io/LUTFileReader.h"

namespace Orlith::LUT {

// What .blut files mean beside their book: the range in the header is the domain, and every sample
// has to be there. By the book both are remarked only.

/// Remarks why a file's magic is wrong.
/// @param held  bytes of the header that the file has; behind them are zeros
void explainBLUTMagic(const Reading& reading, const BLUTHeaderBytes& header, std::size_t held);

/// Remarks a size that no table should have.
/// @throws Exception  as meant: fewer than two points a side
void expectBLUTSize(const Reading& reading, int size);

/// Looks at the table that the reader has made.
/// @throws Exception  as meant: samples are missing, or the range is none
void finishBLUT(const Reading& reading, const BLUTHeaderBytes& header, LUT& lut);

/// The range that a file's header has for a table: its domain.
/// @throws Exception  the format cannot hold the table
Range rangeOfBLUT(const LUT& lut);

}  // namespace Orlith::LUT
