#include <gtest/gtest.h>

#include "tests/support/Files.h"
#include "tests/support/ForeignFiles.h"

namespace {

using namespace test;

constexpr char kDataError[] = "Iridas LUT reader: syntax error while reading LUT data.";
constexpr char kSizeError[] = "Iridas LUT reader: syntax error while reading LUT size.";
constexpr char kNoTable[] = "Iridas LUT reader: LUT failed to initialise.";

// Sample (r, g, b) is (r, g / 2, b / 4).
const std::string kSamples = "0 0 0\n1 0 0\n0 .5 0\n1 .5 0\n0 0 .25\n1 0 .25\n0 .5 .25\n1 .5 .25\n";
const std::string kCube = "LUT_3D_SIZE 2\n" + kSamples;
const std::string kShaped =
    "LUT_3D_SIZE 2\nLUT_3D_INPUT_RANGE 0 2\nLUT_1D_SIZE 3\nLUT_1D_INPUT_RANGE 0 4\n"
    "0 0 0\n.5 1 2\n2 2 2\n" +
    kSamples;

TEST(CubeInterchange, ReadsFilesAsMeant) {
    const Outcome shaped("2 2 2 -> .25 .25 .25, 3 4 0 -> .625 .5 0");
    expectOutcomes(
        ".cube",
        {{"a domain of a curve's channels",
          "LUT_1D_SIZE 2\nDOMAIN_MAX .5 1 1\n.25 0 -.5\n1 1.5 1\n", kMeant,
          ".25 .5 .5 -> .625 .75 .25"},
         {"a domain of each channel", "DOMAIN_MIN -1 0 1\nDOMAIN_MAX 1 4 2\n" + kCube, kMeant,
          "0 1 1.5 -> .5 .125 .125, 2 4 0 -> 1 .5 0"},
         {"a range behind the samples", kCube + "LUT_3D_INPUT_RANGE 0 2\n", kMeant,
          "2 2 2 -> 1 .5 .25"},
         {"a domain behind the samples", kCube + "DOMAIN_MAX 2 2 2\n", kMeant,
          "1 1 1 -> .5 .25 .125"},
         {"a curve with a range", "LUT_1D_SIZE 2\nLUT_1D_INPUT_RANGE -1 3\n0 0 0\n4 2 1\n", kMeant,
          "0 1 2 -> 1 1 .75"},
         {"a 1D block before the lattice, either size first", kShaped, kMeant, shaped},
         {"a domain of a 1D block", replaced(kShaped, "LUT_1D_INPUT_RANGE 0", "DOMAIN_MAX 4 4"),
          kMeant, shaped},
         {"words that mean nothing",
          "TITLE x\nLUT_IN_VIDEO_RANGE\nLUT_1D_INPUT_RANGE 0 2\n" + kCube, kMeant,
          ".5 .5 .5 -> .5 .25 .125",
          "2: \"LUT_IN_VIDEO_RANGE\" is not known and not used | 0: \"LUT_1D_INPUT_RANGE\" is not "
          "used: the file has no 1D block"},
         {"a domain stated twice", "DOMAIN_MAX 4 4 4\nDOMAIN_MAX 2 2 2\n" + kCube, kMeant,
          "1 1 1 -> .5 .25 .125", "2: \"DOMAIN_MAX\" is stated again: this one is used"},
         {"a range beside a domain", "LUT_3D_INPUT_RANGE 0 4\nDOMAIN_MAX 2 2 2\n" + kCube, kMeant,
          "1 1 1 -> .5 .25 .125",
          "0: \"LUT_3D_INPUT_RANGE\" is not used: the domain is stated as well"},
         {"the same range beside a domain", "LUT_3D_INPUT_RANGE 0 2\nDOMAIN_MAX 2 2 2\n" + kCube,
          kMeant, "1 1 1 -> .5 .25 .125"},
         {"small letters", "lut_3d_size 2\n" + kSamples, kMeant, kNoTable,
          "1: \"lut_3d_size\" is not known and not used: keywords are in capital letters | "
          "2: what is missing should come before this line of three numbers"},
         {"returns alone", "LUT_3D_SIZE 2\r0 0 0\r1 1 1\r", kMeant, kSizeError,
          "1: the lines of the file end in carriage returns alone"},
         {"a domain by the book", "DOMAIN_MIN 0 0 0\nDOMAIN_MAX 1 2 1\n" + kCube, kBook,
          ".5 .5 .5 -> .5 .25 .125", "2: the domain is not used: the table covers 0 to 1"},
         {"no words", "# nothing\n", kMeant, kNoTable,
          "1: there is no line LUT_1D_SIZE or LUT_3D_SIZE"},
         {"a size with a tail", "LUT_3D_SIZE 2x\n" + kSamples, kMeant, kSizeError,
          "1: \"2x\" is no size"},
         {"one point", "LUT_3D_SIZE 1\n0 0 0\n", kMeant, kSizeError,
          "1: a table needs at least 2 points a side"},
         {"two sizes", "LUT_3D_SIZE 2\n" + kCube, kMeant, kSizeError, "2: a second size line"},
         {"another format", "NUCODA_3D_CUBE 1\n" + kCube, kMeant, kDataError,
          "1: \"NUCODA_3D_CUBE\" tells a .cms file by another name"},
         {"a misspelt sample", replaced(kCube, "\n1 0 0\n", "\nO 0 0\n"), kMeant, kDataError,
          "3: \"O\" is no number"},
         {"a falling domain", "DOMAIN_MAX 1 0 1\n" + kCube, kMeant, kDataError,
          "10: the domain does not rise"},
         {"a range of one number", "LUT_3D_INPUT_RANGE 1\n" + kCube, kMeant, kDataError,
          "1: \"LUT_3D_INPUT_RANGE\" needs 2 numbers, has 1"}});
}

}  // namespace
