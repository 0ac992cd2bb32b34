// What readers have in common. What they make of single lines is in ReaderRows_test.cpp.

#include <gtest/gtest.h>

#include <cstdint>
#include <filesystem>
#include <stdexcept>

#include "lut/Exception.h"
#include "lut/io/Registry.h"
#include "tests/support/Files.h"
#include "tests/support/Tables.h"

namespace {

using namespace test;

TEST(EveryReader, PutsEachSampleAtItsPlaceInADomainOfZeroToOne) {
    const struct {
        const char* file;  // under tests/data
        int width, height, depth;
        float divisor;
    } kLattices[] = {
        {"3dl/flame.3dl", 2, 2, 2, 4095.0F},      {"cms/lattice.cms", 2, 2, 2, 10000.0F},
        {"csp/lattice.csp", 2, 3, 4, 10000.0F},   {"cub/lattice.cub", 2, 3, 4, 10000.0F},
        {"cube/lattice.cube", 2, 2, 2, 10000.0F}, {"vf/lattice.vf", 2, 3, 4, 10000.0F},
    };
    for (const auto& [file, width, height, depth, divisor] : kLattices) {
        SCOPED_TRACE(file);
        const auto expected = markedLattice(width, height, depth, divisor);
        ol::setUnitDomain(*expected, width, height, depth);
        const std::string extension = std::filesystem::path(file).extension();
        const auto lut = readBytes(extension, readFile(dataPath(file)));
        expectSamplesNear(*lut, *expected, 0.0F);
        if (extension != ".vf") {  // which says itself where it lies
            EXPECT_EQ(lut->transform, expected->transform);
        }
    }
}

/// Expects a table, an Exception or the standard library's length error.
void expectSafe(ol::LUTFileReader& reader, const std::string& file) {
    try {
        EXPECT_TRUE(reader.read(file));
    } catch (const ol::Exception& exception) {
        EXPECT_STRNE(exception.message(), "");
    } catch (const std::length_error&) {
    }
}

// Under the address sanitizer, without reading or writing outside an array.
TEST(EveryFormat, SurvivesEveryTruncationOfItsSamples) {
    const TempFolder folder;
    testing::internal::CaptureStderr();
    int fileCount = 0;
    for (const auto& entry : std::filesystem::recursive_directory_iterator(dataPath(""))) {
        const std::string extension = entry.path().extension().string();
        if (!entry.is_regular_file() || extension == ".md" || extension == ".txt") continue;
        SCOPED_TRACE(entry.path());
        ++fileCount;
        const auto byFile = ol::createReader("", true, extension);
        const auto asLustre = ol::createReader("", true, extension);
        Reading3DL()(*byFile);
        Reading3DL{"lustre", -1, 1}(*asLustre);
        const std::string file = folder.write("cut", readFile(entry.path().string()));
        for (std::uintmax_t byteCount = entry.file_size(); byteCount-- > 0;) {
            std::filesystem::resize_file(file, byteCount);
            expectSafe(*byFile, file);
            expectSafe(*asLustre, file);
        }
    }
    testing::internal::GetCapturedStderr();
    EXPECT_GE(fileCount, 20);
}

}  // namespace
