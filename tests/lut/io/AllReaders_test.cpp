// What readers have in common. What they make of single lines is in ReaderRows_test.cpp.

#include <gtest/gtest.h>
#include <sys/resource.h>

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

/// Most memory that this process has had resident so far.
std::int64_t peakMebibytes() {
    rusage usage{};
    getrusage(RUSAGE_SELF, &usage);
#ifdef __APPLE__
    return usage.ru_maxrss >> 20;  // given in bytes
#else
    return usage.ru_maxrss >> 10;
#endif
}

// Each table would be 1.4 GiB, if the samples that the file does not hold were touched.
TEST(EveryFormat, CostsNoMemoryForWhatAFileOnlyClaims) {
    std::string grid;
    for (int i = 0; i < 500; ++i)
        grid += std::to_string(i * 65535 / 499) + " ";
    const std::string cub = "# width 500 500 500\n1 1 1\n# width 500 500 499\n1 1 1\n";
    const std::string csp = "CSPLUTV100\n3D\n1\n0\n0\n1\n0\n0\n1\n0\n0\n";
    const std::string vf = "#Inventor V2.1 ascii\n\nparameters\n";
    const struct {
        const char* extension;
        std::string text;
        bool isTable;
    } kFiles[] = {
        {".3dl", grid + "\n1 2 3\n", true},  // of 4 bits, which is known at the end
        {".cms", "LUT_3D_SIZE 500\n", true},
        {".csp", csp + "500 500 500\n0 0 0\n", false},
        {".csp", csp + "2147483647 0 2147483647\n", true},
        {".cub", cub + cub + cub + cub, true},
        {".cube", "LUT_3D_SIZE 500\n1 1 1\n", true},
        {".vf", vf + "grid_size 500 500 500\ngrid_size 500 500 499\ndata\n", false},
        {".vf", vf + "grid_size 0 2147483647 2147483647\n", true},
    };
    const std::int64_t before = peakMebibytes();
    for (const auto& each : kFiles) {
        const std::string message = messageOf([&] { readBytes(each.extension, each.text); });
        EXPECT_EQ(message == "(no exception)", each.isTable) << message;
        EXPECT_LT(peakMebibytes() - before, 64) << each.extension;
    }
}

}  // namespace
