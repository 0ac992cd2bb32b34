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

}  // namespace
