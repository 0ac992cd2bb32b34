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
    const auto back = readBytes(".vf", readFile(folder.path("out.vf")));
    EXPECT_EQ(back->transform[1][1], 0.030303F);
    expectSamplesNear(*back, *lut, 0.5e-6F + 1e-7F);
}

}  // namespace
