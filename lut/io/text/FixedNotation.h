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

}  // namespace Orlith::LUT
