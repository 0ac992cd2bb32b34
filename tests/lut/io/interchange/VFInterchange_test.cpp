#include <gtest/gtest.h>

#include "tests/support/ForeignFiles.h"
#include "tests/support/Gzip.h"

namespace {

using namespace test;

constexpr char kDataError[] = "VF file reader: syntax error while reading LUT data.";
constexpr char kGridError[] = "VF file reader: expecting 3 values for grid_size.";
constexpr char kHeaderError[] = "VF file reader: expecting #Inventor V2.1 ascii header line.";

const std::string kNode = "#Inventor V2.1 ascii\nSoVectorField {\n";
const std::string kHeader = kNode + "parameters\n";
// 2 x 2 x 3 points, blue fastest; sample (r, g, b) is (r, g / 2, b / 4).
const std::string kGrid = kHeader + "grid_size 2 2 3\n";
const std::string kData =
    "data\n0 0 0\n0 0 .25\n0 0 .5\n0 .5 0\n0 .5 .25\n0 .5 .5\n"
    "1 0 0\n1 0 .25\n1 0 .5\n1 .5 0\n1 .5 .25\n1 .5 .5\n}\n";
const std::string kSteps =
    "global_transform 0.500000 0 0 0 0 0.500000 0 0 0 0 0.333333 0 0 0 0 1\n";
const std::string kSheared = "global_transform 1 .5 0 0 0 2 0 0 0 0 1 0 -1 0 0 1\n";

TEST(VFInterchange, ReadsFilesAsMeant) {
    const Outcome unit(".5 .5 .25 -> .5 .25 .125, 1 1 1 -> 1 .5 .5");
    const std::string good = kGrid + kSteps + kData;
    expectOutcomes(
        ".vf",
        {{"steps of 1/N", good, kMeant, unit},
         {"compressed", gzip(good), kMeant, unit},
         {"commas, more behind the end",
          kGrid + "element_size 0,5 0,5 0,333333\n" + kData + "anything\n1 2 3\n", kMeant, unit},
         {"not placed", kGrid + "unit 1\n" + kData, kMeant, unit,
          "5: \"unit\" is not known and not used | 0: the file does not place its grid, which is "
          "taken to cover 0 to 1"},
         {"placed elsewhere", kGrid + "element_size .5 2 1\nworld_origin 0 1 -1\n" + kData, kMeant,
          ".25 2 0 -> .5 .25 .25"},
         {"placed and sheared", kGrid + kSheared + kData, kMeant, "-.5 1 1 -> .5 .25 .25",
          "0: what global_transform turns or shears is not used"},
         {"another version", "#Inventor V1.0 ascii\n", kMeant, kHeaderError,
          "1: the file begins with \"#Inventor V1.0 ascii\""},
         {"no parameters", kNode + kData, kMeant, kDataError,
          "3: \"data\" stands where \"parameters\" should"},
         {"no grid", kHeader + kData, kMeant, kDataError, "4: there is no line grid_size"},
         {"half a matrix", kGrid + "global_transform 1 0 0\n" + kData, kMeant, kDataError,
          "5: \"global_transform\" needs 16 numbers, has 3"},
         {"one point", kHeader + "grid_size 2 2 1\n" + kData, kMeant, kGridError,
          "4: a table needs at least 2 points a side"},
         {"mirrored", kGrid + "element_size 1 -1 1\n" + kData, kMeant, kDataError,
          "19: the domain does not rise"},
         {"cut off by the brace", kGrid + "data\n0 0 0\n}\n0 0 0\n", kMeant, kDataError,
          "8: the file ends after 1 of 12 samples"},
         {"cut short by the book", kGrid + "data\n0 0 0\n", kBook, kDataError,
          "6: the file ends after 1 of 12 samples"}});
}

}  // namespace
