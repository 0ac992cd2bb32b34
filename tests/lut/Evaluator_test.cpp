#include "lut/Evaluator.h"

#include <gtest/gtest.h>
#include <hwy/targets.h>

#include <algorithm>
#include <array>
#include <boost/smart_ptr/make_shared.hpp>
#include <cmath>
#include <limits>
#include <random>
#include <thread>

#include "lut/Interpolation.h"
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
constexpr Outside kRules[] = {Outside::Clamp, Outside::Extrapolate};

using Colours = std::vector<ol::RGB>;

/// Every test runs with every instruction set that this processor has, and with none.
class Evaluator : public testing::TestWithParam<std::int64_t> {
protected:
    void SetUp() override { hwy::SetSupportedTargetsForTest(GetParam()); }
    void TearDown() override { hwy::SetSupportedTargetsForTest(0); }
};

std::vector<std::int64_t> targets() {
    std::vector<std::int64_t> all = {HWY_SCALAR};
    for (const std::int64_t target : hwy::SupportedAndGeneratedTargets()) {
        if (target != HWY_SCALAR) all.push_back(target);
    }
    return all;
}

INSTANTIATE_TEST_SUITE_P(Targets, Evaluator, testing::ValuesIn(targets()),
                         [](const auto& test) { return hwy::TargetName(test.param); });

/// The results of an Evaluator that has seen as many colours before as the table has samples: it is
/// no longer in its beginnings.
Colours evaluate(const boost::shared_ptr<ol::LUT>& table, const Colours& colours,
                 Method method = Method::Trilinear, Outside outside = Outside::Clamp) {
    const ol::Evaluator evaluator(table, method, outside);
    Colours asMany(100 + table->dataSize() / sizeof(ol::RGB), ol::RGB(0.5F, 0.5F, 0.5F));
    float* const floats = asMany.data()->data_block();
    evaluator.apply(floats, floats, asMany.size());
    Colours results(colours.size());
    evaluator.apply(colours.data()->data_block(), results.data()->data_block(), colours.size());
    return results;
}

ol::RGB evaluate(const boost::shared_ptr<ol::LUT>& table, const ol::RGB& colour,
                 Method method = Method::Trilinear, Outside outside = Outside::Clamp) {
    return evaluate(table, Colours{colour}, method, outside)[0];
}

/// What the library gives for one colour, which is not limited to the domain.
ol::RGB byTheBook(const ol::LUT& lut, const ol::RGB& colour, Method method, bool extrapolate) {
    switch (method) {
        case Method::Step:
            return lut.interpolate(colour, ol::Step, extrapolate);
        case Method::Staggered:
            return lut.interpolate(colour, ol::LinearStaggered, extrapolate);
        case Method::Trilinear:
            return lut.interpolate(colour, ol::Trilinear, extrapolate);
        case Method::Cubic:
            return lut.interpolate(colour, ol::Cubic, extrapolate);
        case Method::Tetrahedral:
            break;
    }
    const ol::RGB point = lut.applyShaper(colour);
    return extrapolate ? ol::interpolateOrContinue(lut, point, ol::TetrahedralInterpolate)
                       : ol::TetrahedralInterpolate(lut, point);
}

/// Expects the same bits, but for the kind of what is not a number.
void expectSame(const Colours& actual, const Colours& expected, const Colours& colours) {
    const auto same = [](float a, float b) {
        return a == b ? std::signbit(a) == std::signbit(b) : a != a && b != b;
    };
    for (std::size_t i = 0; i < expected.size(); ++i) {
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

/// Its last input, 1000.00006, is found beyond the point behind the last one.
constexpr Domain kBeyond = {"", {3, 3, 3}, {1.6e-5F, 1.6e-5F, 1.6e-5F}, {1000, 1000, 1000}, false};

constexpr Domain kDomains[] = {
    {"unit", {17, 9, 5}, {1 / 16.0F, 1 / 8.0F, 1 / 4.0F}, {0, 0, 0}, false},
    {"one that rounds", {50, 4, 62}, {1 / 49.0F, 1 / 3.0F, 1 / 61.0F}, {0, 0, 0}, false},
    {"unequal sides", {3, 4, 5}, {0.5F, 0.3F, 1e-5F}, {-1, 3, 0.125F}, false},
    {"from minus zero", {3, 5, 9}, {0.5F, 0.25F, 0.125F}, {-0.0F, -0.0F, -0.0F}, false},
    {"indices", {2, 9, 6}, {1, 1, 1}, {0, 0, 0}, false},
    {"behind shapers", {6, 5, 7}, {1 / 5.0F, 1 / 4.0F, 1 / 6.0F}, {0, 0, 0}, true},
};

/// What stands in a table: random numbers; some of them none, or at the ends of what there is;
/// numbers whose double or sum may be beyond it; some whose half is no number; only zeros, with
/// their sign.
enum class Samples { Random, Odd, Huge, Tiny, NegativeZeros };
constexpr Samples kSamples[] = {Samples::Random, Samples::Odd, Samples::Huge, Samples::Tiny,
                                Samples::NegativeZeros};

void fill(ol::LUT& lut, Samples samples) {
    constexpr float kOdd[] = {kNaN, kInfinity, -0.0F, 1e-41F, -3e38F};
    std::mt19937 random;
    std::uniform_real_distribution<float> value(-1.0F, 1.0F);
    for (std::size_t i = 0; i < lut.dataSize() / sizeof(float); ++i) {
        lut.data()[i] = samples == Samples::NegativeZeros ? -0.0F : value(random);
        if (samples == Samples::Huge) {
            lut.data()[i] = i % 97 == 0 ? 1.8e38F : random() % 2 == 0 ? 2e37F : -3e37F;
        }
        if (samples == Samples::Tiny) lut.data()[i] = float(random() % 8) * 0x1p-149F;
        if (samples == Samples::Odd && i % 11 == 0) lut.data()[i] = kOdd[i % std::size(kOdd)];
    }
}

boost::shared_ptr<ol::LUT3D> makeLattice(const Domain& domain) {
    auto lut = boost::make_shared<ol::LUT3D>();
    lut->resize(domain.sizes[0], domain.sizes[1], domain.sizes[2]);
    fill(*lut, Samples::Random);
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

/// Colours from one domain end to the other, many of them at the ends, at lattice points, or as far
/// from one on several axes.
Colours coloursInside(const ol::LUT3D& lut) {
    ol::RGB min;
    ol::RGB max;
    lut.minmax(min, max);
    std::mt19937 random;
    std::uniform_real_distribution<float> unit(0.0F, 1.0F);
    const int sizes[] = {lut.width(), lut.height(), lut.depth()};
    Colours colours(2000);
    for (ol::RGB& colour : colours) {
        for (unsigned c = 0; c < 3; ++c) {
            float place = unit(random) * static_cast<float>(sizes[c] - 1);
            if (random() % 2 == 0) place = std::round(4.0F * place) / 4.0F;
            const float between = place * lut.transform[c][c] + min[c];
            const float first = min[c] == 0.0F && random() % 2 == 0 ? -0.0F : min[c];
            const float choices[] = {first, max[c], between};
            colour[c] = std::min(std::max(choices[std::min(random() % 12, 2UL)], min[c]), max[c]);
        }
    }
    return colours;
}

TEST_P(Evaluator, GivesTheBitsOfInterpolateWithinTheDomain) {
    for (const Domain& domain : kDomains) {
        SCOPED_TRACE(domain.name);
        const auto lut = makeLattice(domain);
        const Colours colours = coloursInside(*lut);
        for (const Samples samples : kSamples) {
            fill(*lut, samples);
            for (const Method method : kMethods) {
                SCOPED_TRACE(testing::Message() << int(samples) << ", method " << int(method));
                Colours expected;
                for (const ol::RGB& colour : colours)
                    expected.push_back(byTheBook(*lut, colour, method, false));
                for (const Outside outside : kRules)
                    expectSame(evaluate(lut, colours, method, outside), expected, colours);
            }
        }
    }
}

/// Colours beyond the domain on one channel or more, and what is no colour.
Colours oddColours() {
    const float values[] = {0.3F, -0.0F, -0.2F, 1.1F, -3e9F, kInfinity, kNaN};
    Colours colours;
    for (const float r : values) {
        for (const float g : values) {
            for (const float b : values)
                colours.emplace_back(r, g, b);
        }
    }
    return colours;
}

TEST_P(Evaluator, LimitsColoursToTheDomain) {
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

TEST_P(Evaluator, ExtrapolatesAsInterpolateDoes) {
    for (const Domain& domain : kDomains) {
        SCOPED_TRACE(domain.name);
        const auto lut = makeLattice(domain);
        const Colours colours = oddColours();
        for (const Method method : kMethods) {
            SCOPED_TRACE(int(method));
            Colours expected;
            for (const ol::RGB& colour : colours)
                expected.push_back(byTheBook(*lut, colour, method, true));
            expectSame(evaluate(lut, colours, method, Outside::Extrapolate), expected, colours);
        }
    }
    const auto beyond = makeLattice(kBeyond);
    ol::RGB min;
    ol::RGB max;
    beyond->minmax(min, max);
    for (const Method method : kMethods) {
        expectSame(evaluate(beyond, Colours{max}, method, Outside::Extrapolate),
                   {byTheBook(*beyond, max, method, true)}, {max});
    }
    // 0.5 + r / 4 - g / 8 + b / 16, which every tetrahedron continues exactly.
    const auto plane = makeLattice(kDomains[0]);
    for (int i = 0; i < 17 * 9 * 5; ++i) {
        const int r = i % 17;
        const int g = i / 17 % 9;
        const int b = i / 17 / 9;
        plane->get(r, g, b).fill(0.5F + float(r - g + b) / 64.0F);
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

TEST_P(Evaluator, BlendsTheFourCornersOfATetrahedron) {
    const auto lut =
        makeLattice({"", {3, 4, 5}, {0.5F, 0.25F, 2.0F}, {-1.0F, 3.0F, 0.125F}, false});
    // Steps of 1/4: fractions are often equal. In steps of 1/4096 they seldom are. Weights are
    // exact; four products and three sums of at most 1 are rounded.
    constexpr double kTolerance = 7 * 0x1p-24;
    std::mt19937 random;
    Colours colours(4000);
    std::vector<std::array<double, 3>> positions(colours.size());
    for (std::size_t i = 0; i < colours.size(); ++i) {
        const int steps = i < 2000 ? 4 : 4096;
        for (unsigned c = 0; c < 3; ++c) {
            const int cells = static_cast<int>(c) + 2;
            const int place = std::uniform_int_distribution<int>(0, cells * steps)(random);
            positions[i][c] = place / double(steps);
            colours[i][c] = float(positions[i][c]) * lut->transform[c][c] + lut->transform[3][c];
        }
    }
    const Colours results = evaluate(lut, colours, Method::Tetrahedral);
    for (std::size_t i = 0; i < colours.size(); ++i) {
        for (unsigned c = 0; c < 3; ++c) {
            ASSERT_NEAR(double(results[i][c]), tetrahedral(*lut, positions[i], c), kTolerance)
                << colours[i];
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

TEST_P(Evaluator, SendsCurvesThroughTheirShapersAndOverTheirDomain) {
    const ol::Shaper shapers[] = {
        {},
        unevenShaper(),
        // Up, down and equal; falling; none; then without end.
        {{{0.0F, 5.0F, 1.0F},
          {0.9F, 4.0F, 1.0F},
          {0.1F, 3.0F, kNaN},
          {0.1F, 2.0F, 1.0F},
          {0.25F, 1.0F, 2.0F},
          {0.5F, 9.0F, 9.0F},
          {0.5F, 9.0F, 9.0F},
          {1.0F, 9.0F, 9.0F}},
         {8.0F, 5.0F, 5.0F}},
        {{{-kInfinity, 0.0F, -0.0F}, {0.3F, 3.0F, 0.0F}, {kInfinity, 0.25F, 0.0F}},
         {3.0F, 3.0F, 3.0F}}};
    Colours colours = oddColours();
    for (int i = -20; i < 250; ++i)
        colours.emplace_back(float(i) / 80.0F, float(i) / 32.0F, float(i) / 100.0F);

    const auto curve = markedCurve(42);  // 41 times 1/41 is not 1 in single precision
    ol::setUnitDomain(*curve, 42, 42, 42);
    for (const ol::Shaper& shaper : shapers) {
        curve->inputShaper = shaper;
        for (const Samples samples : kSamples) {
            fill(*curve, samples);
            for (const Outside outside : kRules) {
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
        }
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

TEST_P(Evaluator, WorksInPlaceOnAnyNumberOfColours) {
    const auto lut = makeLattice(kDomains[4]);
    Colours colours = coloursInside(*lut);
    const Colours odd = oddColours();
    std::copy(odd.begin(), odd.end(), colours.begin() + 100);
    for (const Method method : kMethods) {
        for (const Outside outside : kRules) {
            const Colours expected = evaluate(lut, colours, method, outside);
            const ol::Evaluator evaluator(lut, method, outside);
            for (const std::ptrdiff_t count : {0, 1, 31, 64, 65, 69, 1000, 1999}) {
                Colours inPlace = colours;
                float* const floats = inPlace.data()->data_block();
                evaluator.apply(floats, floats, static_cast<std::size_t>(count));
                Colours mixed = colours;
                std::copy_n(expected.begin(), count, mixed.begin());
                expectSame(inPlace, mixed, colours);
            }
        }
    }
}

TEST_P(Evaluator, ServesThreadsFromTheFirstColourOn) {
    const auto lut = makeLattice(kDomains[1]);
    const Colours colours = coloursInside(*lut);
    const Colours expected = evaluate(lut, colours, Method::Cubic);
    const ol::Evaluator evaluator(lut, Method::Cubic);
    std::array<Colours, 4> results;
    std::array<std::thread, 4> threads;
    for (std::size_t t = 0; t < threads.size(); ++t) {
        Colours& result = results[t];
        threads[t] = std::thread([&] {
            for (int i = 0; i < 4; ++i) {
                result = colours;
                float* const floats = result.data()->data_block();
                evaluator.apply(floats, floats, result.size());
            }
        });
    }
    for (std::thread& thread : threads)
        thread.join();
    for (const Colours& result : results)
        expectSame(result, expected, colours);
}

TEST_P(Evaluator, StaysWithinTheSamplesOfWrongTables) {
    constexpr float kScales[] = {kInfinity, kNaN, 0.0F, -0.5F, 1e-38F, 1e38F, 0.3F};
    constexpr std::array<int, 3> kSizes[] = {{1, 1, 1}, {1, 3, 2}, {4, 2, 3}};
    constexpr float kCounts[] = {0.0F, 1.0F, 2.0F, 99.0F, -5.0F, kNaN, 3e9F};
    for (const auto& sizes : kSizes) {
        for (std::size_t i = 0; i < 2 * std::size(kScales); ++i) {
            const float scale = kScales[i % std::size(kScales)];
            const float count = i < std::size(kCounts) ? kCounts[i] : 3.0F;
            const float offset = kScales[(i + 1) % std::size(kScales)];
            const auto lut =
                makeLattice({"", sizes, {scale, 0.5F, scale}, {offset, offset, 0.0F}, true});
            lut->inputShaper.counts.fill(count);
            lut->outputShaper.counts.fill(count);
            const auto curve = markedCurve(sizes[0]);
            curve->inputShaper = lut->inputShaper;
            curve->outputShaper = lut->outputShaper;
            curve->transform = lut->transform;
            for (const Method method : kMethods) {
                SCOPED_TRACE(testing::Message() << "scale " << scale << ", count " << count
                                                << ", method " << int(method));
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

}  // namespace
