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

TEST(IridasReader, ReadsACurveAndNothingAfterItsLastEntry) {
    const auto lut = readBytes(".itx", readFile(dataPath("cube/curve.cube")) + "not a number\n");
    ASSERT_TRUE(lut->is1D());
    ASSERT_EQ(lut->width(), 3);
    expectRGB(lut->get(1), 0.5F, 0.25F, 0.75F);
    EXPECT_EQ(lut->transform[0][0], 0.5F);
    EXPECT_EQ(lut->transform[3][3], 1.0F);
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

TEST(IridasReader, RefusesWhatIsNoCube) {
    expectRefused(".cube", "# ok\nLUT_3D_SIZE 2\n0 0 0\n",
                  {{"size zero", "SIZE 2", "SIZE 0", kSizeError},
                   {"size negative", "SIZE 2", "SIZE -4", kSizeError},
                   {"size missing", "SIZE 2", "SIZE", kSizeError},
                   {"comment without a blank", "0 0 0", "#comment", kSyntaxError},
                   {"blank before a carriage return", "0 0 0", "0 0 0 \r", kSyntaxError},
                   {"carriage return alone", "0 0 0", "\r", kSyntaxError},
                   {"data before the size", "# ok", "0 0 0", kNoTable},
                   {"text before the size", "# ok", "LUT_3D_INPUT_RANGE 0 1", kNoTable},
                   {"no size line", "LUT_3D_SIZE 2\n0 0 0\n", "", kNoTable}});
}

}  // namespace
