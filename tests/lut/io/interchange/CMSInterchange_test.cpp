#include <gtest/gtest.h>

#include "tests/support/ForeignFiles.h"

namespace {

using namespace test;

constexpr char kDataError[] = "CMS LUT reader: syntax error while reading LUT data.";
constexpr char kPreLUTError[] = "CMS LUT reader: syntax error while reading pre-LUT data.";
constexpr char kPreLUTEnds[] = "CMS LUT reader: expecting more pre-LUT data.";
constexpr char kNoTable[] = "CMS LUT reader: failed to read LUT file.";

// Sample (r, g, b) is (r, g / 2, b / 4).
const std::string kSamples = "0 0 0\n1 0 0\n0 .5 0\n1 .5 0\n0 0 .25\n1 0 .25\n0 .5 .25\n1 .5 .25\n";
const std::string kSize = "LUT_3D_SIZE 2\n";
const std::string kCut = "LUT_1D_SIZE 3\n" + kSize + "0 0 0\n.5 1 1.5\n";  // the pre-LUT's end
const std::string kPreLUT = kCut + "2 2 2\n";

TEST(CMSInterchange, ReadsFilesAsMeant) {
    expectOutcomes(
        ".cms",
        {{"no pre-LUT, a range",
          "NUCODA_3D_CUBE 3\nTITLE x\n" + kSize + "LUT_3D_INPUT_RANGE -1,0 3,0\n" + kSamples,
          kMeant, "0 1 2 -> .25 .25 .1875"},
         {"a pre-LUT with a comment", kCut + "#white\n2 2 2\n" + kSamples, kMeant,
          ".5 .5 .5 -> .25 .25 .1875, 1 1 1 -> 1 .5 .25"},
         {"words that mean nothing", "LUT_3D_INPUT_RANGE 0 2\nGAMMA 2 2\n" + kPreLUT + kSamples,
          kMeant, ".5 .5 .5 -> .25 .25 .1875",
          "2: \"GAMMA\" is not known and not used | 0: the range is not used: the pre-LUT leads to "
          "the lattice by itself"},
         {"no size", "NUCODA_3D_CUBE 1\n", kMeant, kNoTable, "1: there is no line LUT_3D_SIZE"},
         {"data before it", "0 0 0\n" + kSize, kMeant, kNoTable,
          "1: the line LUT_3D_SIZE has to come before this one"},
         {"no pre-LUT entries", "LUT_1D_SIZE 0\n" + kSize + kSamples, kMeant, kDataError,
          "1: a table needs at least 2 points a side"},
         {"a size among samples", kSize + "0 0 0\nLUT_1D_SIZE 2\n", kMeant, kDataError,
          "3: a size line behind samples"},
         {"an entry cut off", kCut, kMeant, kPreLUTEnds,
          "4: the file ends within the 3 entries of the pre-LUT"},
         {"a falling range", "LUT_3D_INPUT_RANGE 1 0\n" + kSize + kSamples, kMeant, kDataError,
          "1: the domain does not rise"},
         {"no pre-LUT by the book", kSize + kSamples, kBook, kPreLUTError,
          "2: there is no line LUT_1D_SIZE"},
         {"a range by the book", "LUT_1D_SIZE 2\n" + kSize + "LUT_3D_INPUT_RANGE 0 1\n0 0 0\n",
          kBook, "", "3: \"LUT_3D_INPUT_RANGE\" is taken for an entry or a sample"}});
}

}  // namespace
