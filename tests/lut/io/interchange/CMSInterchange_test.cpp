#include "tests/support/ForeignFiles.h"

#include <gtest/gtest.h>

namespace {

using test::Mode;

// Sample (r, g, b) is (r, g / 2, b / 4).
const std::string kSamples = "0 0 0\n1 0 0\n0 .5 0\n1 .5 0\n0 0 .25\n1 0 .25\n0 .5 .25\n1 .5 .25\n";
const std::string kSize = "LUT_3D_SIZE 2\n";
const std::string kPreLUT = "LUT_1D_SIZE 3\n" + kSize + "0 0 0\n.5 1 1.5\n2 2 2\n";

TEST(CMSInterchange, ReadsWhatOtherProgramsWrite) {
    test::expectLooks(
        ".cms", {{"no pre-LUT, a range",
                  "\r\nNUCODA_3D_CUBE 3\r\nTITLE x\r\n" + kSize +
                      "LUT_3D_INPUT_RANGE -1,0 3,0\r\n" + kSamples,
                  {{{0.F, 1.F, 2.F}, {.25F, .25F, .1875F}}}},
                 {"a pre-LUT with a comment and an empty line",
                  kPreLUT.substr(0, kPreLUT.size() - 6) + "#white\n\n2 2 2\n" + kSamples,
                  {{{.5F, .5F, .5F}, {.25F, .25F, .1875F}}, {{1.F, 1.F, 1.F}, {1.F, .5F, .25F}}}},
                 {"words that mean nothing",
                  "LUT_3D_INPUT_RANGE 0 2\nGAMMA 2 2\n" + kPreLUT + kSamples,
                  {{{.5F, .5F, .5F}, {.25F, .25F, .1875F}}},
                  {"2: \"GAMMA\" is not known and not used",
                   "0: the range is not used: the pre-LUT leads to the lattice by itself"}}});
}

TEST(CMSInterchange, SaysWhyAFileIsNoTable) {
    test::expectReasons(".cms", Mode::Meant,
                        {{"no size", "NUCODA_3D_CUBE 1\n", "1: there is no line LUT_3D_SIZE"},
                         {"data before it", "0 0 0\n" + kSize,
                          "1: the line LUT_3D_SIZE has to come before this one"},
                         {"no pre-LUT entries", "LUT_1D_SIZE 0\n" + kSize + kSamples,
                          "1: a table needs at least 2 points a side"},
                         {"a size among samples", kSize + "0 0 0\nLUT_1D_SIZE 2\n",
                          "3: a size line behind samples"},
                         {"an entry cut off", kPreLUT.substr(0, kPreLUT.size() - 6),
                          "4: the file ends within the 3 entries of the pre-LUT"},
                         {"an entry too few", kPreLUT.substr(0, kPreLUT.size() - 6) + kSamples,
                          "12: the file ends after 7 of 8 samples"},
                         {"a sample more", kSize + kSamples + "0 0 0\n",
                          "10: there are more samples than the 8 of the table"},
                         {"no number", kSize + "0 0 l\n", "2: \"l\" is no number"},
                         {"a falling range", "LUT_3D_INPUT_RANGE 1 0\n" + kSize + kSamples,
                          "1: the domain does not rise"}});
    test::expectReasons(
        ".cms", Mode::Book,
        {{"no pre-LUT", kSize + kSamples, "2: there is no line LUT_1D_SIZE"},
         {"a comment in it", kPreLUT.substr(0, kPreLUT.size() - 6) + "# white\n2 2 2\n" + kSamples,
          "5: the line begins with \"#\" and is taken for data"}});
}

TEST(CMSInterchange, RemarksWhatTheBookTakesForData) {
    EXPECT_EQ(
        test::remarksOn(".cms", Mode::Book,
                        "LUT_1D_SIZE 2\n" + kSize + "LUT_3D_INPUT_RANGE 0 1\n0 0 0\n"),
        std::vector<std::string>{"3: \"LUT_3D_INPUT_RANGE\" is taken for an entry or a sample"});
}

}  // namespace
