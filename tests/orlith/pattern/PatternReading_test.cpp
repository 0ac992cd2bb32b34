#include "orlith/pattern/PatternReading.h"

#include <array>
#include <cmath>
#include <functional>
#include <limits>

#include "orlith/Command.h"
#include "tests/host/HostFixture.h"
#include "tests/orlith/Program.h"
#include "zefra/Row.h"

namespace {

using test::Pixel;

// The pattern of 5 points has 12 x 11 patches, of which the last 7 are padding.
constexpr int kWidth = 84;
constexpr int kHeight = 77;
constexpr float kInfinity = std::numeric_limits<float>::infinity();

/// A pixel of the pattern, black in its padding.
Pixel patternPixel(int x, int y) {
    const int index = y / 7 * 12 + x / 7;
    const auto value = [&](int point) { return static_cast<float>(point % 5) / 4; };
    return index < 125 ? Pixel{value(index), value(index / 5), value(index / 25)} : Pixel{0, 0, 0};
}

/// A look that keeps nothing of the pattern's symmetries; black becomes (0.25, 0, 1).
Pixel graded(int x, int y) {
    return test::markedLook(patternPixel(x, y));
}

Pixel times(float factor, const Pixel& pixel) {
    return {factor * pixel.r, factor * pixel.g, factor * pixel.b};
}

/// An image that is made of a function, and expects each of its rows to be fetched once, in order.
class FunctionImage final : public zefra::Iop {
public:
    using Function = std::function<Pixel(int x, int y)>;

    FunctionImage(zefra::Node& node, const zefra::Box& box, Function pixel)
        : Iop(node), pixel_(std::move(pixel)) {
        setBox(box);
    }
    const char* className() const override { return "FunctionImage"; }
    const char* help() const override { return ""; }

protected:
    void _validate(bool) override {}
    void engine(int y, int x, int r, zefra::ChannelMask, zefra::Row& row) override {
        EXPECT_EQ(y, nextRow_++);
        for (int column = x; column < r; ++column) {
            const auto [red, green, blue] = pixel_(column, y);
            row.writable(zefra::kRed)[column] = red;
            row.writable(zefra::kGreen)[column] = green;
            row.writable(zefra::kBlue)[column] = blue;
        }
    }

private:
    Function pixel_;
    int nextRow_ = 0;
};

class PatternReadingTest : public test::HostTest {
protected:
    orlith::PatternReading read(const zefra::Box& box, FunctionImage::Function pixel,
                                bool isForced = false) {
        FunctionImage image(host_.createNode("Read"), box, std::move(pixel));
        return orlith::readPattern("p", image, isForced);
    }
};

TEST_F(PatternReadingTest, LooksAtPatternsBeforeTheyAreBelieved) {
    const std::string uneven = " patches are not of one colour, pixels differ by up to ";
    const std::string place =
        ", most in the patch at x 14 and y 21 from the bottom left (blur,"
        " sharpening, grain, dither, resizing or lossy compression?)";
    const auto noSize = [](const std::string& found) {
        return "no pattern has " + found +
               " pixels; the nearest by its width, of 5 points, has 84"
               " x 77 (resized, cropped or padded?)";
    };
    const auto plain = [](float r, float g, float b) {
        return [=](int, int) { return Pixel{r, g, b}; };
    };
    const auto turned = [](const std::string& how) {
        return "its pattern of 5 points is " + how + "; undo that";
    };
    const struct {
        const char* name;
        int width, height;
        FunctionImage::Function pixel;
        std::string words;  // those of a failure or of a warning
        bool isRefused = false;
        int left = 0;
    } kCases[] = {
        {"a look", kWidth, kHeight, graded, ""},
        {"padded", kWidth + 6, kHeight + 6,
         [](int x, int y) {
             return x < kWidth && y < kHeight ? graded(x, y) : Pixel{9, 9, 9};
         },
         ""},
        {"one colour", kWidth, kHeight, plain(0.3F, 0.3F, 0.3F), ""},
        {"all but white is black", kWidth, kHeight,
         [](int x, int y) {
             const Pixel in = patternPixel(x, y);
             return times(in.r + in.g + in.b > 2.9F ? 1 : 0, in);
         },
         ""},
        {"within the limit", kWidth, kHeight,
         [](int x, int y) { return times(1 + 0.00049F * static_cast<float>(x % 2), graded(x, y)); },
         ""},
        {"within the limit of large values", kWidth, kHeight,
         [](int x, int y) { return times(x % 2 == 0 ? 100 : 100.049F, graded(x, y)); }, ""},

        {"narrow", kWidth - 1, kHeight, graded, noSize("83 x 77"), true},
        {"low", kWidth, kHeight - 1, graded, noSize("84 x 76"), true},
        {"high", kWidth, kHeight + 7, graded, noSize("84 x 84"), true},
        {"moved", kWidth, kHeight, graded,
         "its pixels begin at x 3 and y 0 from the bottom left, a pattern begins at 0 and 0"
         " (cropped, or moved?)",
         true, 3},
        {"mirrored", kWidth, kHeight, [](int x, int y) { return graded(83 - x, y); },
         turned("mirrored left to right"), true},
        {"upside down", kWidth, kHeight, [](int x, int y) { return graded(x, 76 - y); },
         turned("mirrored top to bottom"), true},
        {"half a turn", kWidth, kHeight, [](int x, int y) { return graded(83 - x, 76 - y); },
         turned("turned by 180 degrees"), true},
        {"clockwise", kHeight, kWidth, [](int x, int y) { return graded(83 - y, x); },
         turned("turned by 90 degrees clockwise"), true},
        {"counterclockwise", kHeight, kWidth, [](int x, int y) { return graded(y, 76 - x); },
         turned("turned by 90 degrees counterclockwise"), true},
        {"transposed", kHeight, kWidth, [](int x, int y) { return graded(83 - y, 76 - x); },
         turned("transposed"), true},
        {"on the other diagonal", kHeight, kWidth, [](int x, int y) { return graded(y, x); },
         turned("turned by 180 degrees and transposed"), true},
        {"of one colour, on its side", kHeight, kWidth, plain(1, 0, 0),
         turned("turned by 90 degrees or transposed"), true},

        {"a bright last row", kWidth, kHeight,
         [](int x, int y) { return times(y < 70 ? 1 : 1.001F, graded(x, y)); },
         "the padding behind the last patch should have the colour of the first, and differs by"
         " 0.001 (a vignette, a logo, or the pattern of another program?)"},
        {"one bright pixel", kWidth, kHeight,
         [](int x, int y) { return times(x == 20 && y == 21 ? 1.001F : 1, graded(x, y)); },
         "1 of 125" + uneven + "0.00075" + place},
        {"one infinite pixel beside the centre", kWidth, kHeight,
         [](int x, int y) {
             return x == 20 && y == 21 ? Pixel{0, kInfinity, 0} : graded(x, y);
         },
         "1 of 125" + uneven + "inf" + place},
        {"patches without a number", kWidth, kHeight,
         [](int x, int y) {
             return x / 7 == 2 && y > 20 ? Pixel{std::nanf(""), 0, -kInfinity} : graded(x, y);
         },
         "16 of 375 samples are not finite, the first in the patch at x 14 and y 21 from the bottom"
         " left (a division by zero, the logarithm of a negative number?)"},
    };
    for (const auto& each : kCases) {
        SCOPED_TRACE(each.name);
        const zefra::Box box{each.left, 0, each.left + each.width, each.height};
        std::string words;
        bool isRefused = false;
        try {
            const orlith::PatternReading pattern = read(box, each.pixel);
            EXPECT_EQ(pattern.table->width(), 5);
            for (const std::string& text : pattern.warnings)
                words += text;
        } catch (const orlith::Failure& failure) {
            words = failure.what();
            isRefused = true;
        }
        EXPECT_EQ(words, each.words.empty() ? "" : "p: " + each.words);
        EXPECT_EQ(isRefused, each.isRefused);
    }
}

TEST_F(PatternReadingTest, SeesByItsColoursHowAPatternWithoutPaddingLies) {
    constexpr int kLast = 55;  // 4 points: 8 x 8 patches
    using Look = std::function<Pixel(const Pixel&)>;
    const Look kLooks[] = {
        [](const Pixel& in) { return in; },
        [](const Pixel& in) {
            return Pixel{1 - in.g, 1 - in.b, 1 - in.r};
        },
        [](const Pixel& in) {
            return Pixel{in.r * in.r, in.g, in.b - in.r / 3};
        },
    };
    const struct {
        std::function<std::array<int, 2>(int x, int y)> place;
        const char* how;
    } kCases[] = {
        {[](int x, int y) {
             return std::array{x, y};
         },
         ""},
        {[](int x, int y) {
             return std::array{kLast - x, kLast - y};
         },
         ""},
        {[](int x, int y) {
             return std::array{kLast - x, y};
         },
         "mirrored left to right or mirrored top to bottom"},
        {[](int x, int y) {
             return std::array{x, kLast - y};
         },
         "mirrored left to right or mirrored top to bottom"},
        {[](int x, int y) {
             return std::array{kLast - y, x};
         },
         "turned by 90 degrees clockwise or turned by 90 degrees counterclockwise"},
        {[](int x, int y) {
             return std::array{y, x};
         },
         "transposed or turned by 180 degrees and transposed"},
    };
    const auto warningOf = [&](const FunctionImage::Function& pixel) {
        const auto pattern = read({0, 0, kLast + 1, kLast + 1}, pixel);
        return pattern.warnings.empty() ? "" : pattern.warnings.front();
    };
    for (const auto& each : kCases) {
        for (const Look& look : kLooks) {
            const std::string words = warningOf([&](int x, int y) {
                const auto [column, row] = each.place(x, y);
                const int index = row / 7 * 8 + column / 7;
                const auto value = [&](int point) { return static_cast<float>(point % 4) / 3; };
                return look({value(index), value(index / 4), value(index / 16)});
            });
            EXPECT_EQ(words, *each.how == '\0'
                                 ? ""
                                 : std::string("p: its pattern of 4 points seems to be ") +
                                       each.how + ": its colours would be in order");
        }
    }
    EXPECT_EQ(warningOf([](int, int) { return Pixel{0.3F, 0.3F, 0.3F}; }), "");
    EXPECT_EQ(warningOf([](int x, int y) {
                  const auto noise = static_cast<float>((x / 7 * 131 + y / 7 * 8171) * 977 % 1009);
                  return Pixel{noise, -noise, noise / 2};
              }),
              "");
}

TEST_F(PatternReadingTest, TakesCentresByForce) {
    const auto pattern = read(
        {0, 0, kWidth, 15},
        [](int x, int y) { return x % 7 == 3 && y % 7 == 3 ? graded(x, y) : Pixel{}; }, true);
    ASSERT_EQ(pattern.warnings.size(), 2U);  // size, and that patches are not of one colour
    const auto& table = *pattern.table;
    EXPECT_EQ(table.get(3, 4, 0), Orlith::LUT::RGB(0.625F, 1.0F, 1.0F));
    EXPECT_EQ(table.get(4, 4, 0), Orlith::LUT::RGB(0.0F, 0.0F, 0.0F)) << "is not there";
}

}  // namespace
