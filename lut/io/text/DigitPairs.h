#pragma once

#include <cstddef>
#include <cstdint>
#include <cstring>

namespace Orlith::LUT {

/// "00", "01", ... "99": decimal digits two at a time.
struct DigitPairs {
    char text[200];
    constexpr DigitPairs() : text() {
        for (std::size_t i = 0; i < 100; ++i) {
            text[2 * i] = static_cast<char>('0' + i / 10);
            text[2 * i + 1] = static_cast<char>('0' + i % 10);
        }
    }
};
inline constexpr DigitPairs kDigitPairs;

/// @param out   room for two characters
/// @param pair  below 100
inline void writeDigitPair(char* out, std::uint32_t pair) {
    std::memcpy(out, kDigitPairs.text + 2 * std::size_t{pair}, 2);
}

}  // namespace Orlith::LUT
