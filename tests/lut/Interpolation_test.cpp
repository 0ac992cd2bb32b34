#include "lut/Interpolation.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <cmath>
#include <limits>
#include <random>

#include "tests/support/Tables.h"

namespace {

using namespace test;

constexpr float kNaN = std::numeric_limits<float>::quiet_NaN();
constexpr float kInfinity = std::numeric_limits<float>::infinity();
constexpr double kRound = 0x1p-24;  // largest relative error of one single-precision operation

constexpr ol::InterpolationMode kModes[] = {ol::Step, ol::LinearStaggered, ol::Trilinear,
                                            ol::Cubic};

using Point = std::array<double, 3>;
using Index = std::array<int, 3>;

constexpr Index kSizes = {3, 4, 5};

// Powers of two and short binary fractions: between input and lattice coordinates nothing is
// rounded, so that tolerances are those of the interpolation alone.
constexpr Point kScale = {0.5, 0.25, 2.0};
constexpr Point kOffset = {-1.0, 3.0, 0.125};

ol::RGB toInput(const Point& x) {
    ol::RGB point;
    for (unsigned c = 0; c < 3; ++c)
        point[c] = static_cast<float>(x[c] * kScale[c] + kOffset[c]);
    return point;
}

/// A lattice of kSizes with a scaled and shifted domain; sample(r, g, b) gives its samples.
template <class Sample>
boost::shared_ptr<ol::LUT3D> makeLattice(Sample sample) {
    auto lut = markedLattice(kSizes[0], kSizes[1], kSizes[2]);
    for (int b = 0; b < kSizes[2]; ++b) {
        for (int g = 0; g < kSizes[1]; ++g) {
            for (int r = 0; r < kSizes[0]; ++r)
                lut->get(r, g, b) = sample(r, g, b);
        }
    }
    for (unsigned c = 0; c < 3; ++c) {
        lut->transform[c][c] = static_cast<float>(kScale[c]);
        lut->transform[3][c] = static_cast<float>(kOffset[c]);
    }
    return lut;
}

boost::shared_ptr<ol::LUT3D> randomLattice() {
    std::mt19937 random;
    std::uniform_real_distribution<float> value(-1.0F, 1.0F);
    return makeLattice(
        [&](int, int, int) { return ol::RGB(value(random), value(random), value(random)); });
}

/// 0.5 + r / 4 - g / 8 + b / 16, half as much and its negative: exact at every short fraction.
Point plane(const Point& x) {
    const double value = 0.5 + x[0] / 4.0 - x[1] / 8.0 + x[2] / 16.0;
    return {value, value / 2.0, -value};
}

constexpr Point kPlaneSlope = {1.0 / 4.0, -1.0 / 16.0, -1.0 / 16.0};  // own axis of each channel

boost::shared_ptr<ol::LUT3D> planeLattice() {
    return makeLattice([](int r, int g, int b) {
        const Point value = plane({double(r), double(g), double(b)});
        return ol::RGB(float(value[0]), float(value[1]), float(value[2]));
    });
}

/// Points between the given lattice coordinates, in steps of 1/1024.
std::vector<Point> randomPoints(const Point& from, const Point& to, int count) {
    std::mt19937 random;
    std::vector<Point> points;
    for (int i = 0; i < count; ++i) {
        Point point;
        for (unsigned c = 0; c < 3; ++c) {
            const int steps = static_cast<int>((to[c] - from[c]) * 1024.0);
            point[c] = from[c] + std::uniform_int_distribution<int>(0, steps)(random) / 1024.0;
        }
        points.push_back(point);
    }
    return points;
}

const Point kLast = {kSizes[0] - 1.0, kSizes[1] - 1.0, kSizes[2] - 1.0};

std::vector<Point> pointsInside() {
    return randomPoints({0.0, 0.0, 0.0}, kLast, 500);
}

void expectNear(const ol::RGB& actual, const Point& expected, double tolerance) {
    for (unsigned c = 0; c < 3; ++c)
        EXPECT_NEAR(static_cast<double>(actual[c]), expected[c], tolerance) << "channel " << c;
}

// The references: double precision, each formula written differently from the library's.

double at(const ol::LUT& lut, Index index, unsigned channel) {
    for (unsigned axis = 0; axis < 3; ++axis)
        index[axis] = std::min(std::max(index[axis], 0), kSizes[axis] - 1);
    return static_cast<double>(lut.get(index[0], index[1], index[2])[channel]);
}

/// Sums every sample of the lattice times its tent, which is 1 at the sample and 0 a cell away.
template <class Weight>
Point weightedSum(const ol::LUT& lut, Weight weight) {
    Point sum = {0.0, 0.0, 0.0};
    for (int b = 0; b < kSizes[2]; ++b) {
        for (int g = 0; g < kSizes[1]; ++g) {
            for (int r = 0; r < kSizes[0]; ++r) {
                for (unsigned c = 0; c < 3; ++c)
                    sum[c] += weight({r, g, b}, c) * at(lut, {r, g, b}, c);
            }
        }
    }
    return sum;
}

double tent(double x, int index) {
    return std::max(0.0, 1.0 - std::fabs(x - index));
}

Point trilinear(const ol::LUT& lut, const Point& x) {
    return weightedSum(lut, [&](const Index& i, unsigned) {
        return tent(x[0], i[0]) * tent(x[1], i[1]) * tent(x[2], i[2]);
    });
}

/// As trilinear, but each channel's own axis blends the nearest point and the one above it, by the
/// distance from half a cell below the nearest.
Point staggered(const ol::LUT& lut, const Point& x) {
    return weightedSum(lut, [&](const Index& i, unsigned channel) {
        double weight = 1.0;
        for (unsigned axis = 0; axis < 3; ++axis) {
            if (axis != channel) {
                weight *= tent(x[axis], i[axis]);
                continue;
            }
            const int nearest = static_cast<int>(std::floor(x[axis] + 0.5));
            const int above = std::min(nearest + 1, kSizes[axis] - 1);
            const double share = x[axis] - nearest + 0.5;
            weight *= (i[axis] == nearest ? 1.0 - share : 0.0) + (i[axis] == above ? share : 0.0);
        }
        return weight;
    });
}

/// A sample, or beyond the faces the edge lines of each axis, blended by distance.
double continued(const ol::LUT& lut, const Index& index, unsigned channel) {
    double total = 0.0;
    double sum = 0.0;
    const double edge = at(lut, index, channel);
    for (unsigned axis = 0; axis < 3; ++axis) {
        const int below = std::max(-index[axis], 0);
        const int above = std::max(index[axis] - (kSizes[axis] - 1), 0);
        Index inward = index;
        inward[axis] = below > 0 ? 1 : kSizes[axis] - 2;
        const int outside = below + above;
        total += outside;
        sum += outside * (edge + outside * (edge - at(lut, inward, channel)));
    }
    return total == 0.0 ? edge : sum / total;
}

/// The Catmull-Rom spline as weights of the four points around.
Point cubic(const ol::LUT& lut, const Point& x) {
    std::array<std::array<double, 4>, 3> weights;
    Index first;
    for (unsigned axis = 0; axis < 3; ++axis) {
        const double t = x[axis] - std::floor(x[axis]);
        weights[axis] = {-t * (1 - t) * (1 - t) / 2, 1 - t * t * (5 - 3 * t) / 2,
                         t * (1 + t * (4 - 3 * t)) / 2, -t * t * (1 - t) / 2};
        first[axis] = static_cast<int>(std::floor(x[axis])) - 1;
    }
    Point sum = {0.0, 0.0, 0.0};
    for (int r = 0; r < 4; ++r) {
        for (int g = 0; g < 4; ++g) {
            for (int b = 0; b < 4; ++b) {
                const double weight =
                    weights[0][unsigned(r)] * weights[1][unsigned(g)] * weights[2][unsigned(b)];
                for (unsigned c = 0; c < 3; ++c)
                    sum[c] +=
                        weight * continued(lut, {first[0] + r, first[1] + g, first[2] + b}, c);
            }
        }
    }
    return sum;
}

// Rounding bounds for samples from -1 to 1. Trilinear: weights are exact, each of the eight terms
// passes three products and at most eight sums, and weights add up to 1. Staggered: three blends
// of five roundings. Cubic: continued samples reach 3, a spline's sum 12 times that in eight
// roundings; three passes, each of which enlarges errors by at most 1.25.
constexpr double kTrilinearError = 11 * kRound;
constexpr double kStaggeredError = 15 * kRound;
constexpr double kCubicError = 3 * 12 * 8 * 3 * 1.25 * 1.25 * kRound;

TEST(Interpolation, FollowsItsFormulasAnywhereInside) {
    const auto lut = randomLattice();
    for (const Point& x : pointsInside()) {
        SCOPED_TRACE(testing::PrintToString(x));
        const ol::RGB point = toInput(x);
        expectNear(ol::TrilinearInterpolate(*lut, point), trilinear(*lut, x), kTrilinearError);
        expectNear(ol::LinearStaggeredInterpolate(*lut, point), staggered(*lut, x),
                   kStaggeredError);
        expectNear(ol::CubicInterpolate(*lut, point), cubic(*lut, x), kCubicError);
        expectRGB(ol::StepInterpolate(*lut, point), lut->get(int(x[0]), int(x[1]), int(x[2])));
    }
}

TEST(Interpolation, GivesTheSampleAtALatticePoint) {
    const auto lut = randomLattice();
    for (int b = 0; b < kSizes[2]; ++b) {
        for (int g = 0; g < kSizes[1]; ++g) {
            for (int r = 0; r < kSizes[0]; ++r) {
                const ol::RGB point = toInput({double(r), double(g), double(b)});
                const ol::RGB& sample = lut->get(r, g, b);
                expectRGB(ol::StepInterpolate(*lut, point), sample);
                expectRGB(ol::TrilinearInterpolate(*lut, point), sample);
                expectRGB(ol::CubicInterpolate(*lut, point), sample);
                expectRGB(ol::Extrapolate(*lut, r, g, b), sample);
            }
        }
    }
    // Half a cell off on each channel's own axis; the last point has none above it.
    const auto planes = planeLattice();
    expectNear(ol::LinearStaggeredInterpolate(*planes, toInput({1.0, 1.0, 1.0})),
               {0.6875 + 0.125, 0.6875 / 2 - 1.0 / 32.0, -0.6875 - 1.0 / 32.0}, 0.0);
    expectRGB(ol::LinearStaggeredInterpolate(*lut, toInput(kLast)), lut->get(2, 3, 4));
}

TEST(Interpolation, ReproducesLinearTables) {
    const auto lut = planeLattice();
    for (const Point& x : pointsInside())
        expectNear(ol::TrilinearInterpolate(*lut, toInput(x)), plane(x), 2 * kTrilinearError);
    // Where the neighbourhood leaves the lattice on the red axis alone.
    for (const Point& x : randomPoints({0.0, 1.0, 1.0}, {2.0, 2.0, 3.0}, 200))
        expectNear(ol::CubicInterpolate(*lut, toInput(x)), plane(x), kCubicError);
    // Below the last point's half cell; shifted by half a cell on the own axis.
    for (const Point& x : randomPoints({0.0, 0.0, 0.0}, {1.25, 2.25, 3.25}, 200)) {
        Point expected = plane(x);
        for (unsigned c = 0; c < 3; ++c)
            expected[c] += kPlaneSlope[c] / 2.0;
        expectNear(ol::LinearStaggeredInterpolate(*lut, toInput(x)), expected, 2 * kStaggeredError);
    }
}

TEST(Interpolation, StepsDownAndStopsAtTheFaces) {
    const auto lut = markedLattice(4, 3, 2);
    expectRGB(ol::StepInterpolate(*lut, {1.99F, 0.0F, 0.0F}), lut->get(1, 0, 0));
    expectRGB(ol::StepInterpolate(*lut, {-3.0F, -0.01F, 1.01F}), lut->get(0, 0, 1));
    expectRGB(ol::StepInterpolate(*lut, {99.0F, 3e9F, kInfinity}), lut->get(3, 2, 1));
    expectRGB(ol::StepInterpolate(*lut, {-3e9F, -kInfinity, kNaN}), lut->get(0, 0, 0));
}

TEST(Interpolation, ContinuesTheEdgeBeyondTheLattice) {
    const auto lut = makeLattice([](int r, int g, int b) {
        return ol::RGB(float(r), float(r + 10 * g + 100 * b), float(r * r));
    });
    expectRGB(ol::Extrapolate(*lut, -1, 0, 0), -1.0F, -1.0F, -1.0F);
    expectRGB(ol::Extrapolate(*lut, 4, 3, 4), 4.0F, 434.0F, 10.0F);  // r^2: 4 and twice 4 - 1
    // Two axes: a third of the red line (-1), two thirds of the green one (-20).
    EXPECT_NEAR(ol::Extrapolate(*lut, -1, -2, 0)[1], -41.0F / 3.0F, 1e-5F);
    // Three axes, all above: weights 1/7, 2/7 and 4/7 of 433, 452 and 832.
    EXPECT_NEAR(ol::Extrapolate(*lut, 3, 5, 8)[1], (433.0F + 2 * 452.0F + 4 * 832.0F) / 7.0F,
                1e-3F);
}

TEST(Interpolation, RefusesCurves) {
    const auto curve = markedCurve(4);
    const ol::RGB point(0.5F, 0.5F, 0.5F);
    EXPECT_EQ(messageOf([&] { ol::StepInterpolate(*curve, point); }),
              "StepInterpolate: expecting a 3D lut");
    EXPECT_EQ(messageOf([&] { ol::TrilinearInterpolate(*curve, point); }),
              "TrilinearInterpolate: expecting a 3D lut");
    EXPECT_EQ(messageOf([&] { ol::CubicInterpolate(*curve, point); }),
              "CubicInterpolate: expecting a 3D lut");
    EXPECT_EQ(messageOf([&] { ol::LinearStaggeredInterpolate(*curve, point); }),
              "LinearStaggeredInterpolate: expecting a 3D lut");
    EXPECT_EQ(messageOf([&] { ol::TetrahedralInterpolate(*curve, point); }),
              "TetrahedralInterpolate: expecting a 3D lut");
    EXPECT_EQ(messageOf([&] { ol::Extrapolate(*curve, 0, 0, 0); }),
              "Extrapolate: expecting a 3D lut");
}

TEST(Evaluation, ChoosesTheMethodByItsMode) {
    const auto lut = randomLattice();
    const ol::RGB point = toInput({0.75, 1.625, 2.25});
    for (const bool extrapolate : {false, true}) {
        expectRGB(lut->interpolate(point, ol::Step, extrapolate), ol::StepInterpolate(*lut, point));
        expectRGB(lut->interpolate(point, ol::LinearStaggered, extrapolate),
                  ol::LinearStaggeredInterpolate(*lut, point));
        expectRGB(lut->interpolate(point, ol::Trilinear, extrapolate),
                  ol::TrilinearInterpolate(*lut, point));
        expectRGB(lut->interpolate(point, ol::Cubic, extrapolate),
                  ol::CubicInterpolate(*lut, point));
    }
    for (const unsigned mode : {4U, 0xffffffffU}) {
        EXPECT_EQ(messageOf([&, m = ol::InterpolationMode(mode)] {
                      ol::LUT3D().interpolate(point, m, false);
                  }),
                  "Unknown interpolation mode");
    }
}

TEST(Evaluation, ContinuesALinearTableAlongAStraightLine) {
    const auto lut = planeLattice();
    // One face, an edge and a corner. The slope over a third of an input unit magnifies rounding
    // by three times the distance, which is at most 4.
    for (const Point& x : {Point{3.0, 1.5, 2.0}, Point{1.0, -4.0, 5.0}, Point{-2.0, 7.0, 5.0}}) {
        const ol::RGB point = toInput(x);
        expectNear(lut->interpolate(point, ol::Trilinear, true), plane(x),
                   2 * 3 * 4 * 2 * kTrilinearError);
    }
    const auto identity = markedLattice(5, 5, 5);
    ol::setUnitDomain(*identity, 5, 5, 5);
    for (int r = 0; r < 5; ++r)
        identity->get(r, 2, 2) = ol::RGB(float(r) / 4.0F, 0.5F, 0.5F);
    expectNear(identity->interpolate({1.5F, 0.5F, 0.5F}, ol::Trilinear, true), {1.5, 0.5, 0.5},
               1e-6);
}

TEST(Evaluation, MeasuresTheSlopeOverOneRedCellWhateverTheAxis) {
    // Only the last of nine blue planes is 1, so that a third of the axis back it is 0: slope 3.
    ol::LUT3D lut;
    lut.resize(3, 2, 9);
    ol::setUnitDomain(lut, 3, 2, 9);
    for (int g = 0; g < 2; ++g) {
        for (int r = 0; r < 3; ++r)
            lut.get(r, g, 8).fill(1.0F);
    }
    expectNear(lut.interpolate({0.5F, 0.5F, 1.5F}, ol::Trilinear, true), {2.5, 2.5, 2.5}, 1e-6);
    // The last point itself is inside: no slope, which would be infinite times 0 here.
    lut.get(2, 1, 8).fill(kInfinity);
    expectRGB(lut.interpolate({1.0F, 1.0F, 1.0F}, ol::Step, true), kInfinity, kInfinity, kInfinity);
}

TEST(Evaluation, SendsAColourThroughBothShapers) {
    ol::LUT3D lut;
    expectRGB(lut.applyShaper({-5.0F, 0.3F, kInfinity}), -5.0F, 0.3F, kInfinity);

    // Three breakpoints on red, two on green, four on blue.
    lut.inputShaper.entries = {
        {0.0F, -1.0F, 0.0F}, {0.5F, 3.0F, 0.25F}, {1.0F, 9.0F, 0.5F}, {9.0F, 9.0F, 8.0F}};
    lut.inputShaper.counts = {3.0F, 2.0F, 4.0F};
    expectRGB(lut.applyShaper({0.25F, 1.0F, 0.0F}), 0.25F, 0.5F, 0.0F);
    expectRGB(lut.applyShaper({0.75F, 2.0F, 0.375F}), 0.75F, 0.75F, 1.5F / 3.0F);
    expectRGB(lut.applyShaper({-1.0F, -1.0F, 9.0F}), 0.0F, 0.0F, 1.0F);
    expectRGB(lut.applyShaper({1.0F, 3.0F, 4.25F}), 1.0F, 1.0F, 2.5F / 3.0F);

    // Equal breakpoints: the last of them counts.
    ol::LUT3D steps;
    steps.inputShaper.entries = {{0.0F, 0.0F, 5.0F},
                                 {0.5F, 1.0F, 5.0F},
                                 {0.5F, 1.0F, 5.0F},
                                 {1.0F, 1.0F, 5.0F},
                                 {2.0F, 1.0F, 5.0F}};
    steps.inputShaper.counts.fill(5.0F);
    expectRGB(steps.applyShaper({0.5F, 1.0F, 5.0F}), 0.5F, 1.0F, 0.0F);

    lut.outputShaper.entries = {{0.0F, 10.0F, 0.0F}, {8.0F, 20.0F, 1.0F}, {0.0F, 40.0F, 5.0F}};
    lut.outputShaper.counts = {2.0F, 3.0F, 3.0F};
    expectRGB(lut.applyShaper({0.25F, 1.0F, 9.0F}), 2.0F, 20.0F, 5.0F);
    expectRGB(lut.applyShaper({0.75F, 2.0F, -1.0F}), 6.0F, 30.0F, 0.0F);

    lut.inputShaper.entries.clear();  // the second alone
    expectRGB(lut.applyShaper({0.5F, -0.5F, 1.5F}), 4.0F, 10.0F, 5.0F);

    const ol::Shaper shaper = lut.outputShaper;
    const auto shaped = randomLattice();
    const ol::RGB point(0.1F, 0.2F, 0.3F);
    shaped->outputShaper = shaper;
    expectRGB(shaped->interpolate(point, ol::Step, false),
              ol::StepInterpolate(*shaped, shaped->applyShaper(point)));
}

TEST(Evaluation, LooksACurveUpFromZeroToOne) {
    const auto curve = markedCurve(5);
    curve->transform[0][0] = 7.0F;  // neither transform nor shapers count
    curve->inputShaper.entries.assign(2, ol::RGB(3.0F, 3.0F, 3.0F));
    curve->inputShaper.counts = {2.0F, 2.0F, 2.0F};
    curve->outputShaper = curve->inputShaper;
    for (const bool extrapolate : {false, true}) {
        const ol::RGB ends = curve->interpolate({1.2F, -0.3F, 0.5F}, ol::Cubic, extrapolate);
        expectRGB(ends, markedSample(4, 0, 0)[0], markedSample(0, 0, 0)[1],
                  markedSample(2, 0, 0)[2]);
    }
    expectRGB(curve->interpolate({-kInfinity, kInfinity, 3e9F}, ol::Step, false),
              markedSample(0, 0, 0)[0], markedSample(4, 0, 0)[1], markedSample(4, 0, 0)[2]);
    const ol::RGB between = curve->interpolate({0.375F, 0.375F, 1.0F}, ol::Step, false);
    expectNear(between, {0.00015, 0.10015, 0.2004}, kRound);
}

/// Points and numbers that lead astray.
const float kWild[] = {0.0F,          0.5F,        1.0F,     -3.0F,      2.5F, 100.0F,
                       2147483648.0F, -1e30F,      1e30F,    -kInfinity, kNaN, kInfinity,
                       1e-40F,        16777217.0F, -2147e6F, 1.0F / 3.0F};

TEST(Evaluation, ReadsNothingBeyondAShaperWhateverItsCounts) {
    for (std::size_t entryCount = 1; entryCount <= 3; ++entryCount) {
        std::vector<ol::RGB> entries;
        for (std::size_t i = 0; i < entryCount; ++i)
            entries.emplace_back(0.25F * float(i), 0.5F * float(i), 0.125F);
        for (const float count : kWild) {
            ol::LUT3D in;
            in.inputShaper.entries = entries;
            in.inputShaper.counts.fill(count);
            ol::LUT3D out;
            out.outputShaper = in.inputShaper;
            for (const float value : kWild) {
                SCOPED_TRACE(testing::Message()
                             << entryCount << " stored, " << count << " counted, at " << value);
                const ol::RGB position = in.applyShaper({value, value, value});
                const ol::RGB shaped = out.applyShaper({value, value, value});
                for (unsigned c = 0; c < 3; ++c) {  // a position, an entry, or no number
                    EXPECT_FALSE(position[c] < 0.0F || position[c] > 1.0F) << position[c];
                    EXPECT_FALSE(shaped[c] < 0.0F || shaped[c] > 1.0F) << shaped[c];
                }
            }
        }
    }
}

TEST(Evaluation, ReadsNothingBeyondTheLatticeWhateverThePoint) {
    const auto lut = randomLattice();
    const auto curve = markedCurve(3);
    for (const float scale : {0.5F, 0.0F, -1.0F, kNaN, kInfinity, 1e-38F}) {
        lut->transform[1][1] = scale;
        lut->transform[3][2] = scale;
        for (const float r : kWild) {
            for (const float g : kWild) {
                for (const float b : kWild) {
                    const ol::RGB point(r, g, b);
                    for (const ol::InterpolationMode mode : kModes) {
                        EXPECT_NO_THROW(lut->interpolate(point, mode, false));
                        EXPECT_NO_THROW(lut->interpolate(point, mode, true));
                    }
                    EXPECT_LE(std::fabs(ol::StepInterpolate(*lut, point)[0]), 1.0F);
                    EXPECT_NO_THROW(curve->interpolate(point, ol::Step, false));
                }
            }
        }
    }
    constexpr int kMost = std::numeric_limits<int>::max();
    constexpr int kLeast = std::numeric_limits<int>::min();
    EXPECT_NO_THROW(ol::Extrapolate(*lut, kLeast, kMost, kLeast));
    EXPECT_NO_THROW(ol::Extrapolate(*lut, kMost, kLeast, kMost));
}

TEST(Evaluation, GivesZerosWithoutSamplesAndOnePointsValueEverywhere) {
    ol::LUT3D empty;
    ol::LUT3D flat;  // sides whose product overflows before the zero comes in
    flat.resize(65536, 65536, 0);
    ol::LUT3D one;
    one.resize(1);
    one.get(0, 0, 0) = ol::RGB(0.25F, 0.5F, 0.75F);
    ol::setUnitDomain(one, 1, 1, 1);
    for (const ol::InterpolationMode mode : kModes) {
        for (const bool extrapolate : {false, true}) {
            expectRGB(empty.interpolate({0.5F, -9.0F, kInfinity}, mode, extrapolate), 0.0F, 0.0F,
                      0.0F);
            expectRGB(flat.interpolate({0.5F, -9.0F, 9.0F}, mode, extrapolate), 0.0F, 0.0F, 0.0F);
        }
        expectNear(one.interpolate({0.3F, -9.0F, 9.0F}, mode, false), {0.25, 0.5, 0.75}, 1e-6);
    }
    expectRGB(ol::Extrapolate(empty, 1, -1, 0), 0.0F, 0.0F, 0.0F);
    expectRGB(ol::TrilinearInterpolate(flat, {0.5F, 0.5F, 0.5F}), 0.0F, 0.0F, 0.0F);
    expectRGB(ol::LUT1D().interpolate({0.5F, 0.5F, 0.5F}, ol::Step, false), 0.0F, 0.0F, 0.0F);
    expectRGB(markedCurve(1)->interpolate({0.5F, kNaN, 9.0F}, ol::Step, false), 0.0F, 0.1F, 0.2F);

    // One point on green only.
    ol::LUT3D slab;
    slab.resize(2, 1, 2);
    ol::setUnitDomain(slab, 2, 1, 2);
    slab.get(1, 0, 0).fill(1.0F);
    slab.get(1, 0, 1).fill(1.0F);
    expectRGB(slab.interpolate({0.25F, 0.7F, 0.5F}, ol::Trilinear, false), 0.25F, 0.25F, 0.25F);
}

}  // namespace
