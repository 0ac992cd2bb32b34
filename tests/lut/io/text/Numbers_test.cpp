#include "lut/io/text/Numbers.h"

#include <gtest/gtest.h>

#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <random>
#include <string>
#include <vector>

namespace {

namespace ol = Orlith::LUT;

std::uint32_t bitsOf(float value) {
    std::uint32_t bits;
    std::memcpy(&bits, &value, sizeof(bits));
    return bits;
}

float floatOf(std::uint32_t bits) {
    float value;
    std::memcpy(&value, &bits, sizeof(value));
    return value;
}

/// What the C library makes of a text; these tests run in the "C" locale.
float strtodFloat(const std::string& text) {
    return static_cast<float>(std::strtod(text.c_str(), nullptr));
}

/// A text in memory of just its size, so that the address sanitizer sees one byte too far.
class ExactText {
public:
    explicit ExactText(const std::string& text) : bytes_(text.begin(), text.end()) {
        bytes_.shrink_to_fit();
    }

    std::string_view view() const { return {bytes_.data(), bytes_.size()}; }

private:
    std::vector<char> bytes_;
};

const char* const kTokens[] = {
    // plain decimals, of up to 15 digits and more
    "0", "-0", "+0", "1", "-1", "+1", "0.5", ".5", "-.5", "5.", "-5.", ".", "-", "+", "-.", "",
    "0.123456", "-0.000001", "1.000000", "00000.5", "99999999", "999999999", "0.99999999",
    "0.999999999", "123456789012345", "1234567890123456", "12345678.12345678", "0.12345678901234",
    "0.123456789012345", "0.1234567890123456", "0.000000000000001", "0.0000000000000001",
    "16777217", "16777217.0000001", "16777219", "9007199254740993", "0.30000001192092896",
    "000000000000000000000000000001", "123456789012345678901234567890", "0.00000000000000000000001",
    "0000000000000000000000000000.1", "18446744073709551617", "0.18446744073709551617",
    // exponents and range
    "1e5", "1E5", "1e+5", "1e-5", "1e", "1e+", "1e5x", "3.4028235e38", "3.4028236e38", "1e39",
    "-1e39", "1e308", "1e400", "1e-45", "7e-46", "1e-320", "1e-400", "4.9e-324",
    "340282356779733661637539395458142568447", "340282356779733661637539395458142568448",
    // other spellings
    "0x10", "0x1.8p1", "-0x1p-2", "0x", "0xg", "inf", "-inf", "+inf", "INF", "Infinity", "infinit",
    "nan", "-nan", "NaN", "nan(7)", "nan(", "nano",
    // no numbers, and what follows one
    "none", "#", "1.5.5", "1,5", "1-5", "--1", "+-1", "1f", "1;", "17abc", "1_000", "1'000", "0b1",
    "08", "\t1", " 1", "\n1", "\r1", "\v1", "\f1", "1\r", "1 ", "\xa0\x31", "\xc2\xbd",
    // 32 and 64 bits
    "2147483647", "2147483648", "-2147483648", "-2147483649", "4294967296", "4294967297",
    "9223372036854775807", "9223372036854775808", "-9223372036854775809"};

TEST(Numbers, ConvertAsTheCLibraryDoes) {
    for (const char* const token : kTokens) {
        SCOPED_TRACE(token);
        const ExactText text(token);
        EXPECT_EQ(bitsOf(ol::toFloat(text.view())), bitsOf(strtodFloat(token)));
        EXPECT_EQ(ol::toInt(text.view()),
                  static_cast<std::int32_t>(std::strtol(token, nullptr, 10)));
    }
}

TEST(Numbers, EndAtAnEmbeddedNul) {
    const std::string text("15.5\0009", 6);
    EXPECT_EQ(ol::toFloat(text), 15.5F);
    EXPECT_EQ(ol::toInt(text), 15);
    EXPECT_EQ(ol::toFloat(std::string_view(text).substr(4)), 0.0F);
    EXPECT_EQ(ol::toFloat({}), 0.0F);
    EXPECT_EQ(ol::toInt({}), 0);
}

/// Expects a line of three such tokens, in every position, to give toFloat's values or none.
/// @return whether it was taken
bool expectPlainTripleAgrees(const std::string& a, const std::string& b, const std::string& c) {
    const ExactText line(a + " " + b + "\t" + c);
    ol::RGB rgb(7.0F, 8.0F, 9.0F);
    const bool isPlain = ol::parsePlainTriple(line.view(), rgb);
    const float expected[] = {strtodFloat(a), strtodFloat(b), strtodFloat(c)};
    for (unsigned i = 0; i < 3; ++i) {
        EXPECT_EQ(bitsOf(rgb[i]), bitsOf(isPlain ? expected[i] : 7.0F + static_cast<float>(i)))
            << std::string(line.view());
    }
    return isPlain;
}

TEST(PlainTriple, AgreesWithTheTokensOrDeclines) {
    for (const std::string token : kTokens) {
        // Blanks make other tokens of it, and a text without end is no token.
        if (token.empty() || token.find_first_of(" \t") != std::string::npos) continue;
        expectPlainTripleAgrees(token, "0.25", "-3");
        expectPlainTripleAgrees("0.25", token, "-3");
        expectPlainTripleAgrees("0.25", "-3", token);
        expectPlainTripleAgrees(token, token, token);
    }
}

TEST(PlainTriple, TakesTheLinesThatFilesAreMadeOf) {
    const auto isPlain = [](const std::string& line) {
        ol::RGB rgb;
        return ol::parsePlainTriple(ExactText(line).view(), rgb);
    };
    for (const char* const line : {"1 2 3", "0.062500 0.125000 0.187500", " \t.5  -1.\t 00012.5 \t",
                                   "1 2 3\r", "1234567890.12345 -0.00000000000001 123456789012345"})
        EXPECT_TRUE(isPlain(line)) << line;
    for (const std::string& line : std::vector<std::string>{"1 2 3 \r",
                                                            "1 2 3\r ",
                                                            "1 2\r3",
                                                            "\r1 2 3",
                                                            "1 2",
                                                            "1 2 ",
                                                            "1 2 3 4",
                                                            "1 2 3e0",
                                                            "1 2 +3",
                                                            "1,2,3",
                                                            {"1 2 3\0", 6},
                                                            "1 2 1234567890123456",
                                                            "",
                                                            " ",
                                                            "\r",
                                                            "...",
                                                            "- - -"})
        EXPECT_FALSE(isPlain(line)) << line;
}

TEST(PlainTriple, AgreesOnRandomDecimals) {
    std::mt19937 random;
    const auto below = [&](std::size_t limit) {
        return static_cast<std::size_t>(random()) % limit;
    };
    const auto appendDigits = [&](std::string& text, std::size_t count) {
        while (count-- > 0)
            text += static_cast<char>('0' + below(10));
    };
    const auto decimal = [&] {
        std::string text = below(4) == 0 ? "-" : "";
        appendDigits(text, below(4) == 0 ? below(18) : below(3));
        if (below(8) != 0) text += '.';
        appendDigits(text, below(20));
        if (text.empty()) return std::string("0");
        // Now and then a character that does not belong, the neighbours of the digits first.
        constexpr char kStrange[] = "/:.-e\x7f\xb0\x80";
        if (below(8) == 0) text[below(text.size())] = kStrange[below(8)];
        return text;
    };
    int plain = 0;
    for (int i = 0; i < 200000; ++i)
        plain += expectPlainTripleAgrees(decimal(), decimal(), decimal());
    EXPECT_GT(plain, 20000);  // so that declining everything does not pass
}

TEST(Numbers, AgreeOnRandomBitsInEveryNotation) {
    std::mt19937 random;
    for (int i = 0; i < 50000; ++i) {
        const auto value = static_cast<double>(floatOf(static_cast<std::uint32_t>(random())));
        for (const char* const format : {"%.6f", "%.9g", "%.17g", "%a"}) {
            char text[400];
            std::snprintf(text, sizeof(text), format, value);
            EXPECT_EQ(bitsOf(ol::toFloat(text)), bitsOf(strtodFloat(text))) << text;
        }
    }
}

}  // namespace
