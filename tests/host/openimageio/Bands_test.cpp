#include "host/openimageio/Bands.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <vector>

#include "host/Error.h"

namespace {

using host::openimageio::Bands;

/// An image whose samples are the numbers of their lines, and how often each line was decoded.
struct Image {
    Image(int imageWidth, int imageHeight, int blockLines)
        : width(imageWidth),
          height(imageHeight),
          counts(static_cast<std::size_t>(imageHeight)),
          bands(width, height, blockLines, [this, blockLines](int first, int end, float* rgb) {
              EXPECT_EQ(first % blockLines, 0);
              EXPECT_TRUE(end % blockLines == 0 || end == height) << end;
              if (damagedLine >= first && damagedLine < end) throw host::Error("damaged");
              for (int line = first; line < end; ++line) {
                  ++counts[static_cast<std::size_t>(line)];
                  rgb = std::fill_n(rgb, 3 * width, static_cast<float>(line));
              }
          }) {}

    int most() const { return *std::max_element(counts.begin(), counts.end()); }

    const int width, height;
    int damagedLine = -1;
    std::vector<int> counts;
    Bands bands;
};

TEST(Bands, GiveAnyLineAndDecodeEachOnceInAPass) {
    const struct {
        const char* name;
        int width, height, blockLines;
        int mostInTwoPasses;  // and once more where a pass does not begin with the first line
    } kCases[] = {
        {"one line", 5, 1, 1, 1},
        {"two bands", 1000, 400, 1, 1},
        {"four bands", 50000, 67, 1, 3},
        {"blocks of 32, the last cut short", 50000, 150, 32, 3},
        {"blocks higher than a band", 3000, 1300, 256, 3},
    };
    for (const auto& each : kCases) {
        SCOPED_TRACE(each.name);
        Image image(each.width, each.height, each.blockLines);
        for (int pass = 0; pass < 2; ++pass) {
            for (int line = each.height - 1; line >= 0; --line) {
                const float* const rgb = image.bands.line(line);
                ASSERT_EQ(rgb[0], static_cast<float>(line));
                ASSERT_EQ(rgb[3 * each.width - 1], static_cast<float>(line));
            }
        }
        EXPECT_EQ(image.most(), each.mostInTwoPasses);
    }
}

TEST(Bands, NoticeWhatIsNotThereWhateverIsAskedFor) {
    constexpr int kHeight = 67;
    const struct {
        int damagedLine, askedLine;
        bool isNoticed;
    } kCases[] = {{0, kHeight - 1, true}, {kHeight - 1, 0, true}, {30, 31, true}, {30, 0, false}};
    for (const auto& each : kCases) {
        Image image(50000, kHeight, 1);
        image.damagedLine = each.damagedLine;
        for (int attempt = 0; attempt < 2; ++attempt) {
            if (each.isNoticed) {
                EXPECT_THROW(image.bands.line(each.askedLine), host::Error);
            } else {
                EXPECT_EQ(*image.bands.line(each.askedLine), static_cast<float>(each.askedLine));
            }
        }
    }
    for (const int damagedLine : {0, 15, 16, 31, 32, 47, 48, 66}) {
        Image image(50000, kHeight, 1);
        image.damagedLine = damagedLine;
        EXPECT_THROW(for (int line = kHeight - 4; line >= 0; line -= 7) image.bands.line(line),
                     host::Error)
            << "one line in seven, damaged line " << damagedLine;
    }
}

}  // namespace
