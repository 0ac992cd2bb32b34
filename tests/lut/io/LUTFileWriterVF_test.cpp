#include "lut/io/LUTFileWriterVF.h"

#include <gtest/gtest.h>

#include <filesystem>

#include "lut/io/LUTFileReaderVF.h"
#include "lut/io/Registry.h"
#include "tests/support/Files.h"
#include "tests/support/Gzip.h"
#include "tests/support/Tables.h"

namespace {

using namespace test;

TEST(VFWriter, WritesBlueFastestAndNeverCompressed) {
    const TempFolder folder;
    for (const char* const name : {"out.vf", "out.vfz", "out.vf.gz"}) {
        ol::createWriter(name, false, "")->write(folder.path(name), markedLattice(2, 2, 2));
        EXPECT_EQ(readFile(folder.path(name)),
                  "#Inventor V2.1 ascii\n"
                  "SoVectorField {\n"
                  "parameters\n"
                  "grid_size 2 2 2\n"
                  "global_transform 0.500000 0.000000 0.000000 0.000000 "
                  "0.000000 0.500000 0.000000 0.000000 "
                  "0.000000 0.000000 0.500000 0.000000 "
                  "0.000000 0.000000 0.000000 1.000000\n"
                  "data\n"
                  "0.000000 0.100000 0.200000\n"
                  "0.010000 0.110000 0.210000\n"
                  "0.001000 0.101000 0.201000\n"
                  "0.011000 0.111000 0.211000\n"
                  "0.000100 0.100100 0.200100\n"
                  "0.010100 0.110100 0.210100\n"
                  "0.001100 0.101100 0.201100\n"
                  "0.011100 0.111100 0.211100\n"
                  "}\n");
    }
}

TEST(VFWriter, PlacesGridInStepsOfOneOverN) {
    const TempFolder folder;
    const auto lut = markedLattice(33, 33, 33);
    ol::setUnitDomain(*lut, 33, 33, 33);  // not what the file says
    ol::LUTFileWriterVF().write(folder.path("out.vf"), lut);
    const std::string text = readFile(folder.path("out.vf"));
    EXPECT_NE(text.find("global_transform 0.030303 0.000000 "), std::string::npos);
    folder.write("out.vfz", gzip(text));

    ol::Transform expected;
    expected.set_identity();
    expected[0][0] = expected[1][1] = expected[2][2] = 0.030303F;
    for (const char* const name : {"out.vf", "out.vfz"}) {
        const auto readBack = ol::LUTFileReaderVF().read(folder.path(name));
        EXPECT_EQ(readBack->transform, expected);
        expectSamplesNear(*readBack, *lut, 0.5e-6F + 1e-7F);
    }
}

TEST(VFWriter, RefusesBeforeAFileIsMade) {
    const TempFolder folder;
    ol::LUTFileWriterVF writer;
    EXPECT_EQ(messageOf([&] { writer.write(folder.path("no.vf"), markedCurve(2)); }),
              "unable to write: must be a 3D lut");
    const int sizes[][3] = {{2, 2, 3}, {2, 3, 2}, {3, 2, 2}};
    for (const auto& [width, height, depth] : sizes) {
        EXPECT_EQ(messageOf([&, w = width, h = height, d = depth] {
                      writer.write(folder.path("no.vf"), markedLattice(w, h, d));
                  }),
                  "unable to write: must have the same dimension in r, g and b");
    }
    EXPECT_FALSE(std::filesystem::exists(folder.path("no.vf")));
    EXPECT_EQ(messageOf([&] { writer.write(folder.path("no/folder.vf"), markedLattice(1, 1, 1)); }),
              "unable to open file for writing");
}

}  // namespace
