#pragma once

#include <cstdint>
#include <string_view>

namespace Orlith::LUT {

/// Whose .3dl file it is.
enum class Dialect3DL : std::int32_t { Unknown = -1, Auto = 0, Flame = 1, Lustre = 2, Scratch = 3 };

/// The dialect of the word "auto", "flame", "lustre" or "scratch"; case counts.
Dialect3DL toDialect3DL(std::string_view word);

/// The largest code of a bit depth, 2^bits - 1. Any number may come in, since files and properties
/// state what they like: bits counts modulo 32, so that 32 gives 0.
std::int32_t codeMaxOf(std::int32_t bits);

/// Significant bits of a code: 10 for 1023, 11 for 1024; 0 for 0 and below.
std::int32_t bitCountOf(std::int32_t code);

/// Whether a code is the largest of some bit depth: 0, 1, 3, 7, ...
inline bool isCodeMax(std::int32_t code) {
    return code == codeMaxOf(bitCountOf(code));
}

}  // namespace Orlith::LUT
