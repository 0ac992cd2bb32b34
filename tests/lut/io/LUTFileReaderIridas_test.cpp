#include "lut/io/LUTFileReaderIridas.h"

#include <gtest/gtest.h>

#include <stdexcept>

#include "tests/support/Files.h"
#include "tests/support/Tables.h"

namespace {

using namespace test;

constexpr char kSyntaxError[] = "Iridas LUT reader: syntax error while reading LUT data.";
constexpr char kSizeError[] = "Iridas LUT reader: syntax error while reading LUT size.";
constexpr char kNoTable[] = "Iridas LUT reader: LUT failed to initialise.";

TEST(IridasReader, PutsRedFastestAndCoversZeroToOne) {
    const auto lut = readBytes(".cube", readFile(dataPath("cube/lattice.cube")));
    ASSERT_FALSE(lut->is1D());
    ASSERT_EQ(lut->width(), 2);
    ASSERT_EQ(lut->height(), 2);
    ASSERT_EQ(lut->depth(), 2);
    expectRGB(lut->get(0, 0, 0), 0.0F, 0.1F, 0.2F);
    expectRGB(lut->get(1, 0, 0), 1.0F, 0.1F, 0.2F);
    expectRGB(lut->get(0, 1, 0), 0.0F, 1.1F, 0.2F);
    expectRGB(lut->get(0, 0, 1), 0.0F, 0.1F, 1.2F);
    expectRGB(lut->get(0, 1, 1), -0.5F, 0.25F, 0.001F);
    expectRGB(lut->get(1, 1, 1), 1.0F, 1.1F, 1.2F);
    ol::Transform unit;
    unit.set_identity();
    EXPECT_EQ(lut->transform, unit);
}

TEST(IridasReader, ReadsACurveAndNothingAfterItsLastEntry) {
    const auto lut = readBytes(".itx", readFile(dataPath("cube/curve.cube")) + "not a number\n");
    ASSERT_TRUE(lut->is1D());
    ASSERT_EQ(lut->width(), 3);
    expectRGB(lut->get(1), 0.5F, 0.25F, 0.75F);
    EXPECT_EQ(lut->transform[0][0], 0.5F);
    EXPECT_EQ(lut->transform[3][3], 1.0F);
}

TEST(IridasReader, StartsOverWithSurplusSamplesAndLeavesMissingOnesZero) {
    const auto wrapped = readBytes(".cube", "LUT_3D_SIZE 1\n1 1 1\n2 3 4\n");
    expectRGB(wrapped->get(0, 0, 0), 2.0F, 3.0F, 4.0F);
    const auto shortened = readBytes(".cube", "LUT_3D_SIZE 2\n1 1 1\n");
    expectRGB(shortened->get(1, 0, 0), 0.0F, 0.0F, 0.0F);
}

TEST(IridasReader, KeepsThePositionWhenASecondSizeLineReplacesTheTable) {
    const auto larger = readBytes(".cube", "LUT_3D_SIZE 2\n1 1 1\nLUT_3D_SIZE 3\n5 5 5\n");
    ASSERT_EQ(larger->width(), 3);
    expectRGB(larger->get(0, 0, 0), 0.0F, 0.0F, 0.0F);
    expectRGB(larger->get(1, 0, 0), 5.0F, 5.0F, 5.0F);
    EXPECT_EQ(messageOf([] { readBytes(".cube", "LUT_3D_SIZE 2\n1 1 1\nLUT_3D_SIZE 1\n3 3 3\n"); }),
              kSyntaxError);
    EXPECT_EQ(messageOf([] { readBytes(".cube", "LUT_1D_SIZE 2\n1 1 1\nLUT_1D_SIZE 1\n3 3 3\n"); }),
              kSyntaxError);
}

TEST(IridasReader, ReadsNumbersAsTheCConversionsDo) {
    const auto lut = readBytes(".cube", "LUT_3D_SIZE 1abc\n+1e1 0x10 none\n");
    expectRGB(lut->get(0, 0, 0), 10.0F, 16.0F, 0.0F);
    const auto withReturns = readBytes(".cube", "LUT_3D_SIZE 1\r\n1.5 2.5 3.5\r\n");
    expectRGB(withReturns->get(0, 0, 0), 1.5F, 2.5F, 3.5F);
}

TEST(IridasReader, RefusesWhatIsNoCube) {
    expectRefused(".cube", "# ok\nLUT_3D_SIZE 2\n0 0 0\n",
                  {{"size zero", "SIZE 2", "SIZE 0", kSizeError},
                   {"size negative", "SIZE 2", "SIZE -4", kSizeError},
                   {"size missing", "SIZE 2", "SIZE", kSizeError},
                   {"four numbers", "0 0 0", "0 0 0 0", kSyntaxError},
                   {"two numbers", "0 0 0", "0 0", kSyntaxError},
                   {"comment without a blank", "0 0 0", "#comment", kSyntaxError},
                   {"blank before a carriage return", "0 0 0", "0 0 0 \r", kSyntaxError},
                   {"carriage return alone", "0 0 0", "\r", kSyntaxError},
                   {"data before the size", "# ok", "0 0 0", kNoTable},
                   {"text before the size", "# ok", "LUT_3D_INPUT_RANGE 0 1", kNoTable},
                   {"no size line", "LUT_3D_SIZE 2\n0 0 0\n", "", kNoTable}});
    EXPECT_EQ(messageOf([] { readBytes(".cube", ""); }), kNoTable);
    EXPECT_EQ(messageOf([] { ol::LUTFileReaderIridas().read("/no/such.cube"); }),
              "Iridas LUT reader: unable to open file.");
}

TEST(IridasReader, RefusesALatticeThatNoTableCanHold) {
    EXPECT_THROW(readBytes(".cube", "LUT_3D_SIZE 1291\n"), std::length_error);
    EXPECT_THROW(readBytes(".cube", "LUT_3D_SIZE 2147483647\n"), std::length_error);
}

TEST(IridasReader, TellsPlaceAndCountsAndCanBeUsedAgain) {
    const TempFolder folder;
    ol::LUTFileReaderIridas reader;
    const std::string bad = folder.write("bad.cube", "LUT_3D_SIZE 2\n\n1 1 1\n1 1\n");
    EXPECT_EQ(messageOf([&] { reader.read(bad); }), kSyntaxError);
    EXPECT_EQ(reader.lineNumber(), 4U);
    EXPECT_EQ(reader.sampleCount(), 1U);

    const auto first = reader.read(dataPath("cube/lattice.cube"));
    EXPECT_EQ(reader.sampleCount(), 8U);
    const auto second = reader.read(dataPath("cube/curve.cube"));
    EXPECT_EQ(reader.lineNumber(), 4U);
    EXPECT_EQ(reader.sampleCount(), 3U);
    EXPECT_FALSE(first->is1D());
    EXPECT_TRUE(second->is1D());
}

TEST(IridasReader, SurvivesEveryTruncation) {
    expectTruncationsAreSafe(".cube", readFile(dataPath("cube/lattice.cube")));
    expectTruncationsAreSafe(".cube", readFile(dataPath("cube/curve.cube")));
}

}  // namespace
