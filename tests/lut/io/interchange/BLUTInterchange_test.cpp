#include <gtest/gtest.h>

#include "tests/support/ForeignFiles.h"

namespace {

using namespace std::string_literals;
using namespace test;

// One end of a curve of halves from -1 to 1 on red, 0 to 1 on green, 0 to 2 on blue, and the other.
const std::string kMagic = "HLUT\0\0\0\1\0\0\0\5\0\0\0\x40"s;
const std::string kRed = "\xbf\x80\0\0\x3f\x80\0\0"s;
const std::string kOthers = "\0\0\0\0\x3f\x80\0\0\0\0\0\0\x40\0\0\0"s;
const std::string kSamples = "\0\0\0\2h\0\0\0\0\0\0\x3c\0\x38\0\x34\0"s;  // 0 0 0, 1 0.5 0.25
const std::string kCurve = kMagic + kRed + kOthers + kSamples;

TEST(BLUTInterchange, ReadsFilesAsMeant) {
    constexpr char kNoMagic[] =
        "BLUT LUT reader: unsupported header magic number, expected \"HLUT\".";
    constexpr char kDataError[] = "BLUT LUT reader: syntax error while reading LUT data.";
    const std::string backwards = "\x3f\x80\0\0\xbf\x80\0\0"s + kOthers + kSamples;
    const std::string endless = "\0\0\0\0\x7f\x80\0\0"s + kOthers + kSamples;
    expectOutcomes(
        ".blut",
        {{"a range of each channel", kCurve, kMeant, "0 .5 .5 -> .5 .25 .0625"},
         {"cut short by the book", kCurve.substr(0, 56), kBook, "",
          "0: the file ends after 1 of 2 samples | 0: the range in the header is not "
          "used: the table covers 0 to 1"},
         {"cut short", kCurve.substr(0, 56), kMeant, kDataError,
          "0: the file ends after 1 of 2 samples"},
         {"a range backwards", kMagic + backwards, kMeant, kDataError,
          "0: the range in the header does not rise"},
         {"a range to infinity", kMagic + endless, kMeant, kDataError,
          "0: the range in the header does not rise"},
         {"too many points", kMagic + kRed + kOthers + "\0\0\0\xc8h"s, kMeant, kDataError,
          "0: a table of 200 points a side, where 2 to 127 can be"},
         {"another file", "GIF89a", kMeant, kNoMagic, "0: the file begins with \"GIF8\""}});
}

}  // namespace
