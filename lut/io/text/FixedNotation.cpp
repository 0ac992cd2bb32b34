#include "lut/io/text/FixedNotation.h"

#include <charconv>
#include <cmath>
#include <cstdint>

#include "lut/io/text/DigitPairs.h"

namespace Orlith::LUT {

char* writeFixed(char* out, float value) {
    // A float has 24 significant bits and 10^6 is 2^6 * 5^6, 14 more: their product is exact in
    // double, so that rounding it to an integer gives the very digits of fixed notation.
    const double millionths = std::fabs(static_cast<double>(value)) * 1e6;
    if (!(millionths < 9.0e18)) {  // beyond 64-bit integers, or not finite
        return std::to_chars(out, out + kFixedLength, value, std::chars_format::fixed, 6).ptr;
    }
    if (std::signbit(value)) *out++ = '-';
    const auto rounded = static_cast<std::uint64_t>(std::nearbyint(millionths));
    const std::uint64_t whole = rounded / 1000000;
    const auto fraction = static_cast<std::uint32_t>(rounded % 1000000);
    if (whole < 10) {
        *out++ = static_cast<char>('0' + whole);
    } else {
        out = std::to_chars(out, out + kFixedLength - 8, whole).ptr;
    }
    *out++ = '.';
    writeDigitPair(out, fraction / 10000);
    writeDigitPair(out + 2, fraction / 100 % 100);
    writeDigitPair(out + 4, fraction % 100);
    return out + 6;
}

char* writeShortest(char* out, float value) {
    return std::to_chars(out, out + kShortestLength, value, std::chars_format::fixed).ptr;
}

}  // namespace Orlith::LUT
