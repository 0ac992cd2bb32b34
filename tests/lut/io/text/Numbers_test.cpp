#include "lut/io/text/Numbers.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <iterator>
#include <random>
#include <sstream>
#include <string>
#include <vector>

#include "tests/support/Bits.h"
#include "tests/support/Files.h"

namespace {

namespace ol = Orlith::LUT;

using test::bitsOf;

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

/// The words of data/numbers.txt, and what is no word.
std::vector<std::string> tokens() {
    std::vector<std::string> tokens = {"",    "\t1",      " 1",       "\n1",
                                       "\r1", "\v1",      "\f1",      "1\r",
                                       "1 ",  "\xa0\x31", "\xc2\xbd", {"15.5\0009", 6}};
    std::istringstream lines(test::readFile(test::dataPath("numbers.txt")));
    for (std::string line; std::getline(lines, line);) {
        if (line.compare(0, 2, "//") == 0) continue;
        std::istringstream words(line);
        tokens.insert(tokens.end(), std::istream_iterator<std::string>(words), {});
    }
    return tokens;
}

TEST(Numbers, ConvertAsTheCLibraryDoes) {
    for (const std::string& token : tokens()) {
        SCOPED_TRACE(token);
        const ExactText text(token);
        EXPECT_EQ(bitsOf(ol::toFloat(text.view())), bitsOf(strtodFloat(token)));
        EXPECT_EQ(ol::toInt(text.view()),
                  static_cast<std::int32_t>(std::strtol(token.c_str(), nullptr, 10)));
    }
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
    for (const std::string& token : tokens()) {
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
    for (const char* const line :
         {"1 2 3 \r", "1 2 3\r ", "1 2\r3", "\r1 2 3", "1 2", "1 2 ", "1 2 3 4", "1 2 3e0",
          "1 2 +3", "1,2,3", "1 2 1234567890123456", "", " ", "\r", "...", "- - -"})
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

}  // namespace
