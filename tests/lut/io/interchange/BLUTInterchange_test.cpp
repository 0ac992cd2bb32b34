#include "tests/support/ForeignFiles.h"

#include <gtest/gtest.h>

#include "tests/support/Files.h"

namespace {

using namespace std::string_literals;
using test::Mode;

// One end of a curve of halves from -1 to 1 on red, 0 to 1 on green, 0 to 2 on blue, and the other.
const std::string kMagic = "HLUT\0\0\0\1\0\0\0\5\0\0\0\x40"s;
const std::string kRanges = "\xbf\x80\0\0\x3f\x80\0\0\0\0\0\0\x3f\x80\0\0\0\0\0\0\x40\0\0\0"s;
const std::string kSamples = "\0\0\0\0\0\0\x3c\0\x38\0\x34\0"s;  // 0 0 0, 1 0.5 0.25
const std::string kCurve = kMagic + kRanges + "\0\0\0\2h"s + kSamples;

TEST(BLUTInterchange, TakesTheRangeForTheDomain) {
    test::expectLooks(
        ".blut", {{"a range of each channel", kCurve, {{{0.F, .5F, .5F}, {.5F, .25F, .0625F}}}}});
    EXPECT_EQ(test::remarksOn(".blut", Mode::Book, kCurve.substr(0, 56)),
              (std::vector<std::string>{
                  "0: the file ends after 1 of 2 samples",
                  "0: the range in the header is not used: the table covers 0 to 1"}));
}

TEST(BLUTInterchange, SaysWhyAFileIsNoTable) {
    const std::string backwards = kRanges.substr(4, 4) + kRanges.substr(0, 4) + kRanges.substr(8);
    const std::string endless = "\0\0\0\0\x7f\x80\0\0"s + kRanges.substr(8);
    test::expectReasons(
        ".blut", Mode::Meant,
        {{"cut short", kCurve.substr(0, 56), "0: the file ends after 1 of 2 samples"},
         {"a range backwards", test::replaced(kCurve, kRanges, backwards),
          "0: the range in the header does not rise"},
         {"a range to infinity", test::replaced(kCurve, kRanges, endless),
          "0: the range in the header does not rise"},
         {"too many points", kMagic + kRanges + "\0\0\0\xc8h"s,
          "0: a table of 200 points a side, where 2 to 127 can be"},
         {"another file", "GIF89a", "0: the file begins with \"GIF8\""}});
}

}  // namespace
