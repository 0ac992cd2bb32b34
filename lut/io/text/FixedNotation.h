#pragma once

#include <cstddef>

namespace Orlith::LUT {

/// Room that writeFixed needs: sign, 39 digits, point, 6 digits.
constexpr std::size_t kFixedLength = 48;

/// Writes a number in fixed notation with six digits after the point, "0.062500", rounded to
/// nearest, ties to even, independent of any locale: what printf("%.6f") gives in the "C" locale,
/// "nan" and "-inf" included.
/// @param out  room for kFixedLength characters
/// @return     the place after the last character; no NUL is written
char* writeFixed(char* out, float value);

/// Room that writeShortest needs: sign, "0.", 37 zeros and 9 digits of the smallest numbers.
constexpr std::size_t kShortestLength = 64;

/// Writes a number in fixed notation with the fewest digits that read back as the same one: "0.1".
/// @param out  room for kShortestLength characters
/// @return     the place after the last character; no NUL is written
char* writeShortest(char* out, float value);

}  // namespace Orlith::LUT
