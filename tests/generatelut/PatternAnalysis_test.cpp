#include "generatelut/PatternAnalysis.h"

#include <gtest/gtest.h>

#include <cmath>
#include <string>
#include <vector>

namespace {

using generatelut::PatternSize;
using Ints = std::vector<int>;
using Floats = std::vector<float>;

/// An image that tells what was asked of it. The centre of patch i holds (i, i + 0.25, i + 0.5),
/// every pixel that nobody should look at -1.
class MemoryFrame final : public generatelut::Frame {
public:
    explicit MemoryFrame(int width) : width_(width) {}

    void withRow(int y, int width, const UseRow& use) override {
        rows.push_back(y);
        Floats channels[3];
        for (int c = 0; c < 3; ++c) {
            for (int x = 0; x < width; ++x) {
                const int index = y / 7 * (width_ / 7) + x / 7;
                const bool isCentre = x % 7 == 3 && y % 7 == 3;
                channels[c].push_back(
                    isCentre ? static_cast<float>(index) + 0.25F * static_cast<float>(c) : -1.0F);
            }
        }
        use(channels[0].data(), channels[1].data(), channels[2].data());
    }
    void progressMessage(const char* text) override { messages.emplace_back(text); }
    void progressFraction(double fraction) override { fractions.push_back(fraction); }
    bool aborted() override { return rows.size() >= abortAtRow; }

    std::size_t abortAtRow = 1U << 20;
    Ints rows;
    std::vector<std::string> messages;
    std::vector<double> fractions;

private:
    int width_;
};

boost::shared_ptr<Orlith::LUT::LUT3D> analyse(MemoryFrame& frame, int width, int height) {
    return generatelut::analyseFrame(PatternSize::ofImage(width, height), {2, true}, frame);
}

Ints numbersOf(const PatternSize& size) {
    EXPECT_EQ(size.lutSizeG, size.lutSizeR);
    EXPECT_EQ(size.lutSizeB, size.lutSizeR);
    EXPECT_EQ(size.pixelWidth(), size.patchColumns * 7);
    EXPECT_EQ(size.pixelHeight(), size.patchRows * 7);
    return {size.lutSizeR, size.lutEntryCount, size.patchRows, size.patchColumns};
}

TEST(PatternSize, FollowsFromTheSizeOfTheImage) {
    const struct {
        int width, height;
        Ints numbers;  // points a side, points, rows and columns of patches
    } kCases[] = {
        {1274, 1267, {32, 32768, 181, 182}},
        {1280, 1273, {32, 32768, 181, 182}},  // a remainder is no patch
        {182 * 7, 7, {32, 32768, 1, 182}},    // only the width decides
        {183 * 7, 181 * 7, {33, 35937, 181, 183}},
        {7, 7, {1, 1, 1, 1}},
        {6, 700, {0, 0, 100, 0}},
        {0, 0, {0, 0, 0, 0}},
    };
    for (const auto& each : kCases) {
        SCOPED_TRACE(std::to_string(each.width) + " x " + std::to_string(each.height));
        EXPECT_EQ(numbersOf(PatternSize::ofImage(each.width, each.height)), each.numbers);
    }
    EXPECT_EQ(numbersOf(PatternSize()), (Ints{32, 32768, 181, 182})) << "until one was seen";
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
    EXPECT_EQ(Ints(place, place + 3), (Ints{4, 1, 3}));
    ASSERT_TRUE(size.indexToColour(4 + 5 * 1 + 25 * 3, colour));
    EXPECT_EQ(Floats(colour, colour + 3), (Floats{1.0F, 0.25F, 0.75F}));
    for (const int index : {-1, 125, 1 << 30}) {
        EXPECT_FALSE(size.indexToLattice(index, place));
        EXPECT_FALSE(size.indexToColour(index, colour));
        EXPECT_EQ(Ints(place, place + 3), (Ints{0, 0, 0}));
        EXPECT_EQ(Floats(colour, colour + 3), (Floats{0, 0, 0}));
    }
    EXPECT_TRUE(PatternSize::ofImage(7, 7).indexToColour(0, colour));
    EXPECT_TRUE(std::isnan(colour[0])) << "a cube of one point has no extent";
}

TEST(PatternSampling, ReadsTheCentreOfEachPatchRedFastest) {
    // 12 x 11 patches for 125 points, and a remainder of pixels to the right and above.
    MemoryFrame frame(12 * 7 + 5);
    const auto lut = analyse(frame, 12 * 7 + 5, 11 * 7 + 6);
    ASSERT_TRUE(lut);
    ASSERT_EQ(lut->dataSize(), 125 * 12U);
    for (int index = 0; index < 125; ++index) {
        const Orlith::LUT::RGB& sample = lut->get(index % 5, index / 5 % 5, index / 25);
        const auto first = static_cast<float>(index);
        EXPECT_EQ(sample, Orlith::LUT::RGB(first, first + 0.25F, first + 0.5F));
    }
    EXPECT_EQ(frame.rows, (Ints{3, 10, 17, 24, 31, 38, 45, 52, 59, 66, 73}));
    EXPECT_EQ(frame.messages, std::vector<std::string>{"Analyzing frame"});
    ASSERT_EQ(frame.fractions.size(), 11U);
    EXPECT_EQ(frame.fractions[0], 3.0 / 77.0);
    EXPECT_EQ(frame.fractions[10], 73.0 / 77.0);
}

TEST(PatternSampling, LeavesZerosWherePatchesAreMissing) {
    MemoryFrame frame(84);
    const auto lut = analyse(frame, 84, 14);  // 2 of 11 rows
    ASSERT_EQ(lut->width(), 5);
    EXPECT_EQ(lut->data()[3 * 24 - 1], 23.5F);
    for (std::size_t i = 3 * std::size_t{24}; i < 3 * std::size_t{125}; ++i)
        EXPECT_EQ(lut->data()[i], 0.0F) << "float " << i;
    MemoryFrame narrow(6);
    EXPECT_EQ(analyse(narrow, 6, 84)->width(), 0);
}

TEST(PatternSampling, StopsWhenCancelled) {
    MemoryFrame frame(84);
    frame.abortAtRow = 4;
    EXPECT_FALSE(analyse(frame, 84, 77));
    EXPECT_EQ(frame.rows.size(), 4U);
}

TEST(PreLUT, IsARampOfItsStyleWithoutCounts) {
    for (const bool isLinear : {false, true}) {
        MemoryFrame frame(21);
        const auto lut =
            generatelut::analyseFrame(PatternSize::ofImage(21, 21), {5, isLinear}, frame);
        ASSERT_EQ(lut->outputShaper.entries.size(), 5U);
        EXPECT_EQ(lut->outputShaper.entries[1][0], isLinear ? 0.25F : 0.15625F);
        EXPECT_EQ(lut->outputShaper.counts[0], 0.0F);
    }
}

}  // namespace
