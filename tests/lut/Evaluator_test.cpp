#include "lut/Evaluator.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <boost/smart_ptr/make_shared.hpp>
#include <cmath>
#include <limits>
#include <random>

#include "tests/support/Tables.h"

namespace {

using namespace test;
using Method = ol::Evaluator::Method;
using Outside = ol::Evaluator::Outside;

constexpr float kNaN = std::numeric_limits<float>::quiet_NaN();
constexpr float kInfinity = std::numeric_limits<float>::infinity();
constexpr int kMostInt = std::numeric_limits<int>::max();

constexpr Method kMethods[] = {Method::Step, Method::Staggered, Method::Trilinear,
                               Method::Tetrahedral, Method::Cubic};

/// The methods of LUT::interpolate, and the Evaluator's names for them.
constexpr struct {
    Method method;
    ol::InterpolationMode mode;
} kModes[] = {{Method::Step, ol::Step},
              {Method::Staggered, ol::LinearStaggered},
              {Method::Trilinear, ol::Trilinear},
              {Method::Cubic, ol::Cubic}};

using Colours = std::vector<ol::RGB>;

Colours evaluate(const boost::shared_ptr<ol::LUT>& table, const Colours& colours,
                 Method method = Method::Trilinear, Outside outside = Outside::Clamp) {
    Colours results(colours.size(), ol::RGB(-77.0F, -77.0F, -77.0F));
    ol::Evaluator(table, method, outside)
        .apply(colours.data()->data_block(), results.data()->data_block(), colours.size());
    return results;
}

ol::RGB evaluate(const boost::shared_ptr<ol::LUT>& table, const ol::RGB& colour,
                 Method method = Method::Trilinear, Outside outside = Outside::Clamp) {
    return evaluate(table, Colours{colour}, method, outside)[0];
}

/// Expects the same bits, but for the kind of what is not a number.
void expectSame(const Colours& actual, const Colours& expected, const Colours& colours) {
    const auto same = [](float a, float b) {
        return (a == b && !std::signbit(a) == !std::signbit(b)) || (a != a && b != b);
    };
    for (std::size_t i = 0; i < colours.size(); ++i) {
        for (unsigned c = 0; c < 3; ++c) {
            ASSERT_TRUE(same(actual[i][c], expected[i][c]))
                << actual[i] << " for " << colours[i] << ", not " << expected[i];
        }
    }
}

/// Curves of three, two and four points on red, green and blue, more stored than counted.
ol::Shaper unevenShaper() {
    return {{{-0.5F, 0.0F, 0.0F}, {0.25F, 2.0F, 0.125F}, {1.5F, 9.0F, 0.25F}, {9.0F, 9.0F, 1.25F}},
            {3.0F, 2.0F, 4.0F}};
}

struct Domain {
    const char* name;
    std::array<int, 3> sizes;
    std::array<float, 3> scale;
    std::array<float, 3> offset;
    bool isShaped;
};

constexpr Domain kDomains[] = {
    {"unit", {33, 33, 33}, {1 / 32.0F, 1 / 32.0F, 1 / 32.0F}, {0, 0, 0}, false},
    {"one that rounds", {50, 84, 24}, {1 / 49.0F, 1 / 83.0F, 1 / 23.0F}, {0, 0, 0}, false},
    {"unequal sides", {3, 4, 5}, {0.5F, 0.3F, 1e-5F}, {-1, 3, 0.125F}, false},
    {"indices", {2, 9, 6}, {1, 1, 1}, {0, 0, 0}, false},
    {"behind shapers", {6, 5, 7}, {1 / 5.0F, 1 / 4.0F, 1 / 6.0F}, {0, 0, 0}, true},
};

/// A lattice of random samples.
boost::shared_ptr<ol::LUT3D> makeLattice(const Domain& domain) {
    auto lut = boost::make_shared<ol::LUT3D>();
    lut->resize(domain.sizes[0], domain.sizes[1], domain.sizes[2]);
    std::mt19937 random;
    std::uniform_real_distribution<float> value(-1.0F, 1.0F);
    std::generate_n(lut->data(), lut->dataSize() / sizeof(float), [&] { return value(random); });
    for (unsigned c = 0; c < 3; ++c) {
        lut->transform[c][c] = domain.scale[c];
        lut->transform[3][c] = domain.offset[c];
    }
    if (domain.isShaped) {
        lut->inputShaper = unevenShaper();
        lut->outputShaper.entries = {{0.0F, 0.0F, 0.0F}, {0.7F, 1.0F, 1.0F}, {1.0F, 5.0F, 5.0F}};
        lut->outputShaper.counts = {3.0F, 2.0F, 2.0F};
    }
    return lut;
}

/// Colours from one domain end to the other, many of them at the ends or at a lattice point.
Colours coloursInside(const ol::LUT3D& lut) {
    ol::RGB min;
    ol::RGB max;
    lut.minmax(min, max);
    std::mt19937 random;
    std::uniform_real_distribution<float> unit(0.0F, 1.0F);
    const int sizes[] = {lut.width(), lut.height(), lut.depth()};
    Colours colours(5000);
    for (ol::RGB& colour : colours) {
        for (unsigned c = 0; c < 3; ++c) {
            const auto cells = static_cast<float>(sizes[c] - 1);
            float place = unit(random) * cells;
            if (random() % 8 == 0) place = std::round(place);
            const float choices[] = {min[c], max[c], place * lut.transform[c][c] + min[c]};
            colour[c] = std::min(std::max(choices[std::min(random() % 12, 2UL)], min[c]), max[c]);
        }
    }
    return colours;
}

TEST(Evaluator, GivesTheBitsOfInterpolateWithinTheDomain) {
    for (const Domain& domain : kDomains) {
        SCOPED_TRACE(domain.name);
        const auto lut = makeLattice(domain);
        const Colours colours = coloursInside(*lut);
        for (const auto& [method, mode] : kModes) {
            SCOPED_TRACE(mode);
            Colours expected;
            for (const ol::RGB& colour : colours)
                expected.push_back(lut->interpolate(colour, mode, false));
            expectSame(evaluate(lut, colours, method), expected, colours);
            expectSame(evaluate(lut, colours, method, Outside::Extrapolate), expected, colours);
        }
    }
}

/// Colours beyond the domain on one channel or more, and what is no colour.
Colours oddColours() {
    const float values[] = {0.3F, -0.2F, 1.1F, 4.0F, -3e9F, 1e30F, kInfinity, -kInfinity, kNaN};
    Colours colours;
    for (const float r : values) {
        for (const float g : values) {
            for (const float b : values)
                colours.emplace_back(r, g, b);
        }
    }
    return colours;
}

TEST(Evaluator, LimitsColoursToTheDomain) {
    const auto lut = makeLattice(kDomains[0]);
    const Colours colours = oddColours();
    Colours limited = colours;
    for (ol::RGB& colour : limited) {
        for (float& value : colour)
            value = value > 0.0F ? std::min(value, 1.0F) : 0.0F;
    }
    for (const Method method : kMethods)
        expectSame(evaluate(lut, colours, method), evaluate(lut, limited, method), colours);
}

TEST(Evaluator, ExtrapolatesAsInterpolateDoes) {
    for (const Domain& domain : kDomains) {
        SCOPED_TRACE(domain.name);
        const auto lut = makeLattice(domain);
        const Colours colours = oddColours();
        for (const auto& [method, mode] : kModes) {
            SCOPED_TRACE(mode);
            Colours expected;
            for (const ol::RGB& colour : colours)
                expected.push_back(lut->interpolate(colour, mode, true));
            expectSame(evaluate(lut, colours, method, Outside::Extrapolate), expected, colours);
        }
    }
    // 0.5 + r / 4 - g / 8 + b / 16, which every tetrahedron continues exactly.
    const auto plane = makeLattice(kDomains[0]);
    for (int i = 0; i < 33 * 33 * 33; ++i) {
        const int r = i % 33;
        const int g = i / 33 % 33;
        const int b = i / 33 / 33;
        plane->get(r, g, b).fill(0.5F + float(4 * r - 2 * g + b) / 512.0F);
    }
    for (const ol::RGB& x :
         Colours{{1.5F, 0.25F, 0.5F}, {0.25F, -1.0F, 2.0F}, {2.0F, 2.0F, 2.0F}}) {
        EXPECT_NEAR(evaluate(plane, x, Method::Tetrahedral, Outside::Extrapolate)[0],
                    0.5F + x[0] / 4 - x[1] / 8 + x[2] / 16, 1e-4F);
    }
}

/// The same tetrahedra without a sorting: a corner weighs as much as the smallest fraction of the
/// axes on which it is the upper one exceeds the largest fraction of the others.
double tetrahedral(const ol::LUT& lut, const std::array<double, 3>& x, unsigned channel) {
    const int lasts[] = {lut.width() - 1, lut.height() - 1, lut.depth() - 1};
    double sum = 0.0;
    for (unsigned corner = 0; corner < 8; ++corner) {
        double smallest = 1.0;
        double largest = 0.0;
        int index[3];
        for (unsigned c = 0; c < 3; ++c) {
            const double fraction = x[c] - std::floor(x[c]);
            const bool isUpper = (corner >> c & 1) != 0;
            index[c] = std::min(static_cast<int>(x[c]) + isUpper, lasts[c]);
            if (isUpper) {
                smallest = std::min(smallest, fraction);
            } else {
                largest = std::max(largest, fraction);
            }
        }
        sum += std::max(0.0, smallest - largest) *
               static_cast<double>(lut.get(index[0], index[1], index[2])[channel]);
    }
    return sum;
}

TEST(Evaluator, BlendsTheFourCornersOfATetrahedron) {
    const auto lut =
        makeLattice({"", {3, 4, 5}, {0.5F, 0.25F, 2.0F}, {-1.0F, 3.0F, 0.125F}, false});
    // Steps of 1/4: fractions are often equal. In steps of 1/4096 they seldom are. Weights are
    // exact; four products and three sums of at most 1 are rounded.
    constexpr double kTolerance = 7 * 0x1p-24;
    std::mt19937 random;
    for (const int steps : {4, 4096}) {
        for (int i = 0; i < 2000; ++i) {
            std::array<double, 3> x;
            ol::RGB colour;
            for (unsigned c = 0; c < 3; ++c) {
                const int cells = static_cast<int>(c) + 2;
                x[c] = std::uniform_int_distribution<int>(0, cells * steps)(random) / double(steps);
                colour[c] = static_cast<float>(x[c]) * lut->transform[c][c] + lut->transform[3][c];
            }
            const ol::RGB result = evaluate(lut, colour, Method::Tetrahedral);
            for (unsigned c = 0; c < 3; ++c)
                ASSERT_NEAR(double(result[c]), tetrahedral(*lut, x, c), kTolerance) << colour;
        }
    }
    // By hand: red before blue before green, weights 1/4, 1/4, 3/8 and 1/8.
    const auto marked = markedLattice(3, 4, 5);
    marked->get(1, 1, 2) = ol::RGB(8.0F, 0.0F, 0.0F);
    marked->get(2, 1, 2) = ol::RGB(0.0F, 16.0F, 0.0F);
    marked->get(2, 1, 3) = ol::RGB(0.0F, 0.0F, 32.0F);
    marked->get(2, 2, 3) = ol::RGB(64.0F, 0.0F, 0.0F);
    expectRGB(evaluate(marked, {1.75F, 1.125F, 2.5F}, Method::Tetrahedral), 10.0F, 4.0F, 12.0F);
}

TEST(Evaluator, SendsCurvesThroughTheirShapersAndOverTheirDomain) {
    const auto curve = markedCurve(42);  // 41 times 1/41 is not 1 in single precision
    curve->inputShaper = unevenShaper();
    ol::setUnitDomain(*curve, 42, 42, 42);
    Colours colours = oddColours();
    for (int i = 0; i < 300; ++i)
        colours.emplace_back(float(i) / 200.0F, float(i) / 100.0F - 0.5F, float(i) / 299.0F);
    for (const Outside outside : {Outside::Clamp, Outside::Extrapolate}) {
        Colours expected;
        for (const ol::RGB& colour : colours) {
            ol::RGB place = curve->applyShaper(colour);
            for (float& value : place) {
                if (value != value && outside == Outside::Clamp) value = 0.0F;
            }
            expected.push_back(curve->interpolate(place, ol::Step, true));
        }
        expectSame(evaluate(curve, colours, Method::Cubic, outside), expected, colours);
    }

    // Sample i stands for the input i on red, for 2 i - 4 on green and for i / 5 on blue.
    const auto ranged = markedCurve(6);
    ranged->transform[1][1] = 2.0F;
    ranged->transform[3][1] = -4.0F;
    ranged->transform[2][2] = 1.0F / 5.0F;
    const ol::RGB middle = evaluate(ranged, {2.5F, 1.0F, 0.5F});
    for (unsigned c = 0; c < 3; ++c)
        EXPECT_NEAR(middle[c], 0.00025F + 0.1F * float(c), 1e-7F);
    expectRGB(evaluate(ranged, {9.0F, -4.5F, kNaN}), markedSample(5, 0, 0)[0],
              markedSample(0, 0, 0)[1], markedSample(0, 0, 0)[2]);
}

TEST(Evaluator, WorksInPlaceOnAnyNumberOfColours) {
    const auto lut = makeLattice(kDomains[1]);
    const Colours colours = coloursInside(*lut);
    for (const Method method : kMethods) {
        const Colours expected = evaluate(lut, colours, method);
        const ol::Evaluator evaluator(lut, method);
        for (const std::size_t count :
             {std::size_t{0}, std::size_t{1}, std::size_t{31}, colours.size() - 1}) {
            Colours inPlace = colours;
            float* const floats = inPlace.data()->data_block();
            evaluator.apply(floats, floats, count);
            Colours mixed(expected.begin(), expected.begin() + std::ptrdiff_t(count));
            mixed.insert(mixed.end(), colours.begin() + std::ptrdiff_t(count), colours.end());
            expectSame(inPlace, mixed, colours);
        }
    }
}

TEST(Evaluator, StaysWithinTheSamplesOfWrongTables) {
    constexpr float kScales[] = {kInfinity, kNaN, 0.0F, -0.5F, 1e-38F, 1e38F, 0.3F};
    constexpr std::array<int, 3> kSizes[] = {{1, 1, 1}, {1, 3, 2}, {4, 2, 3}};
    constexpr float kCounts[] = {0.0F, 1.0F, 2.0F, 99.0F, -5.0F, kNaN, 3e9F};
    for (const auto& sizes : kSizes) {
        for (std::size_t i = 0; i < std::size(kScales); ++i) {
            const float scale = kScales[i];
            const float offset = kScales[(i + 1) % std::size(kScales)];
            const auto lut =
                makeLattice({"", sizes, {scale, 0.5F, scale}, {offset, offset, 0.0F}, true});
            lut->inputShaper.counts.fill(kCounts[i]);
            lut->outputShaper.counts.fill(kCounts[i]);
            const auto curve = markedCurve(sizes[0]);
            curve->inputShaper = lut->inputShaper;
            curve->outputShaper = lut->outputShaper;
            curve->transform = lut->transform;
            for (const Method method : kMethods) {
                SCOPED_TRACE(testing::Message() << "scale " << scale << ", method " << int(method));
                for (const ol::RGB& colour : evaluate(lut, oddColours(), method)) {
                    // Splines overshoot: three passes of at most 1.25; so do half cells.
                    for (const float value : colour)
                        ASSERT_LE(std::fabs(value), method == Method::Cubic ? 40.0F : 3.4F);
                }
                // What lies outside may be anything, but is read from the samples.
                evaluate(lut, oddColours(), method, Outside::Extrapolate);
            }
            for (const ol::RGB& colour : evaluate(curve, oddColours())) {
                for (const float value : colour)
                    ASSERT_TRUE(0.0F <= value && value <= 0.2003F) << value;
            }
        }
    }
    const auto empty = boost::make_shared<ol::LUT3D>();
    empty->resize(0, kMostInt, kMostInt);
    for (const Method method : kMethods) {
        expectRGB(evaluate(empty, {0.5F, kNaN, 2.0F}, method, Outside::Extrapolate), 0.0F, 0.0F,
                  0.0F);
        expectRGB(evaluate(boost::make_shared<ol::LUT1D>(), {0.5F, kNaN, 2.0F}, method), 0.0F, 0.0F,
                  0.0F);
    }
}

TEST(Evaluator, PassesOnSamplesThatAreNoNumbers) {
    const auto lut = makeLattice(kDomains[0]);
    lut->get(16, 16, 16)[1] = kNaN;
    for (const Method method : kMethods) {
        const ol::RGB result = evaluate(lut, {0.501F, 0.501F, 0.501F}, method);
        EXPECT_TRUE(result[1] != result[1]);
        EXPECT_LT(std::fabs(result[0]) + std::fabs(result[2]), 20.0F);
    }
}

}  // namespace
