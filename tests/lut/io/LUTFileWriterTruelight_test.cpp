#include "lut/io/LUTFileWriterTruelight.h"

#include <gtest/gtest.h>

#include <filesystem>

#include "lut/RampFill.h"
#include "lut/io/LUTFileReaderTruelight.h"
#include "tests/support/Files.h"
#include "tests/support/Tables.h"

namespace {

using namespace test;

TEST(TruelightWriter, WritesInputLUTAndCube) {
    const TempFolder folder;
    const auto lut = markedLattice(2, 1, 3);
    lut->outputShaper.entries = {ol::RGB(0.0F, -0.25F, 0.5F), ol::RGB(1.0F, 2.0F, 1000.0F)};
    lut->inputShaper.entries = {ol::RGB(9.0F, 9.0F, 9.0F)};
    ol::LUTFileWriterTruelight().write(folder.path("out.cub"), lut);
    EXPECT_EQ(readFile(folder.path("out.cub")),
              "# Truelight Cube v2.0\n"
              "# iDims 3\n"
              "# oDims 3\n"
              "# width 2 1 3\n"
              "# lutLength 2\n"
              "# InputLUT\n"
              "0.000000 -0.250000 0.500000\n"
              "1.000000 2.000000 1000.000000\n"
              "\n"
              "# Cube\n"
              "0.000000 0.100000 0.200000\n"
              "0.000100 0.100100 0.200100\n"
              "0.010000 0.110000 0.210000\n"
              "0.010100 0.110100 0.210100\n"
              "0.020000 0.120000 0.220000\n"
              "0.020100 0.120100 0.220100\n");
}

TEST(TruelightWriter, LeavesOutAnEmptyInputLUTAndPutsGreenBeforeBlue) {
    const TempFolder folder;
    const auto lut = markedLattice(1, 2, 2);
    lut->outputShaper.counts.fill(2.0F);  // counts without entries are no shaper
    ol::LUTFileWriterTruelight().write(folder.path("out.cub"), lut);
    EXPECT_EQ(readFile(folder.path("out.cub")),
              "# Truelight Cube v2.0\n"
              "# iDims 3\n"
              "# oDims 3\n"
              "# width 1 2 2\n"
              "\n"
              "# Cube\n"
              "0.000000 0.100000 0.200000\n"
              "0.001000 0.101000 0.201000\n"
              "0.010000 0.110000 0.210000\n"
              "0.011000 0.111000 0.211000\n");
}

TEST(TruelightWriter, ReadsBack) {
    const TempFolder folder;
    const std::string file = folder.write("out.cub", std::string(100000, 'x'));
    const auto lut = markedLattice(3, 5, 4);
    ol::fillSmoothRamp(lut->outputShaper.entries, 7, 4);
    ol::LUTFileWriterTruelight().write(file, lut);
    const auto back = ol::LUTFileReaderTruelight().read(file);
    const float tolerance = 0.5e-6F + 1e-7F;
    expectSamplesNear(*back, *lut, tolerance);
    expectRGB(back->outputShaper.counts, 7.0F, 7.0F, 7.0F);
    ASSERT_EQ(back->outputShaper.entries.size(), 7U);
    for (std::size_t i = 0; i < 7; ++i) {
        EXPECT_NEAR(back->outputShaper.entries[i][2], lut->outputShaper.entries[i][2],
                    tolerance + 2.5e-7F);
    }
}

TEST(TruelightWriter, RefusesACurveBeforeAFileIsMade) {
    const TempFolder folder;
    ol::LUTFileWriterTruelight writer;
    EXPECT_EQ(messageOf([&] { writer.write(folder.path("no.cub"), markedCurve(2)); }),
              "unable to write: must be a 3D lut");
    EXPECT_FALSE(std::filesystem::exists(folder.path("no.cub")));
    EXPECT_EQ(messageOf([&] { writer.write(folder.path("no/no.cub"), markedLattice(2, 2, 2)); }),
              "unable to open file for writing");
}

}  // namespace
