#include "tests/support/Tables.h"

#include <gtest/gtest.h>

#include <boost/smart_ptr/make_shared.hpp>

#include "lut/Exception.h"
#include "lut/io/Registry.h"
#include "tests/support/Files.h"

namespace test {

ol::RGB markedSample(int r, int g, int b, float divisor) {
    const auto place = static_cast<float>(r + 10 * g + 100 * b);
    return {place / divisor, (place + 1000.0F) / divisor, (place + 2000.0F) / divisor};
}

boost::shared_ptr<ol::LUT3D> markedLattice(int width, int height, int depth, float divisor) {
    auto lut = boost::make_shared<ol::LUT3D>();
    lut->resize(width, height, depth);
    for (int b = 0; b < depth; ++b) {
        for (int g = 0; g < height; ++g) {
            for (int r = 0; r < width; ++r)
                lut->get(r, g, b) = markedSample(r, g, b, divisor);
        }
    }
    return lut;
}

boost::shared_ptr<ol::LUT1D> markedCurve(int sampleCount) {
    auto lut = boost::make_shared<ol::LUT1D>();
    lut->resize(sampleCount);
    for (int i = 0; i < sampleCount; ++i)
        lut->get(i) = markedSample(i, 0, 0);
    return lut;
}

void expectRGB(const ol::RGB& actual, float r, float g, float b) {
    EXPECT_EQ(actual[0], r);
    EXPECT_EQ(actual[1], g);
    EXPECT_EQ(actual[2], b);
}

void expectRGB(const ol::RGB& actual, const ol::RGB& expected) {
    expectRGB(actual, expected[0], expected[1], expected[2]);
}

void expectSamplesNear(const ol::LUT& actual, const ol::LUT& expected, float tolerance) {
    ASSERT_EQ(actual.is1D(), expected.is1D());
    ASSERT_EQ(actual.width(), expected.width());
    if (!actual.is1D()) {
        ASSERT_EQ(actual.height(), expected.height());
        ASSERT_EQ(actual.depth(), expected.depth());
    }
    for (std::size_t i = 0; i < expected.dataSize() / sizeof(float); ++i) {
        ASSERT_NEAR(actual.data()[i], expected.data()[i], tolerance) << "float " << i;
    }
}

std::string messageOf(const std::function<void()>& action) {
    try {
        action();
    } catch (const ol::Exception& exception) {
        return exception.message();
    }
    return "(no exception)";
}

boost::shared_ptr<ol::LUT> readBytes(const std::string& extension, std::string_view bytes,
                                     const Reading3DL& reading) {
    const TempFolder folder;
    const auto reader = ol::createReader("", true, extension);
    reading(*reader);
    return reader->read(folder.write("table", bytes));
}

}  // namespace test
