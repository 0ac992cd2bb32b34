#pragma once

#include <cstdint>
#include <string_view>

#include "lut/RGB.h"

namespace Orlith::LUT {

// Numbers in text, with the grammar and the results of the C conversions in the "C" locale,
// whatever locale the process has set. None of them fails: text that is no number is 0, and what
// follows a number is ignored.

/// As strtod, narrowed to single precision.
float toFloat(std::string_view token);

/// As strtol in base 10, cut to 32 bits.
std::int32_t toInt(std::string_view token);

/// Whether a word is digits, a comma and digits, perhaps behind a sign: "0,5" for 0.5.
bool hasDecimalComma(std::string_view word);

/// Reads a line of three plain decimals ("0.5 -12 .25"), separated by blanks and tabs; the result
/// is that of toFloat on each. This is the quick way for the data lines of every text format.
/// @param line  may end in a carriage return
/// @return false, leaving rgb alone, if the line is anything else: look at its tokens then
bool parsePlainTriple(std::string_view line, RGB& rgb);

}  // namespace Orlith::LUT
