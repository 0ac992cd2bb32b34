#include "tests/host/HostFixture.h"
#include "zefra/Row.h"

namespace {

using TestPatternTest = test::HostTest;

/// The colour of pixel (x, y).
std::vector<float> pixel(zefra::Iop& image, int x, int y) {
    zefra::Row row(x, x + 1);
    row.get(image, y, x, x + 1, zefra::kRGB);
    return {*row.pixels(zefra::kRed), *row.pixels(zefra::kGreen), *row.pixels(zefra::kBlue)};
}

TEST_F(TestPatternTest, LaysPatchesFromTheBottomLeftRedFastest) {
    host::Node& node = host_.createNode("CMSTestPattern");
    node.setValue("size", "4");  // 64 patches in 8 rows of 8: no padding
    zefra::Iop& image = *node.image();
    image.validate(true);
    EXPECT_EQ(image.box().width(), 56);
    EXPECT_EQ(image.box().height(), 56);

    using Colour = std::vector<float>;
    EXPECT_EQ(pixel(image, 0, 0), (Colour{0, 0, 0}));
    EXPECT_EQ(pixel(image, 6, 6), (Colour{0, 0, 0}));
    EXPECT_EQ(pixel(image, 7, 0), (Colour{1.0F / 3.0F, 0, 0}));
    EXPECT_EQ(pixel(image, 4 * 7 + 3, 3), (Colour{0, 1.0F / 3.0F, 0}));  // patch 4
    EXPECT_EQ(pixel(image, 3, 7), (Colour{0, 2.0F / 3.0F, 0}));          // patch 8
    EXPECT_EQ(pixel(image, 3, 2 * 7 + 3), (Colour{0, 0, 1.0F / 3.0F}));  // patch 16
    EXPECT_EQ(pixel(image, 55, 55), (Colour{1, 1, 1}));
    EXPECT_EQ(pixel(image, -1, 0), (Colour{0, 0, 0}));
    EXPECT_EQ(pixel(image, 56, 55), (Colour{0, 0, 0}));
}

TEST_F(TestPatternTest, PadsTheTopRowWithBlack) {
    host::Node& node = host_.createNode("CMSTestPattern");
    node.setValue("size", "3");  // 27 patches: 4 rows of 6 and one of 3
    zefra::Iop& image = *node.image();
    image.validate(true);
    EXPECT_EQ(image.box().width(), 42);
    EXPECT_EQ(image.box().height(), 35);
    EXPECT_EQ(pixel(image, 2 * 7 + 3, 31), (std::vector<float>{1, 1, 1}));  // the last colour
    EXPECT_EQ(pixel(image, 3 * 7 + 3, 31), (std::vector<float>{0, 0, 0}));
    EXPECT_EQ(pixel(image, 41, 34), (std::vector<float>{0, 0, 0}));
}

TEST_F(TestPatternTest, HasNoPixelsForASizeOutOfRange) {
    for (const char* const size : {"1", "0", "-5", "130", "2147483647"}) {
        host::Node& node = host_.createNode("CMSTestPattern");
        node.image()->validate(true);
        EXPECT_EQ(node.image()->box().width(), 190 * 7) << "33 points: 190 patches a row";
        node.setValue("size", size);
        EXPECT_EQ(test::failureOf([&] { node.image()->validate(true); }),
                  std::string("CMSTestPattern: size ") + size + " is not within 2 to 129");
        EXPECT_EQ(node.image()->box().width(), 0);
    }
}

}  // namespace
