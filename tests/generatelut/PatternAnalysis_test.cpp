#include "generatelut/PatternAnalysis.h"

#include <gtest/gtest.h>

#include <cmath>
#include <string>
#include <vector>

namespace {

using generatelut::PatternSize;

constexpr float kOutside = -1.0F;  // a pixel that nobody should look at

/// An image in memory that tells what was asked of it. Every pixel holds kOutside, except the
/// centres of patches: patch i holds (i, i + 0.25, i + 0.5).
class MemoryFrame final : public generatelut::Frame {
public:
    MemoryFrame(int width, int height)
        : width_(width),
          pixels_(3 * static_cast<std::size_t>(width) * static_cast<std::size_t>(height),
                  kOutside) {
        float index = 0.0F;
        for (int y = 3; y + 4 <= height; y += 7) {
            for (int x = 3; x + 4 <= width; x += 7, ++index) {
                for (int c = 0; c < 3; ++c)
                    *pixel(c, x, y) = index + 0.25F * static_cast<float>(c);
            }
        }
    }

    void withRow(int y, int width, const UseRow& use) override {
        rows.push_back(y);
        EXPECT_LE(width, width_);
        use(pixel(0, 0, y), pixel(1, 0, y), pixel(2, 0, y));
    }
    void progressMessage(const char* text) override { messages.emplace_back(text); }
    void progressFraction(double fraction) override { fractions.push_back(fraction); }
    bool aborted() override { return static_cast<int>(rows.size()) >= abortAtRow; }

    int abortAtRow = 1 << 20;
    std::vector<int> rows;
    std::vector<std::string> messages;
    std::vector<double> fractions;

private:
    float* pixel(int channel, int x, int y) {
        const std::size_t plane = pixels_.size() / 3;
        return pixels_.data() + static_cast<std::size_t>(channel) * plane +
               static_cast<std::size_t>(y) * static_cast<std::size_t>(width_) +
               static_cast<std::size_t>(x);
    }

    int width_;
    std::vector<float> pixels_;
};

boost::shared_ptr<Orlith::LUT::LUT3D> analyse(MemoryFrame& frame, int width, int height) {
    return generatelut::analyseFrame(PatternSize::ofImage(width, height), {2, true}, frame);
}

TEST(PatternSize, FollowsFromTheSizeOfTheImage) {
    const struct {
        int width, height, points, entries, rows, columns;
    } kCases[] = {
        {1274, 1267, 32, 32768, 181, 182},
        {1280, 1273, 32, 32768, 181, 182},  // a remainder is no patch
        {71 * 7, 70 * 7, 17, 4913, 70, 71},
        {525 * 7, 524 * 7, 65, 274625, 524, 525},
        {1466 * 7, 1465 * 7, 129, 2146689, 1465, 1466},
        {182 * 7, 7, 32, 32768, 1, 182},  // only the width decides
        {183 * 7, 181 * 7, 33, 35937, 181, 183},
        {180 * 7, 181 * 7, 32, 32768, 181, 180},
        {173 * 7, 173 * 7, 31, 29791, 173, 173},
        {21, 21, 2, 8, 3, 3},
        {14, 14, 2, 8, 2, 2},
        {7, 7, 1, 1, 1, 1},
        {6, 700, 0, 0, 100, 0},
        {0, 0, 0, 0, 0, 0},
    };
    for (const auto& each : kCases) {
        SCOPED_TRACE(std::to_string(each.width) + " x " + std::to_string(each.height));
        const PatternSize size = PatternSize::ofImage(each.width, each.height);
        EXPECT_EQ(size.lutSizeR, each.points);
        EXPECT_EQ(size.lutSizeG, each.points);
        EXPECT_EQ(size.lutSizeB, each.points);
        EXPECT_EQ(size.lutEntryCount, each.entries);
        EXPECT_EQ(size.patchRows, each.rows);
        EXPECT_EQ(size.patchColumns, each.columns);
        EXPECT_EQ(size.pixelWidth(), each.columns * 7);
        EXPECT_EQ(size.pixelHeight(), each.rows * 7);
    }
    const PatternSize unseen;
    EXPECT_EQ(unseen.lutSizeB, 32);
    EXPECT_EQ(unseen.lutEntryCount, 32768);
    EXPECT_EQ(unseen.patchRows, 181);
    EXPECT_EQ(unseen.patchColumns, 182);
}

TEST(PatternSize, RecoversEveryCubeFromTheWidthOfItsPattern) {
    for (int points = 2; points <= 200; ++points) {
        int columns = 0;  // the least width whose square holds all patches
        while (columns * columns < points * points * points)
            ++columns;
        EXPECT_EQ(PatternSize::ofImage(7 * columns, 7).lutSizeR, points) << columns << " columns";
    }
}

TEST(PatternSize, TurnsAnIndexIntoItsPlaceAndColour) {
    const PatternSize size = PatternSize::ofImage(12 * 7, 11 * 7);  // 5 points
    int place[3];
    float colour[3];
    ASSERT_TRUE(size.indexToLattice(4 + 5 * 1 + 25 * 3, place));
    EXPECT_EQ(std::vector<int>(place, place + 3), (std::vector<int>{4, 1, 3}));
    ASSERT_TRUE(size.indexToColour(4 + 5 * 1 + 25 * 3, colour));
    EXPECT_EQ(std::vector<float>(colour, colour + 3), (std::vector<float>{1.0F, 0.25F, 0.75F}));
    for (const int index : {-1, 125, 1 << 30}) {
        place[0] = place[1] = place[2] = 9;
        EXPECT_FALSE(size.indexToLattice(index, place));
        EXPECT_EQ(std::vector<int>(place, place + 3), (std::vector<int>{0, 0, 0}));
        colour[0] = colour[1] = colour[2] = 9.0F;
        EXPECT_FALSE(size.indexToColour(index, colour));
        EXPECT_EQ(std::vector<float>(colour, colour + 3), (std::vector<float>{0, 0, 0}));
    }
    EXPECT_TRUE(PatternSize::ofImage(7, 7).indexToColour(0, colour));
    EXPECT_TRUE(std::isnan(colour[0])) << "a cube of one point has no extent";
}

TEST(PatternSampling, ReadsTheCentreOfEachPatchRedFastest) {
    // 12 x 11 patches for 125 points, and a remainder of pixels to the right and above.
    MemoryFrame frame(12 * 7 + 5, 11 * 7 + 6);
    const auto lut = analyse(frame, 12 * 7 + 5, 11 * 7 + 6);
    ASSERT_TRUE(lut);
    ASSERT_EQ(lut->dataSize(), 125 * 12U);
    for (int b = 0; b < 5; ++b) {
        for (int g = 0; g < 5; ++g) {
            for (int r = 0; r < 5; ++r) {
                const auto index = static_cast<float>(r + 5 * g + 25 * b);
                EXPECT_EQ(lut->get(r, g, b)[0], index);
                EXPECT_EQ(lut->get(r, g, b)[1], index + 0.25F);
                EXPECT_EQ(lut->get(r, g, b)[2], index + 0.5F);
            }
        }
    }
    EXPECT_EQ(frame.rows, (std::vector<int>{3, 10, 17, 24, 31, 38, 45, 52, 59, 66, 73}));
    EXPECT_EQ(frame.messages, std::vector<std::string>{"Analyzing frame"});
    ASSERT_EQ(frame.fractions.size(), 11U);
    EXPECT_EQ(frame.fractions[0], 3.0 / 77.0);
    EXPECT_EQ(frame.fractions[10], 73.0 / 77.0);
}

TEST(PatternSampling, LeavesZerosWhereRowsAreMissing) {
    MemoryFrame frame(12 * 7, 2 * 7);
    const auto lut = analyse(frame, 12 * 7, 2 * 7);
    ASSERT_TRUE(lut);
    EXPECT_EQ(frame.rows.size(), 2U);
    EXPECT_EQ(lut->data()[3 * 23 + 2], 23.5F);
    for (int i = 3 * 24; i < 3 * 125; ++i)
        EXPECT_EQ(lut->data()[i], 0.0F) << "float " << i;
}

TEST(PatternSampling, TakesImagesThatAreTooSmallForAnySample) {
    const struct {
        int width, height, points;
        std::size_t rows;
    } kCases[] = {{84, 6, 5, 0}, {6, 84, 0, 12}, {3, 3, 0, 0}};
    for (const auto& each : kCases) {
        MemoryFrame frame(each.width, each.height);
        const auto lut = analyse(frame, each.width, each.height);
        ASSERT_TRUE(lut);
        EXPECT_EQ(lut->width(), each.points);
        EXPECT_EQ(frame.rows.size(), each.rows);
        EXPECT_EQ(frame.messages.size(), 1U);
        EXPECT_EQ(lut->outputShaper.entries.size(), 2U);
        for (std::size_t i = 0; i < lut->dataSize() / sizeof(float); ++i)
            EXPECT_EQ(lut->data()[i], 0.0F);
    }
}

TEST(PatternSampling, StopsWhenCancelled) {
    for (const int row : {1, 4}) {
        MemoryFrame frame(84, 77);
        frame.abortAtRow = row;
        EXPECT_FALSE(analyse(frame, 84, 77));
        EXPECT_EQ(frame.rows.size(), static_cast<std::size_t>(row));
    }
}

TEST(PreLUT, IsARampOfItsStyle) {
    const auto ramp = [](int entryCount, bool isLinear) {
        MemoryFrame frame(21, 21);
        return generatelut::analyseFrame(PatternSize::ofImage(21, 21), {entryCount, isLinear},
                                         frame)
            ->outputShaper;
    };
    const Orlith::LUT::Shaper linear = ramp(1024, true);
    ASSERT_EQ(linear.entries.size(), 1024U);
    EXPECT_EQ(linear.entries[0][0], 0.0F);
    EXPECT_EQ(linear.entries[512][1], 512.0F / 1023.0F);
    EXPECT_EQ(linear.entries[1023][2], 1.0F);
    EXPECT_EQ(linear.counts[0], 0.0F) << "the counts are left alone";

    const Orlith::LUT::Shaper smooth = ramp(1024, false);
    const double t = 512.0 / 1023.0;
    EXPECT_NEAR(static_cast<double>(smooth.entries[512][2]), 3 * t * t - 2 * t * t * t, 1.2e-7);
    EXPECT_EQ(ramp(5, false).entries[1][0], 0.15625F);

    EXPECT_TRUE(std::isnan(ramp(1, true).entries[0][0]));
    EXPECT_TRUE(ramp(0, true).empty());
    EXPECT_TRUE(ramp(-7, false).empty());
}

}  // namespace
