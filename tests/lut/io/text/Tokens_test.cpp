#include "lut/io/text/Tokens.h"

#include <gtest/gtest.h>

#include <string>

namespace {

namespace ol = Orlith::LUT;

TEST(Trim, TakesWhiteSpaceOffBothEnds) {
    EXPECT_EQ(ol::trim(" \t\r\n\v\fa b\t \r\n\v\f"), "a b");
    EXPECT_EQ(ol::trim("a"), "a");
    EXPECT_EQ(ol::trim(" \t\r\n"), "");
    EXPECT_EQ(ol::trim({}), "");
    EXPECT_EQ(ol::trimEnd(" \t\r a \v\f"), " \t\r a");
    EXPECT_EQ(ol::trimEnd(" \t\r"), "");
    const std::string strange(" \0 \xa0 ", 5);  // neither is white space
    EXPECT_EQ(ol::trim(strange), std::string("\0 \xa0", 3));
}

TEST(Tokens, AreSeparatedByRunsOfBlanksAndTabs) {
    ol::Tokens tokens("\t one \t two\rthree ");
    ASSERT_EQ(tokens.count(), 2U);
    EXPECT_EQ(tokens[0], "one");
    EXPECT_EQ(tokens[1], "two\rthree");
    EXPECT_EQ(tokens[2], "");
    EXPECT_EQ(tokens[1000], "");

    for (const char* const blank : {"", " ", "\t \t"}) {
        tokens.split(blank);
        EXPECT_TRUE(tokens.empty());
        EXPECT_EQ(tokens[0], "");
    }
    std::string line;
    for (std::size_t i = 0; i < 100; ++i)
        line += std::to_string(i) + "\t";
    EXPECT_EQ(ol::countWords(line), 100U);
    tokens.split("first second");
    tokens.add(line);
    EXPECT_EQ(tokens.count(), ol::Tokens::kMost);
    EXPECT_EQ(tokens[1], "second");
    EXPECT_EQ(tokens[17], "15");
    EXPECT_EQ(tokens[18], "");
}

}  // namespace
