#include "lut/io/LUTFileWriterBLUT.h"

#include <gtest/gtest.h>

#include <boost/smart_ptr/make_shared.hpp>
#include <cstring>
#include <limits>

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

std::string written(const boost::shared_ptr<ol::LUT>& lut) {
    const TempFolder folder;
    const std::string path = folder.write("out.blut", std::string(10000, 'x'));
    ol::LUTFileWriterBLUT().write(path, lut);
    return readFile(path);
}

TEST(BLUTWriter, WritesHeaderAndBigEndianFloats) {
    const auto lut = boost::make_shared<ol::LUT3D>();
    lut->resize(1);
    lut->get(0, 0, 0) = ol::RGB(0.5F, 1.0F, -2.0F);
    EXPECT_EQ(written(lut),
              "HLUT\x00\x00\x00\x02\x00\x00\x00\x05\x00\x00\x00\x40"
              "\x00\x00\x00\x00\x3F\x80\x00\x00\x00\x00\x00\x00\x3F\x80\x00\x00"
              "\x00\x00\x00\x00\x3F\x80\x00\x00\x00\x00\x00\x01"
              "f\x3F\x00\x00\x00\x3F\x80\x00\x00\xC0\x00\x00\x00"s);
}

TEST(BLUTWriter, ReadsBackBitForBit) {
    const auto lut = markedLattice(33, 33, 33);
    lut->get(1, 2, 3) = ol::RGB(-0.0F, std::numeric_limits<float>::quiet_NaN(), 1e-40F);
    const auto back = readBytes(".blut", written(lut));
    ASSERT_EQ(back->dataSize(), lut->dataSize());
    EXPECT_EQ(std::memcmp(back->data(), lut->data(), lut->dataSize()), 0);
}

TEST(BLUTWriter, WritesTheWidthModulo256) {
    const int cases[][2] = {{0, 0}, {127, 127}, {255, 255}, {256, 0}, {258, 2}, {70000, 0x70}};
    for (const auto& [width, byte] : cases) {
        const std::string bytes = written(boost::make_shared<WidthOnly>(width));
        EXPECT_EQ(bytes.substr(40), "\x00\x00\x00"s + static_cast<char>(byte) + 'f') << width;
    }
}

}  // namespace
