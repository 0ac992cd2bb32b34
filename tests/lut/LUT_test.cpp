#include "lut/LUT.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <stdexcept>

#include "lut/FloatToInt.h"
#include "tests/support/Tables.h"

namespace {

using namespace test;

/// A kind that defines nothing of its own.
class BareLUT final : public ol::LUT {
public:
    bool is1D() const override { return false; }
    ol::RGB interpolate(const ol::RGB& point, ol::InterpolationMode, bool) const override {
        return point;
    }
};

TEST(LUT, RefusesWhatAKindDoesNotHave) {
    BareLUT bare;
    ol::LUT1D curve;
    ol::LUT3D lattice;
    const ol::LUT& constBare = bare;
    ol::RGB rgb;
    const std::pair<const char*, std::function<void()>> refusals[] = {
        {"width: not available", [&] { bare.width(); }},
        {"height: not available", [&] { curve.height(); }},
        {"depth: not available", [&] { curve.depth(); }},
        {"minmax: not available", [&] { bare.minmax(rgb, rgb); }},
        {"resize: not available", [&] { bare.resize(2); }},
        {"resize: not available", [&] { curve.resize(2, 2, 2); }},
        {"get: not available", [&] { lattice.get(0); }},
        {"get: not available", [&] { constBare.get(0); }},
        {"get: not available", [&] { curve.get(0, 0, 0); }},
        {"get: not available", [&] { constBare.get(0, 0, 0); }},
    };
    for (const auto& [message, action] : refusals)
        EXPECT_EQ(messageOf(action), message);
}

TEST(LUT, ShowsADerivedLatticeEveryResize) {
    class Counting final : public ol::LUT3D {
    public:
        using LUT3D::resize;
        void resize(int width, int height, int depth) override {
            sampleCount += width * height * depth;
        }
        int sampleCount = 0;
    };
    Counting lut;
    lut.resize(3);
    EXPECT_EQ(lut.sampleCount, 27);
}

TEST(LUT, KeepsSamplesInStorageAndAddsZeros) {
    const auto lut = markedLattice(4, 4, 4);
    const float* const before = lut->data();
    lut->resize(4);
    EXPECT_EQ(lut->data(), before);
    lut->resize(3, 5, 7);  // element 63, the last of the old ones, is (0, 1, 4) now
    expectRGB(lut->get(1, 0, 0), markedSample(1, 0, 0));
    expectRGB(lut->get(0, 1, 4), markedSample(3, 3, 3));
    expectRGB(lut->get(1, 1, 4), 0.0F, 0.0F, 0.0F);
    expectRGB(lut->get(2, 4, 6), 0.0F, 0.0F, 0.0F);
    lut->resize(2);
    lut->resize(3);  // what a smaller size dropped is gone
    expectRGB(lut->get(1, 2, 0), markedSample(3, 1, 0));
    expectRGB(lut->get(2, 2, 0), 0.0F, 0.0F, 0.0F);

    const auto curve = markedCurve(3);
    curve->resize(5);
    expectRGB(curve->get(2), markedSample(2, 0, 0));
    expectRGB(curve->get(3), 0.0F, 0.0F, 0.0F);
}

TEST(LUT, RefusesSizesThatCannotBeNumberedAndStaysAsItWas) {
    constexpr int kMost = std::numeric_limits<int>::max();
    const auto lut = markedLattice(2, 3, 4);
    const int sizes[][3] = {{-1, 2, 2},        {2, 2, -1},        {-2, -2, 2},
                            {0, -1, 2},        {2, 0, -1},        {1291, 1291, 1291},
                            {65536, 32768, 1}, {32768, 256, 256}, {kMost, kMost, kMost}};
    for (const auto& [width, height, depth] : sizes) {
        SCOPED_TRACE(std::to_string(width) + " " + std::to_string(height));
        EXPECT_THROW(lut->resize(width, height, depth), std::length_error);
        expectSamplesNear(*lut, *markedLattice(2, 3, 4), 0.0F);
    }
    const auto curve = markedCurve(3);
    EXPECT_THROW(curve->resize(-1), std::length_error);
    expectSamplesNear(*curve, *markedCurve(3), 0.0F);

    lut->resize(0, kMost, kMost);  // nothing to number
    EXPECT_EQ(lut->data(), nullptr);
}

TEST(LUT, ClearsWhatAShrunkTableLeftBehind) {
    // Heap blocks, pages, and from one to the other and back; 87,382 samples are 1 MiB.
    const int counts[][2] = {
        {10, 3}, {200'000, 150'001}, {200'000, 87'383}, {200'000, 10}, {1'000'000, 87'381}};
    for (const auto& [larger, smaller] : counts) {
        SCOPED_TRACE(std::to_string(larger) + " to " + std::to_string(smaller));
        const auto curve = markedCurve(larger);
        curve->resize(smaller);
        curve->resize(larger);
        expectRGB(curve->get(smaller - 1), markedSample(smaller - 1, 0, 0));
        const float* const cleared = curve->data() + 3 * std::ptrdiff_t{smaller};
        const float* const end = curve->data() + 3 * std::ptrdiff_t{larger};
        EXPECT_EQ(std::find_if(cleared, end, [](float value) { return value != 0.0F; }), end);
    }
}

TEST(LUT, TellsItsDomain) {
    ol::RGB min;
    ol::RGB max;
    ol::LUT3D lattice;
    lattice.resize(2, 3, 5);
    ol::setUnitDomain(lattice, 2, 3, 5);
    const float unit[] = {1, 0, 0, 0, 0, 0.5F, 0, 0, 0, 0, 0.25F, 0, 0, 0, 0, 1};
    EXPECT_EQ(lattice.transform, ol::Transform(unit));
    lattice.transform[3][1] = -3.0F;
    lattice.minmax(min, max);
    expectRGB(min, 0.0F, -3.0F, 0.0F);
    expectRGB(max, 1.0F, -2.0F, 1.0F);
    markedCurve(17)->minmax(min, max);
    expectRGB(min, 0.0F, 0.0F, 0.0F);
    expectRGB(max, 16.0F, 16.0F, 16.0F);
}

TEST(FloatToInt, CutsTowardsZeroAndSaturates) {
    constexpr int kMost = std::numeric_limits<int>::max();
    constexpr int kLeast = std::numeric_limits<int>::min();
    constexpr double kInfinity = std::numeric_limits<double>::infinity();
    const std::pair<double, int> rows[] = {{1.99, 1},
                                           {-1.99, -1},
                                           {2147483647.5, kMost},
                                           {kInfinity, kMost},
                                           {-kInfinity, kLeast},
                                           {-2147483648.9, kLeast},
                                           {2147483648.0, kMost},
                                           {-2147483649.0, kLeast},
                                           {std::nan(""), 0}};
    for (const auto& [value, expected] : rows) {
        EXPECT_EQ(ol::toInt32(value), expected) << value;
        EXPECT_EQ(ol::toInt32(static_cast<float>(value)), expected) << value;
    }
}

}  // namespace
