#include "lut/io/LUTFileWriterBLUT.h"

#include <gtest/gtest.h>

#include <boost/smart_ptr/make_shared.hpp>
#include <cstring>
#include <filesystem>
#include <limits>

#include "lut/io/LUTFileReaderBLUT.h"
#include "tests/support/Files.h"
#include "tests/support/Tables.h"

namespace {

using namespace test;
using namespace std::string_literals;

/// A table that is all width: no lattice of that many points a side has to be written to see it.
class WidthOnly final : public ol::LUT {
public:
    explicit WidthOnly(int width) : width_(width) {}
    int width() const override { return width_; }
    int height() const override { return 0; }
    int depth() const override { return 0; }
    bool is1D() const override { return true; }
    ol::RGB interpolate(const ol::RGB& point, ol::InterpolationMode, bool) const override {
        return point;
    }

private:
    int width_;
};

TEST(BLUTWriter, WritesHeaderAndBigEndianFloats) {
    const TempFolder folder;
    const auto lut = boost::make_shared<ol::LUT3D>();
    lut->resize(2);
    const float values[] = {0.0F, 0.5F, 1.0F, -2.0F};
    for (std::size_t i = 0; i < 24; ++i)
        lut->data()[i] = values[i % 4];
    ol::LUTFileWriterBLUT().write(folder.path("out.blut"), lut);
    const std::string header =
        "HLUT\x00\x00\x00\x02\x00\x00\x00\x05\x00\x00\x00\x40"
        "\x00\x00\x00\x00\x3F\x80\x00\x00\x00\x00\x00\x00\x3F\x80\x00\x00\x00\x00\x00\x00\x3F\x80"
        "\x00\x00\x00\x00\x00\x02"
        "f"s;
    const std::string fourValues =
        "\x00\x00\x00\x00\x3F\x00\x00\x00\x3F\x80\x00\x00\xC0\x00\x00\x00"s;
    EXPECT_EQ(readFile(folder.path("out.blut")),
              header + fourValues + fourValues + fourValues + fourValues + fourValues + fourValues);
}

TEST(BLUTWriter, ReadsBackBitForBit) {
    const TempFolder folder;
    const std::string file = folder.write("out.blut", std::string(500000, 'x'));
    const auto lut = markedLattice(33, 33, 33);
    lut->get(1, 2, 3) = ol::RGB(-0.0F, std::numeric_limits<float>::quiet_NaN(), 1e-40F);
    ol::LUTFileWriterBLUT().write(file, lut);
    EXPECT_EQ(std::filesystem::file_size(file), 431289U);
    ol::LUTFileReaderBLUT reader;
    const auto back = reader.read(file);
    EXPECT_EQ(reader.sampleCount(), 35937U);
    ASSERT_EQ(back->dataSize(), lut->dataSize());
    EXPECT_EQ(std::memcmp(back->data(), lut->data(), lut->dataSize()), 0);
}

TEST(BLUTWriter, WritesTheWidthModulo256) {
    const TempFolder folder;
    const int cases[][2] = {{0, 0}, {127, 127}, {255, 255}, {256, 0}, {258, 2}, {70000, 0x70}};
    for (const auto& [width, byte] : cases) {
        ol::LUTFileWriterBLUT().write(folder.path("out.blut"),
                                      boost::make_shared<WidthOnly>(width));
        const std::string bytes = readFile(folder.path("out.blut"));
        ASSERT_EQ(bytes.size(), 45U);
        EXPECT_EQ(bytes.substr(40), "\x00\x00\x00"s + static_cast<char>(byte) + 'f') << width;
    }
}

TEST(BLUTWriter, RefusesBeforeAFileIsMade) {
    const TempFolder folder;
    ol::LUTFileWriterBLUT writer;
    const int sizes[][3] = {{2, 2, 3}, {2, 3, 2}, {3, 2, 2}};
    for (const auto& [width, height, depth] : sizes) {
        EXPECT_EQ(messageOf([&, w = width, h = height, d = depth] {
                      writer.write(folder.path("no.blut"), markedLattice(w, h, d));
                  }),
                  "unable to write: must have the same dimension in r, g and b");
    }
    EXPECT_EQ(messageOf([&] { writer.write(folder.path("no.blut"), markedCurve(2)); }),
              "height: not available");
    EXPECT_FALSE(std::filesystem::exists(folder.path("no.blut")));
    EXPECT_EQ(messageOf([&] { writer.write(folder.path("no/no.blut"), markedLattice(2, 2, 2)); }),
              "unable to open file for writing");
}

}  // namespace
