#include "lut/io/text/FixedNotation.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <cstdio>
#include <limits>
#include <random>
#include <string>

#include "tests/support/Bits.h"

namespace {

namespace ol = Orlith::LUT;

using test::floatOf;

/// Compares with the C library; the tests run in the "C" locale.
/// @return whether it was equal, so that a long loop stops at the first difference
bool agreesWithPrintf(float value) {
    char expected[64];
    std::snprintf(expected, sizeof(expected), "%.6f", static_cast<double>(value));
    char written[ol::kFixedLength];
    const std::string_view actual(
        written, static_cast<std::size_t>(ol::writeFixed(written, value) - written));
    EXPECT_EQ(actual, expected) << std::hexfloat << value;
    return actual == expected;
}

TEST(FixedNotation, AgreesWithPrintfOnRandomBits) {
    std::mt19937 random;
    std::uniform_real_distribution<float> ordinary(0.0F, 1.0F);
    for (int i = 0; i < 200000; ++i) {
        ASSERT_TRUE(agreesWithPrintf(floatOf(static_cast<std::uint32_t>(random()))));
        ASSERT_TRUE(agreesWithPrintf(ordinary(random)));
    }
}

TEST(FixedNotation, AgreesWithPrintfOnEveryExponent) {
    // Zeros, denormals, infinities and NaN among them.
    for (std::uint32_t exponent = 0; exponent < 256; ++exponent) {
        for (const std::uint32_t mantissa :
             {0U, 1U, 2U, 0x2aaaaaU, 0x400000U, 0x7ffffeU, 0x7fffffU}) {
            ASSERT_TRUE(agreesWithPrintf(floatOf(exponent << 23 | mantissa)));
            ASSERT_TRUE(agreesWithPrintf(floatOf(0x80000000U | exponent << 23 | mantissa)));
        }
    }
}

TEST(FixedNotation, RoundsTiesToEven) {
    // The odd multiples of 1/128 are the floats that lie half way between two texts.
    for (int i = -99999; i < 100000; i += 2)
        ASSERT_TRUE(agreesWithPrintf(static_cast<float>(i) / 128.0F));
}

}  // namespace
