#include "tests/host/HostFixture.h"
#include "zefra/Row.h"

namespace {

using TestPatternTest = test::HostTest;

using Colour = std::vector<float>;

/// The colour of pixel (x, y).
Colour pixel(zefra::Iop& image, int x, int y) {
    zefra::Row row(x, x + 1);
    row.get(image, y, x, x + 1, zefra::kRGB);
    return {*row.pixels(zefra::kRed), *row.pixels(zefra::kGreen), *row.pixels(zefra::kBlue)};
}

TEST_F(TestPatternTest, LaysPatchesFromTheBottomLeftRedFastestAndPadsWithBlack) {
    constexpr float kThird = 1.0F / 3.0F;
    const struct {
        int size, width, height;  // 64 patches in 8 rows of 8; 27 in 4 rows of 6 and one of 3
        int x, y;
        Colour colour;
    } kPixels[] = {
        {4, 56, 56, 6, 6, {0, 0, 0}},
        {4, 56, 56, 7, 0, {kThird, 0, 0}},
        {4, 56, 56, 4 * 7 + 3, 3, {0, kThird, 0}},
        {4, 56, 56, 3, 7, {0, 2.0F / 3.0F, 0}},
        {4, 56, 56, 3, 2 * 7 + 3, {0, 0, kThird}},
        {4, 56, 56, 55, 55, {1, 1, 1}},
        {4, 56, 56, -1, 0, {0, 0, 0}},
        {4, 56, 56, 56, 55, {0, 0, 0}},
        {8, 161, 161, 3 * 7 + 3, 3, {3.0F / 7.0F, 0, 0}},  // not three times 1/7
        {3, 42, 35, 2 * 7 + 3, 31, {1, 1, 1}},
        {3, 42, 35, 3 * 7 + 3, 31, {0, 0, 0}},
        {3, 42, 35, 41, 34, {0, 0, 0}},
    };
    host::Node& node = host_.createNode("CMSTestPattern");
    zefra::Iop& image = *node.image();
    for (const auto& each : kPixels) {
        node.setValue("size", std::to_string(each.size));
        image.validate(true);
        EXPECT_EQ(image.box().width(), each.width);
        EXPECT_EQ(image.box().height(), each.height);
        EXPECT_EQ(pixel(image, each.x, each.y), each.colour) << each.x << ", " << each.y;
    }
}

TEST_F(TestPatternTest, HasNoPixelsForASizeOutOfRange) {
    host::Node& node = host_.createNode("CMSTestPattern");
    node.image()->validate(true);
    EXPECT_EQ(node.image()->box().width(), 190 * 7) << "33 points: 190 patches a row";
    for (const char* const size : {"1", "-5", "130", "2147483647"}) {
        node.setValue("size", size);
        EXPECT_EQ(test::failureOf([&] { node.image()->validate(true); }),
                  std::string("CMSTestPattern: size ") + size + " is not within 2 to 129");
        EXPECT_EQ(node.image()->box().width(), 0);
    }
}

}  // namespace
