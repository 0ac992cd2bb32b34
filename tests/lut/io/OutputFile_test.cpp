// What becomes of a table when the system does not take all of its file.

#include "lut/io/OutputFile.h"

#include <gtest/gtest.h>

#include <string>

#include "lut/io/Registry.h"
#include "tests/support/Files.h"
#include "tests/support/Tables.h"
#include "tests/support/ThreeDL.h"

namespace {

using namespace test;

TEST(OutputFile, IsKnownNotToBeWhole) {
    const auto lut = markedLattice(17, 17, 17);
    lut->outputShaper.entries.assign(3, ol::RGB(0.5F, 0.5F, 0.5F));
    const TempFolder folder;
    const std::string path = folder.path("out");
    for (const char* const format : {".3dl", ".blut", ".cms", ".csp", ".cub", ".cube", ".vf"}) {
        for (const int flushLines : {0, 1}) {
            SCOPED_TRACE(std::string(format) + " " + std::to_string(flushLines));
            const auto writer = ol::createWriter("", true, format);
            Writing3DL{"flame"}(*writer);
            setProperty<Orlith::Property::Int>(*writer, "flushLines", flushLines);
            writer->write(path, lut);
            writer->write("/dev/full", lut);
            EXPECT_FALSE(writer->wroteAll());
            writer->write(path, lut);
            EXPECT_TRUE(writer->wroteAll());
        }
    }
}

}  // namespace
