#include "tests/support/ForeignFiles.h"

#include <gtest/gtest.h>

#include "tests/support/Gzip.h"

namespace {

using test::Mode;

const std::string kHeader = "#Inventor V2.1 ascii\nSoVectorField {\nparameters\n";
// 2 x 2 x 3 points, blue fastest; sample (r, g, b) is (r, g / 2, b / 4).
const std::string kGrid = "grid_size 2 2 3\n";
const std::string kSamples =
    "0 0 0\n0 0 .25\n0 0 .5\n0 .5 0\n0 .5 .25\n0 .5 .5\n"
    "1 0 0\n1 0 .25\n1 0 .5\n1 .5 0\n1 .5 .25\n1 .5 .5\n";
const std::string kData = "data\n" + kSamples + "}\n";
const std::string kSteps =
    "global_transform 0.500000 0 0 0 0 0.500000 0 0 0 0 0.333333 0 0 0 0 1\n";
const std::string kSheared = "global_transform 1 .5 0 0 0 2 0 0 0 0 1 0 -1 0 0 1\n";

TEST(VFInterchange, ReadsWhatOtherProgramsWrite) {
    const std::vector<test::ForeignFile::Colour> unit{{{.5F, .5F, .25F}, {.5F, .25F, .125F}},
                                                      {{1.F, 1.F, 1.F}, {1.F, .5F, .5F}}};
    const std::string good = kHeader + kGrid + kSteps + kData;
    const std::string messy = "\xef\xbb\xbf" + kHeader + "\r\n#grid\r\n" + kGrid +
                              "element_size 0,5 0,5 0,333333\n\ndata\n# black\n" + kSamples +
                              "\r\n} # field\nanything\n1 2 3\n";
    test::expectLooks(".vf",
                      {{"steps of 1/N", good, unit},
                       {"compressed", test::gzip(good), unit},
                       {"returns, comments, commas", messy, unit},
                       {"not placed",
                        kHeader + kGrid + "unit 1\n" + kData,
                        unit,
                        {"5: \"unit\" is not known and not used",
                         "0: the file does not place its grid, which is taken to cover 0 to 1"}},
                       {"placed elsewhere",
                        kHeader + kGrid + "element_size .5 2 1\nworld_origin 0 1 -1\n" + kData,
                        {{{.25F, 2.F, 0.F}, {.5F, .25F, .25F}}}},
                       {"placed and sheared",
                        kHeader + kGrid + kSheared + kData,
                        {{{-.5F, 1.F, 1.F}, {.5F, .25F, .25F}}},
                        {"0: what global_transform turns or shears is not used"}}});
}

TEST(VFInterchange, SaysWhyAFileIsNoTable) {
    test::expectReasons(".vf", Mode::Meant,
                        {{"another version", "#Inventor V1.0 ascii\n",
                          "1: the file begins with \"#Inventor V1.0 ascii\""},
                         {"no parameters", kHeader.substr(0, 37) + kData,
                          "3: \"data\" stands where \"parameters\" should"},
                         {"no grid", kHeader + kData, "4: there is no line grid_size"},
                         {"half a matrix", kHeader + kGrid + "global_transform 1 0 0\n" + kData,
                          "5: \"global_transform\" needs 16 numbers, has 3"},
                         {"one point", kHeader + "grid_size 2 2 1\n" + kData,
                          "4: a table needs at least 2 points a side"},
                         {"mirrored", kHeader + kGrid + "element_size 1 -1 1\n" + kData,
                          "19: the domain does not rise"},
                         {"cut off by the brace", kHeader + kGrid + "data\n0 0 0\n}\n0 0 0\n",
                          "8: the file ends after 1 of 12 samples"},
                         {"a sample more", kHeader + kGrid + "data\n0 0 0\n" + kSamples,
                          "18: there are more samples than the 12 of the table"}});
    test::expectReasons(".vf", Mode::Book,
                        {{"cut short", kHeader + kGrid + "data\n0 0 0\n",
                          "6: the file ends after 1 of 12 samples"}});
}

}  // namespace
