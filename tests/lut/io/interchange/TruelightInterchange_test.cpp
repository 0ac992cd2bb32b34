#include "tests/support/ForeignFiles.h"

#include <gtest/gtest.h>

namespace {

using test::Mode;

// 2 x 2 x 3 points; sample (r, g, b) is (r, g / 2, b / 4).
const std::string kSamples =
    "0 0 0\n1 0 0\n0 .5 0\n1 .5 0\n0 0 .25\n1 0 .25\n0 .5 .25\n1 .5 .25\n"
    "0 0 .5\n1 0 .5\n0 .5 .5\n1 .5 .5\n";
const std::string kWidth = "# width 2 2 3\n";
const std::string kInputLUT = "# lutLength 3\n# InputLUT\n0 0 0\n.25 .5 2\n1 1 2\n# Cube\n";

std::string withReturns(std::string text) {
    for (std::size_t at = 0; (at = text.find('\n', at)) != std::string::npos; at += 2) {
        text.insert(at, "\r");
    }
    return text;
}

TEST(TruelightInterchange, ReadsWhatOtherProgramsWrite) {
    const std::vector<test::ForeignFile::Colour> shaped{{{.5F, .5F, .5F}, {.25F, .25F, .5F}},
                                                        {{1.F, 2.F, .25F}, {1.F, .5F, .25F}}};
    test::expectLooks(
        ".cub",
        {{"returns behind keywords", withReturns(kWidth + kInputLUT + kSamples + "# end\nmore\n"),
          shaped},
         {"keywords without a blank, comments that look like some",
          "#cube of a print\n#width of it\n#width 2 2 3\n#lutLength 3\n#InputLUT\n0 0 0\n# end of "
          "black\n0,25 0,5 2\n1 1 2\n#CUBE\n" +
              kSamples,
          shaped},
         {"no length", kWidth + kInputLUT.substr(14) + kSamples, shaped},
         {"no input LUT",
          kWidth + "Unknown\n" + kSamples,
          {{{.5F, .5F, .25F}, {.5F, .25F, .125F}}},
          {"2: \"Unknown\" is not known and not used"}}});
}

TEST(TruelightInterchange, SaysWhyAFileIsNoTable) {
    test::expectReasons(
        ".cub", Mode::Meant,
        {{"data first", kSamples, "1: the line \"# width\" has to come before the data"},
         {"two numbers", "# width 2 2\n" + kSamples, "1: a width needs 3 numbers, has 2"},
         {"one point", "# width 2 1 2\n0 0 0\n", "1: a table needs at least 2 points a side"},
         {"two widths", kWidth + kWidth, "2: a second line \"width\""},
         {"no data", kWidth, "1: the file ends after 0 of 12 samples"},
         {"cut off by the end", kWidth + "0 0 0\n# End\n" + kSamples,
          "15: the file ends after 1 of 12 samples"},
         {"a sample more", kWidth + kSamples + "0 0 0\n",
          "14: there are more samples than the 12 of the table"},
         {"an entry too few", kWidth + "# lutLength 4\n" + kInputLUT.substr(14) + kSamples,
          "19: the input LUT has 3 of 4 entries"},
         {"one entry", kWidth + "# InputLUT\n1 1 1\n# Cube\n" + kSamples,
          "16: an input LUT needs at least 2 entries"}});
}

TEST(TruelightInterchange, RemarksWhatTheBookDoesNotKnow) {
    EXPECT_EQ(test::remarksOn(".cub", Mode::Book, kWidth + "# InputLUT\r\n0 0 0\n"),
              std::vector<std::string>{
                  "2: \"InputLUT\\r\" is not known for its carriage return, and not used"});
}

}  // namespace
