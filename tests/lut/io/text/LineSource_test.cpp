#include "lut/io/text/LineSource.h"

#include <gtest/gtest.h>

#include <sstream>
#include <string>
#include <vector>

namespace {

namespace ol = Orlith::LUT;

std::vector<std::string> linesOf(const std::string& text) {
    std::istringstream stream(text);
    std::uint64_t lineNumber = 99;
    ol::LineSource source(stream, lineNumber);
    EXPECT_EQ(lineNumber, 0U);
    std::vector<std::string> lines;
    for (std::string_view line; source.next(line);) {
        lines.emplace_back(line);
        EXPECT_EQ(lineNumber, lines.size());
    }
    std::string_view after = "old";
    EXPECT_FALSE(source.next(after));  // and goes on saying so
    EXPECT_TRUE(after.empty());
    EXPECT_EQ(lineNumber, lines.size());
    return lines;
}

using Lines = std::vector<std::string>;

TEST(LineSource, EndsLinesAtLineFeedsOnly) {
    EXPECT_EQ(linesOf(""), Lines());
    EXPECT_EQ(linesOf("\n"), Lines({""}));
    EXPECT_EQ(linesOf("a"), Lines({"a"}));
    EXPECT_EQ(linesOf("a\nb\n"), Lines({"a", "b"}));
    EXPECT_EQ(linesOf("a\n\n\nb"), Lines({"a", "", "", "b"}));
    EXPECT_EQ(linesOf("a\r\nb\rc\r\n"), Lines({"a\r", "b\rc\r"}));
    EXPECT_EQ(linesOf(std::string("\0a\0\n\0", 5)),
              Lines({std::string("\0a\0", 3), std::string("\0", 1)}));
}

TEST(LineSource, JoinsLinesAcrossBlocks) {
    // Lengths from nothing to several blocks, so that line ends fall everywhere around their edges.
    Lines expected;
    std::string text;
    for (std::size_t i = 0; i < 400; ++i) {
        const std::size_t length = i % 97 == 96 ? 700001 + i
                                   : i % 7 == 6 ? 65535 + i % 3
                                                : i * 37 % 911;
        expected.emplace_back(length, static_cast<char>('a' + i % 26));
        text += expected.back() + "\n";
    }
    expected.emplace_back("no end");
    EXPECT_TRUE(linesOf(text + "no end") == expected);
    for (std::size_t length = (256 << 10) - 2; length <= (256 << 10) + 2; ++length) {
        const std::string line(length, 'x');
        EXPECT_TRUE(linesOf(line) == Lines({line})) << length;
        EXPECT_TRUE(linesOf(line + "\ny") == Lines({line, "y"})) << length;
    }
}

TEST(LineSource, CutsALineThatIsTooLongAndEndsThere) {
    const std::string longest(ol::LineSource::kLongestLine, 'x');
    for (const std::size_t length : {std::size_t{5}, std::size_t{100001}}) {
        const std::string first(length, 'a');
        const std::string text = std::string(first).append("\n").append(longest).append("x\nb\n");
        EXPECT_TRUE(linesOf(text) == Lines({first, longest}));
    }
}

}  // namespace
