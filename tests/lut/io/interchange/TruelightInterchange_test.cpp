#include <gtest/gtest.h>

#include "tests/support/ForeignFiles.h"

namespace {

using namespace test;

constexpr char kDataError[] =
    "Truelight LUT reader: syntax error while reading LUT data (too many or not enough values).";
constexpr char kWidthError[] = "Truelight LUT reader: expected 3 values for width.";

// 2 x 2 x 3 points; sample (r, g, b) is (r, g / 2, b / 4).
const std::string kSamples =
    "0 0 0\n1 0 0\n0 .5 0\n1 .5 0\n0 0 .25\n1 0 .25\n0 .5 .25\n1 .5 .25\n"
    "0 0 .5\n1 0 .5\n0 .5 .5\n1 .5 .5\n";
const std::string kWidth = "# width 2 2 3\n";
const std::string kInputLUT = "# InputLUT\n0 0 0\n.25 .5 2\n1 1 2\n# Cube\n";
const std::string kLookalikes =
    "#cube of a print\n#width of it\n#width 2 2 3\n#lutLength 3\n#InputLUT\n0 0 0\n"
    "# end of black\n0,25 0,5 2\n1 1 2\n#CUBE\n";

TEST(TruelightInterchange, ReadsFilesAsMeant) {
    const Outcome shaped(".5 .5 .5 -> .25 .25 .5, 1 2 .25 -> 1 .5 .25");
    expectOutcomes(
        ".cub", {{"returns behind keywords",
                  withReturns(kWidth + "# lutLength 3\n" + kInputLUT + kSamples + "# end\nmore\n"),
                  kMeant, shaped},
                 {"keywords without a blank, comments that look like some", kLookalikes + kSamples,
                  kMeant, shaped},
                 {"no length", kWidth + kInputLUT + kSamples, kMeant, shaped},
                 {"no input LUT", kWidth + "Unknown\n" + kSamples, kMeant,
                  ".5 .5 .25 -> .5 .25 .125", "2: \"Unknown\" is not known and not used"},
                 {"data first", kSamples, kMeant, kDataError,
                  "1: the line \"# width\" has to come before the data"},
                 {"two numbers", "# width 2 2\n" + kSamples, kMeant, kWidthError,
                  "1: a width needs 3 numbers, has 2"},
                 {"one point", "# width 2 1 2\n0 0 0\n", kMeant, kWidthError,
                  "1: a table needs at least 2 points a side"},
                 {"two widths", kWidth + kWidth, kMeant, kDataError, "2: a second line \"width\""},
                 {"cut off by the end", kWidth + "0 0 0\n# End\n" + kSamples, kMeant, kDataError,
                  "15: the file ends after 1 of 12 samples"},
                 {"an entry too few", kWidth + "# lutLength 4\n" + kInputLUT + kSamples, kMeant,
                  kDataError, "19: the input LUT has 3 of 4 entries"},
                 {"one entry", kWidth + "# InputLUT\n1 1 1\n# Cube\n" + kSamples, kMeant,
                  kDataError, "16: an input LUT needs at least 2 entries"},
                 {"a return by the book", kWidth + "# InputLUT\r\n0 0 0\n", kBook, "",
                  "2: \"InputLUT\\r\" is not known for its carriage return, and not used"}});
}

}  // namespace
