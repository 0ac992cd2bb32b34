#include "lut/io/LUTFileReaderTruelight.h"

#include <gtest/gtest.h>
#include <sys/resource.h>

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

TEST(TruelightReader, PutsRedFastestAndCoversZeroToOne) {
    const auto lut = readBytes(".cub", readFile(dataPath("cub/lattice.cub")));
    ASSERT_EQ(lut->width(), 2);
    ASSERT_EQ(lut->height(), 3);
    ASSERT_EQ(lut->depth(), 4);
    for (int b = 0; b < 4; ++b) {
        for (int g = 0; g < 3; ++g) {
            for (int r = 0; r < 2; ++r)
                expectRGB(lut->get(r, g, b), float(r), float(g), float(b));
        }
    }
    EXPECT_TRUE(lut->outputShaper.empty());
    ol::Transform unit;
    unit.set_identity();
    unit[1][1] = 0.5F;
    unit[2][2] = 1.0F / 3.0F;
    EXPECT_EQ(lut->transform, unit);
}

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

TEST(TruelightReader, StartsOverWithSurplusSamples) {
    const TempFolder folder;
    ol::LUTFileReaderTruelight reader;
    std::string text = "# width 2 2 2\n";
    for (const char digit : std::string("123456789"))
        text += std::string(1, digit) + " 0 0\n";
    const auto lut = reader.read(folder.write("nine.cub", text));
    expectRGB(lut->get(0, 0, 0), 9.0F, 0.0F, 0.0F);
    expectRGB(lut->get(1, 0, 0), 2.0F, 0.0F, 0.0F);
    EXPECT_EQ(reader.sampleCount(), 9U);
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
         {"four numbers", "0 0 0", "0 0 0 0", kCubeError},
         {"two numbers", "0 0 0", "0 0", kCubeError},
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
    EXPECT_EQ(messageOf([] { readBytes(".cub", ""); }), kNoData);
    EXPECT_EQ(messageOf([] { ol::LUTFileReaderTruelight().read("/no/such.cub"); }),
              "Truelight LUT reader: unable to open file.");
}

TEST(TruelightReader, DoesNotBelieveCounts) {
    for (const char* refused : {"# lutLength -1\n", "# width -1 1 1\n", "# width 1291 1291 1291\n"})
        EXPECT_THROW(readBytes(".cub", std::string(refused) + "0 0 0\n"), std::length_error);
    const auto longest = readBytes(".cub", "# lutLength 2147483647\n# InputLUT\n0 0 0\n");
    EXPECT_EQ(longest->outputShaper.entries.size(), 1U);
    EXPECT_EQ(longest->outputShaper.counts[0], 2147483648.0F);
}

TEST(TruelightReader, StaysSmallHoweverOftenAHugeLatticeIsResized) {
    std::string text;
    for (int i = 0; i < 10; ++i)
        text += "# width 400 400 400\n1 1 1\n# width 400 400 399\n1 1 1\n";
    const auto peakKilobytes = [] {
        rusage usage{};
        getrusage(RUSAGE_SELF, &usage);
        return usage.ru_maxrss;
    };
    const auto before = peakKilobytes();
    const auto lut = readBytes(".cub", text);
    EXPECT_EQ(lut->get(19, 0, 0)[0], 1.0F);
    // The samples alone would be 750 000 kB.
    EXPECT_LT(peakKilobytes() - before, 300000);
}

TEST(TruelightReader, TellsPlaceAndCountsAndCanBeUsedAgain) {
    const TempFolder folder;
    ol::LUTFileReaderTruelight reader;
    const std::string bad = folder.write("bad.cub", "# width 2 2 2\n\n# InputLUT\n1 1 1\n2 2\n");
    EXPECT_EQ(messageOf([&] { reader.read(bad); }), kFewInputs);
    EXPECT_EQ(reader.lineNumber(), 5U);
    EXPECT_EQ(reader.sampleCount(), 0U);

    const auto first = reader.read(dataPath("cub/input-lut.cub"));
    EXPECT_EQ(reader.lineNumber(), 16U);
    EXPECT_EQ(reader.sampleCount(), 4U);
    const auto second = reader.read(dataPath("cub/lattice.cub"));
    EXPECT_EQ(reader.sampleCount(), 24U);
    EXPECT_TRUE(second->outputShaper.empty());
    EXPECT_EQ(first->height(), 1);
}

TEST(TruelightReader, SurvivesEveryTruncation) {
    expectTruncationsAreSafe(".cub", readFile(dataPath("cub/lattice.cub")));
    expectTruncationsAreSafe(".cub", readFile(dataPath("cub/input-lut.cub")));
}

}  // namespace
