#include "lut/io/LUTFileReaderBLUT.h"

#include <gtest/gtest.h>

#include <cmath>
#include <cstring>
#include <limits>
#include <stdexcept>

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

std::uint32_t bitsOf(float value) {
    std::uint32_t bits = 0;
    std::memcpy(&bits, &value, sizeof(bits));
    return bits;
}

TEST(BLUTReader, ReadsALatticeRedFastest) {
    const auto lut = readBytes(".blut", readFile(dataPath("blut/lattice.blut")));
    ASSERT_FALSE(lut->is1D());
    ASSERT_EQ(lut->width(), 2);
    ASSERT_EQ(lut->height(), 2);
    ASSERT_EQ(lut->depth(), 2);
    for (int b = 0; b < 2; ++b) {
        for (int g = 0; g < 2; ++g) {
            for (int r = 0; r < 2; ++r)
                expectRGB(lut->get(r, g, b), float(r), float(g), float(b) + 0.25F);
        }
    }
}

TEST(BLUTReader, ReadsACurveOfHalvesAndNothingBehindIt) {
    const std::string bytes = readFile(dataPath("blut/curve-halves.blut"));
    ASSERT_EQ(bytes.size(), 75U);
    const auto lut = readBytes(".blut", bytes + "tail");
    ASSERT_TRUE(lut->is1D());
    ASSERT_EQ(lut->width(), 5);
    for (int i = 0; i < 5; ++i) {
        const float place = static_cast<float>(i) / 4.0F;
        expectRGB(lut->get(i), place, place + 1.0F, -place);
    }
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

TEST(BLUTReader, KeepsEveryBitOfAFloat) {
    const auto lut = readBytes(".blut", header(1, 2, 'f') +
                                            "\x80\x00\x00\x00\x00\x00\x00\x01\x7F\x80\x00\x01"
                                            "\xFF\x80\x00\x00\x3F\x80\x00\x00\x01\x02\x03\x04"s);
    const std::uint32_t expected[] = {0x80000000, 0x00000001, 0x7F800001,
                                      0xFF800000, 0x3F800000, 0x01020304};
    for (std::size_t i = 0; i < 6; ++i)
        EXPECT_EQ(bitsOf(lut->data()[i]), expected[i]) << i;
}

TEST(BLUTReader, TakesTheSizeForASignedByte) {
    const TempFolder folder;
    ol::LUTFileReaderBLUT reader;
    for (int size = 0; size < 256; ++size) {
        SCOPED_TRACE(size);
        const std::string curve = folder.write("curve", header(1, size, 'f'));
        const std::string lattice = folder.write("lattice", header(2, size, 'h'));
        if (size > 127) {
            EXPECT_THROW(reader.read(curve), std::length_error);
            EXPECT_THROW(reader.read(lattice), std::length_error);
            continue;
        }
        EXPECT_EQ(reader.read(curve)->width(), size);
        const auto lut = reader.read(lattice);
        EXPECT_EQ(lut->depth(), size);
        EXPECT_EQ(lut->dataSize(), 12U * unsigned(size * size * size));
        EXPECT_EQ(reader.sampleCount(), 0U);
    }
}

TEST(BLUTReader, CoversZeroToOneWhateverTheHeaderSays) {
    const float infinity = std::numeric_limits<float>::infinity();
    const struct {
        int size;
        float scale;
    } cases[] = {{0, -1.0F}, {1, infinity}, {2, 1.0F}, {4, 1.0F / 3.0F}, {127, 1.0F / 126.0F}};
    for (const auto& [size, scale] : cases) {
        for (const char kind : {char{1}, char{2}}) {
            const auto lut = readBytes(".blut", header(kind, size, 'f'));
            ol::Transform expected(0.0F);
            expected[0][0] = expected[1][1] = expected[2][2] = scale;
            expected[3][3] = 1.0F;
            EXPECT_EQ(lut->transform, expected) << size;
        }
    }
}

TEST(BLUTReader, LooksOnlyAtMagicKindSizeAndType) {
    const std::string good = readFile(dataPath("blut/lattice.blut"));
    for (std::size_t offset = 0; offset < 45; ++offset) {
        SCOPED_TRACE(offset);
        std::string changed = good;
        changed[offset] = 1;
        if (offset < 4) {
            EXPECT_EQ(messageOf([&] { readBytes(".blut", changed); }), kMagicError);
            continue;
        }
        const auto lut = readBytes(".blut", changed);
        EXPECT_EQ(lut->is1D(), offset == 7);
        EXPECT_EQ(lut->width(), offset == 43 ? 1 : 2);
        if (offset < 43 && offset != 7) expectRGB(lut->get(1, 0, 1), 1.0F, 0.0F, 1.25F);
    }
}

TEST(BLUTReader, CompletesAShortFileWithZeros) {
    const TempFolder folder;
    ol::LUTFileReaderBLUT reader;
    const std::string whole = readFile(dataPath("blut/lattice.blut"));
    // Two samples, the red of the third, and three of the four bytes of its green, which is 1.
    const auto lut = reader.read(folder.write("cut", whole.substr(0, 45 + 24 + 4 + 3)));
    EXPECT_EQ(reader.sampleCount(), 2U);
    expectRGB(lut->get(1, 0, 0), 1.0F, 0.0F, 0.25F);
    for (std::size_t i = 6; i < 24; ++i)
        EXPECT_EQ(lut->data()[i], 0.0F) << i;
    const auto halfSample = reader.read(folder.write("cut", whole.substr(0, 45 + 12 + 8)));
    EXPECT_EQ(reader.sampleCount(), 1U);
    expectRGB(halfSample->get(1, 0, 0), 1.0F, 0.0F, 0.0F);

    EXPECT_EQ(reader.read(folder.write("magic", "HLUT"))->width(), 0);
    EXPECT_EQ(messageOf([&] { reader.read(folder.write("magic", "HLU")); }), kMagicError);
    EXPECT_EQ(messageOf([&] { reader.read(folder.write("magic", "")); }), kMagicError);
    EXPECT_EQ(messageOf([&] { reader.read("/no/such.blut"); }),
              "BLUT LUT reader: unable to open file.");
    EXPECT_EQ(reader.sampleCount(), 0U);
    EXPECT_EQ(reader.lineNumber(), 0U);
}

TEST(BLUTReader, SurvivesEveryTruncation) {
    expectTruncationsAreSafe(".blut", readFile(dataPath("blut/lattice.blut")));
    expectTruncationsAreSafe(".blut", readFile(dataPath("blut/curve-halves.blut")));
}

}  // namespace
