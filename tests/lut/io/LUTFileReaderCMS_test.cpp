#include "lut/io/LUTFileReaderCMS.h"

#include <gtest/gtest.h>

#include <stdexcept>

#include "tests/support/Files.h"
#include "tests/support/Tables.h"

namespace {

using namespace test;

constexpr char kPreLUTError[] = "CMS LUT reader: syntax error while reading pre-LUT data.";
constexpr char kDataError[] = "CMS LUT reader: syntax error while reading LUT data.";
constexpr char kNoTable[] = "CMS LUT reader: failed to read LUT file.";

TEST(CMSReader, DividesThePreLUTByThePoints) {
    const auto lut = readBytes(".cms", readFile(dataPath("cms/lattice.cms")));
    ASSERT_EQ(lut->outputShaper.entries.size(), 3U);
    expectRGB(lut->outputShaper.entries[0], 0.0F, 0.0F, 0.0F);
    expectRGB(lut->outputShaper.entries[1], 0.5F, 0.25F, 0.125F);
    expectRGB(lut->outputShaper.entries[2], 1.0F, 1.0F, 1.0F);
    expectRGB(lut->outputShaper.counts, 3.0F, 3.0F, 3.0F);
    EXPECT_TRUE(lut->inputShaper.empty());
    const auto large = readBytes(".cms", "LUT_3D_SIZE 17\nLUT_1D_SIZE 1x\n17 17 17\n");
    expectRGB(large->outputShaper.entries[0], 1.0F, 1.0F, 1.0F);
}

TEST(CMSReader, TrimsLinesAndReadsNumbersAsTheCConversionsDo) {
    const auto lut = readBytes(".cms",
                               "\v LUT_1D_SIZE 2 \r\n\r\n\tLUT_3D_SIZE\t2\r\n"
                               "0 0 0 \r\n TITLE of three\n#\n"
                               " +1e1 0x10 none \r\n\f1 2 3\r\n");
    // Within the pre-LUT no line is anything but data.
    expectRGB(lut->outputShaper.entries[1], 0.0F, 0.0F, 0.0F);
    expectRGB(lut->get(0, 0, 0), 10.0F, 16.0F, 0.0F);
    expectRGB(lut->get(1, 0, 0), 1.0F, 2.0F, 3.0F);
}

TEST(CMSReader, KeepsThePositionWhenASecondSizeLineReplacesTheTable) {
    const std::string start = "LUT_1D_SIZE 1\nLUT_3D_SIZE 3\n9 9 9\n1 1 1\n1 1 1\n";
    const auto larger = readBytes(".cms", start + "LUT_3D_SIZE 4\n5 5 5\n");
    ASSERT_EQ(larger->width(), 4);
    expectRGB(larger->get(1, 0, 0), 0.0F, 0.0F, 0.0F);
    expectRGB(larger->get(2, 0, 0), 5.0F, 5.0F, 5.0F);
    EXPECT_TRUE(larger->outputShaper.empty());
    EXPECT_EQ(messageOf([&] { readBytes(".cms", start + "LUT_3D_SIZE 2\n5 5 5\n"); }), kDataError);
    EXPECT_EQ(messageOf([&] { readBytes(".cms", start + "LUT_3D_SIZE 1\n5 5 5\n"); }), kNoTable);
}

TEST(CMSReader, RefusesWhatIsNoTable) {
    expectRefused(".cms", readFile(dataPath("cms/lattice.cms")),
                  {{"size zero", "LUT_3D_SIZE 2", "LUT_3D_SIZE 0", kNoTable},
                   {"size one", "LUT_3D_SIZE 2", "LUT_3D_SIZE 1", kNoTable},
                   {"size missing", "LUT_3D_SIZE 2", "LUT_3D_SIZE", kNoTable},
                   {"data before the size", "# comments", "0 0 0\n# comments", kNoTable},
                   {"text before the size", "# comments", "#comments", kNoTable},
                   {"no pre-LUT size", "LUT_1D_SIZE 3\n", "", kPreLUTError},
                   {"pre-LUT size zero", "LUT_1D_SIZE 3", "LUT_1D_SIZE 0", kPreLUTError},
                   {"pre-LUT size negative", "LUT_1D_SIZE 3", "LUT_1D_SIZE -3", kPreLUTError},
                   {"first of the pre-LUT", "0.0 0.0 0.0", "0.0 0.0", kPreLUTError},
                   {"second of the pre-LUT", "1.0 0.5 0.25", "1.0 0.5", kDataError},
                   {"comment in the pre-LUT", "2.0 2.0 2.0", "# note\n2.0 2.0 2.0", kDataError},
                   {"comment without a blank", "# between the planes", "#between", kDataError}});
    EXPECT_EQ(
        messageOf([] { readBytes(".cms", "LUT_1D_SIZE 2147483647\nLUT_3D_SIZE 2\n0 0 0\n"); }),
        "CMS LUT reader: expecting more pre-LUT data.");
    EXPECT_THROW(readBytes(".cms", "LUT_3D_SIZE -2\n"), std::length_error);
}

}  // namespace
