#include "lut/RampFill.h"

#include <gtest/gtest.h>

#include <cmath>

#include "tests/support/Tables.h"

namespace {

using namespace test;

void expectRamp(const std::vector<ol::RGB>& entries, const std::vector<float>& expected) {
    ASSERT_EQ(entries.size(), expected.size());
    for (std::size_t i = 0; i < expected.size(); ++i)
        expectRGB(entries[i], expected[i], expected[i], expected[i]);
}

TEST(RampFill, RunsFromZeroToTheMaximum) {
    std::vector<ol::RGB> entries(9, ol::RGB(7.0F, 7.0F, 7.0F));
    ol::fillLinearRamp(entries, 5, 1023);
    expectRamp(entries, {0.0F, 255.75F, 511.5F, 767.25F, 1023.0F});
    ol::fillSmoothRamp(entries, 3, 1);
    expectRamp(entries, {0.0F, 0.5F, 1.0F});
}

TEST(RampFill, RoundsTheSmoothCurveInItsPrescribedForm) {
    // Worked out in single precision step by step; t * t * (3 - 2 t) differs in the last place of
    // entries 1, 3 and 6.
    std::vector<ol::RGB> entries;
    ol::fillSmoothRamp(entries, 8, 1);
    expectRamp(entries, {0.0F, 0x1.c5c8c8p-5F, 0x1.96047cp-3F, 0x1.930834p-2F, 0x1.367be6p-1F,
                         0x1.9a7eep-1F, 0x1.e3a37p-1F, 1.0F});
    ol::fillSmoothRamp(entries, 8, 1023);
    EXPECT_EQ(entries[1][0], 0x1.c55756p+5F);
}

TEST(RampFill, HasNoEntriesBelowOneAndNoNumberInASingleOne) {
    std::vector<ol::RGB> entries(3);
    ol::fillLinearRamp(entries, 0, 1);
    expectRamp(entries, {});
    ol::fillSmoothRamp(entries, 1, 1);
    ASSERT_EQ(entries.size(), 1U);
    EXPECT_TRUE(std::isnan(entries[0][2]));
    ol::fillLinearRamp(entries, -5, 1);
    expectRamp(entries, {});
}

}  // namespace
