#include "lut/io/LUTFileReaderTruelight.h"

#include <gtest/gtest.h>

#include <stdexcept>

#include "tests/support/Files.h"
#include "tests/support/Tables.h"

namespace {

using namespace test;

constexpr char kNoData[] = "Truelight LUT reader: syntax error while reading LUT data.";
constexpr char kCubeError[] =
    "Truelight LUT reader: syntax error while reading LUT data (too many or not enough values).";
constexpr char kWidthError[] = "Truelight LUT reader: expected 3 values for width.";
constexpr char kFewInputs[] = "Truelight LUT reader: expecting more pre-LUT data.";
constexpr char kInputError[] =
    "Truelight LUT reader: syntax error while reading pre-LUT data (too many or not enough "
    "values).";

TEST(TruelightReader, KeepsTheIdentityWithAnInputLUTAndStopsAtEnd) {
    const auto lut = readBytes(".cub", readFile(dataPath("cub/input-lut.cub")));
    ASSERT_EQ(lut->outputShaper.entries.size(), 3U);
    expectRGB(lut->outputShaper.entries[1], 0.25F, 0.5F, 0.75F);
    expectRGB(lut->outputShaper.entries[2], 1.0F, 1.0F, 1.5F);
    expectRGB(lut->outputShaper.counts, 3.0F, 3.0F, 3.0F);
    EXPECT_TRUE(lut->inputShaper.empty());
    expectRGB(lut->get(1, 0, 0), 1.1F, 0.2F, 0.3F);
    expectRGB(lut->get(0, 0, 1), -0.1F, 0.2F, 1.3F);
    ol::Transform identity;
    identity.set_identity();
    EXPECT_EQ(lut->transform, identity);
}

TEST(TruelightReader, TakesDataForCubeUntilToldOtherwiseAndChecksNoCounts) {
    const auto lut = readBytes(".cub",
                               "# lutLength 9\n# lutLength\n# width 2 2 2\n1 2 3\n"
                               "# InputLUT\n4 5 6\n# Cube\n7 8 9\n");
    expectRGB(lut->get(0, 0, 0), 1.0F, 2.0F, 3.0F);
    expectRGB(lut->get(1, 0, 0), 7.0F, 8.0F, 9.0F);
    expectRGB(lut->get(0, 1, 0), 0.0F, 0.0F, 0.0F);
    ASSERT_EQ(lut->outputShaper.entries.size(), 1U);
    expectRGB(lut->outputShaper.entries[0], 4.0F, 5.0F, 6.0F);
    expectRGB(lut->outputShaper.counts, 9.0F, 9.0F, 9.0F);
    EXPECT_EQ(readBytes(".cub", "# InputLUT\n4 5 6\n")->width(), 0);
}

TEST(TruelightReader, KeepsSamplesInStorageAndThePositionWhenResized) {
    // Elements 0 to 3 are stored, then 1 1 2 keeps two of them; the position is (0, 0, 1).
    const std::string start = "# width 2 2 2\n1 0 0\n2 0 0\n3 0 0\n4 0 0\n";
    const auto lut = readBytes(".cub", start + "# width 1 1 2\n# width 3 2 2\n5 0 0\n");
    ASSERT_EQ(lut->width(), 3);
    const float stored[] = {1, 2, 0, 0, 0, 0, 5, 0, 0, 0, 0, 0};
    for (std::size_t element = 0; element < 12; ++element)
        EXPECT_EQ(lut->data()[3 * element], stored[element]) << element;
    // Later samples win over earlier ones of the same place.
    const auto again = readBytes(".cub", start + "# width 1 1 2\n6 0 0\n");
    EXPECT_EQ(again->data()[0], 1.0F);
    EXPECT_EQ(again->data()[3], 6.0F);
}

TEST(TruelightReader, DoesNotKnowAKeywordWithAReturn) {
    const auto lut = readBytes(".cub",
                               "# width 2 1 2\r\n# lutLength 2\r\n# InputLUT\r\n1 2 3\r\n4 5 6\r\n"
                               "# Cube\r\n7 8 9\r\n# end\r\n1e1 11 12\r\n");
    EXPECT_TRUE(lut->outputShaper.empty());
    expectRGB(lut->outputShaper.counts, 2.0F, 2.0F, 2.0F);
    expectRGB(lut->get(0, 0, 0), 1.0F, 2.0F, 3.0F);
    expectRGB(lut->get(0, 0, 1), 7.0F, 8.0F, 9.0F);
    expectRGB(lut->get(1, 0, 1), 10.0F, 11.0F, 12.0F);
}

TEST(TruelightReader, TrimsDataLinesOnlyAfterCountingTheirWords) {
    const auto lut = readBytes(".cub", "# width 1 1 1\n\f+1 2x 0x10\v\n\f \v \r\n \t\n");
    expectRGB(lut->get(0, 0, 0), 1.0F, 2.0F, 16.0F);
}

TEST(TruelightReader, RefusesWhatIsNoCube) {
    expectRefused(
        ".cub", "# width 1 1 1\n# cube\n0 0 0\n# InputLUT\n7 7 7\n",
        {{"two sizes", "1 1 1\n#", "1 1\n#", kWidthError},
         {"four sizes", "1 1 1\n#", "1 1 1 1\n#", kWidthError},
         {"return apart from the sizes", "1 1 1\n#", "1 1 1 \r\n#", kWidthError},
         {"no size line", "# width", "# note", kCubeError},
         {"mark does not stand alone", "# width", "#width", kCubeError},
         {"a side of zero", "1 1 1\n#", "1 0 1\n#", kCubeError},
         {"two numbers and a return", "0 0 0", "0 0 \r", kCubeError},
         {"return alone", "0 0 0", "\r", kCubeError},
         {"sample outside a second size", "0 0 0", "1 1 1\n# width 0 0 0\n2 2 2", kCubeError},
         {"input LUT of two numbers", "7 7 7", "7 7", kFewInputs},
         {"input LUT of four numbers", "7 7 7", "7 7 7 7", kFewInputs},
         {"input LUT of two and a return", "7 7 7", "7 7 \r", kInputError},
         {"input LUT of nothing", "7 7 7", "\f \v \r", kInputError}});
    EXPECT_EQ(messageOf([] { readBytes(".cub", "# width 1 1 1\n# Cube\n# end\n0 0 0\n"); }),
              kNoData);
    EXPECT_EQ(messageOf([] { readBytes(".cub", "# width 1 1 1\n# cube\n\f \v \r\n"); }), kNoData);
}

TEST(TruelightReader, DoesNotBelieveCounts) {
    for (const char* refused : {"# lutLength -1\n", "# width -1 1 1\n"})
        EXPECT_THROW(readBytes(".cub", std::string(refused) + "0 0 0\n"), std::length_error);
    const auto longest = readBytes(".cub", "# lutLength 2147483647\n# InputLUT\n0 0 0\n");
    EXPECT_EQ(longest->outputShaper.entries.size(), 1U);
    EXPECT_EQ(longest->outputShaper.counts[0], 2147483648.0F);
}

}  // namespace
