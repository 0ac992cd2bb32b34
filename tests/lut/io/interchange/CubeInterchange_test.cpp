#include "tests/support/ForeignFiles.h"

#include <gtest/gtest.h>

namespace {

using test::Mode;

// Sample (r, g, b) is (r, g / 2, b / 4).
const std::string kSamples = "0 0 0\n1 0 0\n0 .5 0\n1 .5 0\n0 0 .25\n1 0 .25\n0 .5 .25\n1 .5 .25\n";
const std::string kCube = "LUT_3D_SIZE 2\n" + kSamples;

TEST(CubeInterchange, ReadsWhatOtherProgramsWrite) {
    test::expectLooks(
        ".cube", {{"mark, returns, comments",
                   "\xef\xbb\xbf#look\r\n\r\nLUT_3D_SIZE 2 # points\r\n0 0 0 # black\r\n" +
                       kSamples.substr(6) + "\r\n  # end\r\n",
                   {{{.5F, .5F, .5F}, {.5F, .25F, .125F}}}},
                  {"decimal commas",
                   "LUT_1D_SIZE 2\nDOMAIN_MAX 0,5 1 1\n0,25 0 -0,5\n1 1,5 1\n",
                   {{{.25F, .5F, .5F}, {.625F, .75F, .25F}}}},
                  {"a domain of each channel",
                   "DOMAIN_MIN -1 0 1\nDOMAIN_MAX 1 4 2\n" + kCube,
                   {{{0.F, 1.F, 1.5F}, {.5F, .125F, .125F}}, {{2.F, 4.F, 0.F}, {1.F, .5F, 0.F}}}},
                  {"a domain behind the samples",
                   kCube + "DOMAIN_MAX 2 2 2\n",
                   {{{1.F, 1.F, 1.F}, {.5F, .25F, .125F}}}},
                  {"a curve with a range",
                   "LUT_1D_SIZE 2\nLUT_1D_INPUT_RANGE -1 3\n0 0 0\n4 2 1\n",
                   {{{0.F, 1.F, 2.F}, {1.F, 1.F, .75F}}}},
                  {"a 1D block before the lattice, either size first",
                   "LUT_3D_SIZE 2\nLUT_3D_INPUT_RANGE 0 2\nLUT_1D_SIZE 3\nLUT_1D_INPUT_RANGE 0 4\n"
                   "0 0 0\n.5 1 2\n2 2 2\n" +
                       kSamples,
                   {{{2.F, 2.F, 2.F}, {.25F, .25F, .25F}}, {{3.F, 4.F, 0.F}, {.625F, .5F, 0.F}}}},
                  {"words that mean nothing",
                   "TITLE x\nLUT_IN_VIDEO_RANGE\nLUT_1D_INPUT_RANGE 0 2\n" + kCube,
                   {{{.5F, .5F, .5F}, {.5F, .25F, .125F}}},
                   {"2: \"LUT_IN_VIDEO_RANGE\" is not known and not used",
                    "0: \"LUT_1D_INPUT_RANGE\" is not used: the file has no 1D block"}}});
}

TEST(CubeInterchange, SaysWhyAFileIsNoTable) {
    test::expectReasons(
        ".cube", Mode::Meant,
        {{"a letter in a number", "LUT_3D_SIZE 2\n0 0.5O 0\n", "2: \"0.5O\" is no number"},
         {"hexadecimal", "LUT_3D_SIZE 2\n0x1 0 0\n", "2: \"0x1\" is no number"},
         {"not finite", "LUT_3D_SIZE 2\n0 nan 0\n", "2: \"nan\" is not finite"},
         {"too large", "LUT_3D_SIZE 2\n0 1e39 0\n", "2: \"1e39\" is not finite"},
         {"four words", "LUT_3D_SIZE 2\n0 0 0 0\n", "2: the line has 4 words: \"0 0 0 0\""},
         {"no words", "# nothing\n", "1: there is no line LUT_1D_SIZE or LUT_3D_SIZE"},
         {"a size with a tail", "LUT_3D_SIZE 2x\n" + kSamples, "1: \"2x\" is no size"},
         {"one point", "LUT_3D_SIZE 1\n0 0 0\n", "1: a table needs at least 2 points a side"},
         {"two sizes", "LUT_3D_SIZE 2\n" + kCube, "2: a second size line"},
         {"cut short", kCube.substr(0, 20), "2: the file ends after 1 of 8 samples"},
         {"a sample more", kCube + "0 0 0\n", "10: there are more samples than the 8 of the table"},
         {"an entry more", "LUT_1D_SIZE 2\n0 0 0\n1 1 1\n2 2 2\n",
          "4: there are more samples than the 2 of the table"},
         {"a falling domain", "DOMAIN_MAX 1 0 1\n" + kCube, "10: the domain does not rise"},
         {"a range of one number", "LUT_3D_INPUT_RANGE 1\n" + kCube,
          "1: \"LUT_3D_INPUT_RANGE\" needs 2 numbers, has 1"}});
    test::expectReasons(
        ".cube", Mode::Book,
        {{"a comment", "#title\n" + kCube,
          "1: the line begins with \"#title\" and is taken for data"},
         {"a return", "\r\n" + kCube, "1: the line holds only a carriage return"},
         {"a mark", "\xef\xbb\xbf" + kCube, "1: the file begins with a byte order mark"}});
}

TEST(CubeInterchange, RemarksWhatTheBookDoesNotUse) {
    EXPECT_EQ(test::remarksOn(".cube", Mode::Book, "DOMAIN_MIN 0 0 0\nDOMAIN_MAX 1 2 1\n" + kCube),
              std::vector<std::string>{"2: the domain is not used: the table covers 0 to 1"});
}

}  // namespace
