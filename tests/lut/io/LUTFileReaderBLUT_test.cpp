#include "lut/io/LUTFileReaderBLUT.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <stdexcept>

#include "tests/support/Bits.h"
#include "tests/support/Files.h"
#include "tests/support/Tables.h"

namespace {

using namespace test;
using namespace std::string_literals;

constexpr char kMagicError[] =
    "BLUT LUT reader: unsupported header magic number, expected \"HLUT\".";

/// What the reader looks at: magic, kind, size and type; the rest is noise.
std::string header(char kind, int size, char type) {
    return "HLUT\x7F\x7F\x7F"s + kind + std::string(35, '\x7F') + static_cast<char>(size) + type;
}

TEST(BLUTReader, ReadsALatticeRedFastestAndACurveOfHalves) {
    const auto lattice = readBytes(".blut", readFile(dataPath("blut/lattice.blut")));
    ASSERT_EQ(lattice->depth(), 2);
    expectRGB(lattice->get(1, 0, 0), 1.0F, 0.0F, 0.25F);
    expectRGB(lattice->get(0, 1, 0), 0.0F, 1.0F, 0.25F);
    expectRGB(lattice->get(0, 0, 1), 0.0F, 0.0F, 1.25F);
    // What follows the last sample is not read.
    const auto curve = readBytes(".blut", readFile(dataPath("blut/curve-halves.blut")) + "tail");
    ASSERT_TRUE(curve->is1D());
    ASSERT_EQ(curve->width(), 5);
    expectRGB(curve->get(3), 0.75F, 1.75F, -0.75F);
}

TEST(BLUTReader, ConvertsEveryHalf) {
    // 28^3 samples have room for the 65 536 halves.
    std::string bytes = header(2, 28, 'h');
    for (unsigned half = 0; half < 65536; ++half) {
        bytes += static_cast<char>(half >> 8);
        bytes += static_cast<char>(half & 0xFF);
    }
    const auto lut = readBytes(".blut", bytes);
    for (unsigned half = 0; half < 65536; ++half) {
        const std::uint32_t sign = half & 0x8000U ? 0x80000000U : 0U;
        const int exponent = static_cast<int>(half >> 10 & 0x1F);
        const unsigned fraction = half & 0x3FFU;
        // Eleven bits fit a float; infinities and NaNs keep sign and fraction.
        const double magnitude = exponent == 0 ? std::ldexp(fraction, -24)
                                               : std::ldexp(fraction + 1024.0, exponent - 25);
        const std::uint32_t expected =
            sign |
            (exponent == 31 ? 0x7F800000U | fraction << 13 : bitsOf(static_cast<float>(magnitude)));
        ASSERT_EQ(bitsOf(lut->data()[half]), expected) << "half " << half;
    }
}

TEST(BLUTReader, TakesTheSizeForASignedByte) {
    const TempFolder folder;
    ol::LUTFileReaderBLUT reader;
    for (int size = 0; size < 256; ++size) {
        SCOPED_TRACE(size);
        const std::string lattice = folder.write("lattice", header(2, size, 'h'));
        if (size > 127) {
            EXPECT_THROW(reader.read(lattice), std::length_error);
            continue;
        }
        const auto lut = reader.read(lattice);
        EXPECT_EQ(lut->transform[2][2], 1.0F / static_cast<float>(size - 1));  // of 0 to 1
        EXPECT_EQ(lut->depth(), size);
        EXPECT_EQ(lut->dataSize(), 12U * unsigned(size * size * size));
        EXPECT_EQ(reader.sampleCount(), 0U);
    }
}

TEST(BLUTReader, CompletesAShortFileWithZeros) {
    const TempFolder folder;
    ol::LUTFileReaderBLUT reader;
    const std::string whole = readFile(dataPath("blut/lattice.blut"));
    const auto good = reader.read(dataPath("blut/lattice.blut"));
    EXPECT_EQ(reader.sampleCount(), 8U);
    for (std::size_t byteCount = 45; byteCount < whole.size(); ++byteCount) {
        const auto lut = reader.read(folder.write("cut", whole.substr(0, byteCount)));
        const std::size_t held = (byteCount - 45) / 4;  // whole floats
        EXPECT_EQ(reader.sampleCount(), held / 3);
        for (std::size_t i = 0; i < 24; ++i)
            EXPECT_EQ(lut->data()[i], i < held ? good->data()[i] : 0.0F) << byteCount;
    }
    EXPECT_EQ(reader.read(folder.write("magic", "HLUT"))->width(), 0);
    for (const char* const bytes : {"HLU", "", "xLUT", "HxUT", "HLxT", "HLUx"})
        EXPECT_EQ(messageOf([&] { reader.read(folder.write("magic", bytes)); }), kMagicError);
    EXPECT_EQ(reader.sampleCount(), 0U);
}

}  // namespace
