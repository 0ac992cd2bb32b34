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

using Point = std::array<double, 3>;
using Index = std::array<int, 3>;

constexpr Index kLast = {2, 3, 4};  // of 3 x 4 x 5 points

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

/// Calls visit({r, g, b}) for the indices from first to last, both included.
template <class Visit>
void forEachIndex(const Index& first, const Index& last, Visit visit) {
    for (int b = first[2]; b <= last[2]; ++b)
        for (int g = first[1]; g <= last[1]; ++g)
            for (int r = first[0]; r <= last[0]; ++r)
                visit(Index{r, g, b});
}

/// A lattice with a scaled and shifted domain; sample({r, g, b}) gives its samples.
template <class Sample>
boost::shared_ptr<ol::LUT3D> makeLattice(Sample sample) {
    auto lut = markedLattice(kLast[0] + 1, kLast[1] + 1, kLast[2] + 1);
    forEachIndex({0, 0, 0}, kLast, [&](const Index& i) { lut->get(i[0], i[1], i[2]) = sample(i); });
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
        [&](const Index&) { return ol::RGB(value(random), value(random), value(random)); });
}

/// All lattice points, then others between them in steps of 1/1024.
std::vector<Point> pointsInside() {
    std::vector<Point> points;
    forEachIndex({0, 0, 0}, kLast, [&](const Index& i) {
        points.push_back({double(i[0]), double(i[1]), double(i[2])});
    });
    std::mt19937 random;
    const auto between = [&](int last) {
        return std::uniform_int_distribution<int>(0, last * 1024)(random) / 1024.0;
    };
    for (int i = 0; i < 500; ++i)
        points.push_back({between(kLast[0]), between(kLast[1]), between(kLast[2])});
    return points;
}

void expectNear(const ol::RGB& actual, const Point& expected, double tolerance) {
    for (unsigned c = 0; c < 3; ++c)
        EXPECT_NEAR(static_cast<double>(actual[c]), expected[c], tolerance) << "channel " << c;
}

// The references: double precision, each as a sum over all samples, written differently from the
// library's. A kernel tells what sample i of an axis weighs at x.

double tent(double x, int i) {
    return std::max(0.0, 1.0 - std::fabs(x - i));
}

double catmullRom(double x, int i) {
    const double d = std::fabs(x - i);
    if (d < 1.0) return 1.0 - d * d * (2.5 - 1.5 * d);
    return d < 2.0 ? 2.0 - d * (4.0 - d * (2.5 - 0.5 * d)) : 0.0;
}

/// The own axis of a staggered channel: the nearest point and the one above it, blended by the
/// distance from half a cell below the nearest.
double staggeredKernel(double x, int i, int last) {
    const int nearest = static_cast<int>(std::floor(x + 0.5));
    const double share = x - nearest + 0.5;
    return (i == nearest ? 1.0 - share : 0.0) + (i == std::min(nearest + 1, last) ? share : 0.0);
}

/// A sample, or beyond the faces the edge lines of each axis, blended by distance.
double continued(const ol::LUT& lut, const Index& index, unsigned channel) {
    const auto at = [&](Index i) {
        for (unsigned axis = 0; axis < 3; ++axis)
            i[axis] = std::clamp(i[axis], 0, kLast[axis]);
        return static_cast<double>(lut.get(i[0], i[1], i[2])[channel]);
    };
    const double edge = at(index);
    double total = 0.0;
    double sum = 0.0;
    for (unsigned axis = 0; axis < 3; ++axis) {
        const int outside = std::max({-index[axis], index[axis] - kLast[axis], 0});
        Index inward = index;
        inward[axis] = index[axis] < 0 ? 1 : kLast[axis] - 1;
        total += outside;
        sum += outside * (edge + outside * (edge - at(inward)));
    }
    return total == 0.0 ? edge : sum / total;
}

/// @param kernel  weight of an axis, of a sample on it and of a channel
template <class Kernel>
Point weightedSum(const ol::LUT& lut, Kernel kernel) {
    Point sum = {0.0, 0.0, 0.0};
    const Index beyond = {kLast[0] + 2, kLast[1] + 2, kLast[2] + 2};
    for (unsigned c = 0; c < 3; ++c) {
        forEachIndex({-2, -2, -2}, beyond, [&](const Index& i) {
            const double weight = kernel(0U, i[0], c) * kernel(1U, i[1], c) * kernel(2U, i[2], c);
            if (weight != 0.0) sum[c] += weight * continued(lut, i, c);
        });
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
        const auto trilinear = [&](unsigned axis, int i, unsigned) { return tent(x[axis], i); };
        const auto cubic = [&](unsigned axis, int i, unsigned) { return catmullRom(x[axis], i); };
        const auto staggered = [&](unsigned axis, int i, unsigned c) {
            return axis == c ? staggeredKernel(x[axis], i, kLast[axis]) : tent(x[axis], i);
        };
        expectNear(ol::TrilinearInterpolate(*lut, point), weightedSum(*lut, trilinear),
                   kTrilinearError);
        expectNear(ol::LinearStaggeredInterpolate(*lut, point), weightedSum(*lut, staggered),
                   kStaggeredError);
        expectNear(ol::CubicInterpolate(*lut, point), weightedSum(*lut, cubic), kCubicError);
        expectRGB(ol::StepInterpolate(*lut, point), lut->get(int(x[0]), int(x[1]), int(x[2])));
    }
}

TEST(Interpolation, RoundsTrilinearSumsInTheirPrescribedOrder) {
    // Worked out in single precision step by step; blue before red differs in the last place, and
    // so do weights without their detour over the point above.
    const auto lut = markedLattice(2, 2, 2);
    expectRGB(ol::TrilinearInterpolate(*lut, {0.2F, 0.1F, 0.5F}), 0x1.4f8b5ap-8F, 0x1.ae925p-4F,
              0x1.a415f6p-3F);
}

TEST(Interpolation, StepsDownAndStopsAtTheFaces) {
    const auto lut = markedLattice(4, 3, 2);
    expectRGB(ol::StepInterpolate(*lut, {-3.0F, -0.01F, 1.01F}), lut->get(0, 0, 1));
    expectRGB(ol::StepInterpolate(*lut, {99.0F, 3e9F, kInfinity}), lut->get(3, 2, 1));
    expectRGB(ol::StepInterpolate(*lut, {-3e9F, -kInfinity, kNaN}), lut->get(0, 0, 0));
}

TEST(Interpolation, ContinuesTheEdgeBeyondTheLattice) {
    const auto lut = randomLattice();
    forEachIndex({-3, -4, -5}, {6, 7, 8}, [&](const Index& i) {
        SCOPED_TRACE(testing::PrintToString(i));
        // A sample, plus at most five slopes of 2, in eight roundings.
        expectNear(ol::Extrapolate(*lut, i[0], i[1], i[2]),
                   {continued(*lut, i, 0), continued(*lut, i, 1), continued(*lut, i, 2)},
                   8 * 11 * kRound);
    });
    // A third of the red line (-1), two thirds of the green one (-20),.
    const auto plane = makeLattice([](const Index& i) { return markedSample(i[0], i[1], i[2]); });
    EXPECT_NEAR(ol::Extrapolate(*plane, -1, -2, 0)[0], -41.0F / 3.0F / 10000.0F, 1e-8F);
}

struct Method {
    ol::InterpolationMode mode;
    ol::RGB (*interpolate)(const ol::LUT&, const ol::RGB&);
    const char* refusal;
};
const Method kMethods[] = {
    {ol::Step, ol::StepInterpolate, "StepInterpolate: expecting a 3D lut"},
    {ol::LinearStaggered, ol::LinearStaggeredInterpolate,
     "LinearStaggeredInterpolate: expecting a 3D lut"},
    {ol::Trilinear, ol::TrilinearInterpolate, "TrilinearInterpolate: expecting a 3D lut"},
    {ol::Cubic, ol::CubicInterpolate, "CubicInterpolate: expecting a 3D lut"}};

TEST(Evaluation, ChoosesTheMethodByItsMode) {
    const auto lut = randomLattice();
    const ol::RGB point = toInput({0.75, 1.625, 2.25});
    const auto curve = markedCurve(4);
    for (const auto& [mode, interpolate, refusal] : kMethods) {
        for (const bool extrapolate : {false, true})
            expectRGB(lut->interpolate(point, mode, extrapolate), interpolate(*lut, point));
        EXPECT_EQ(messageOf([&, call = interpolate] { call(*curve, point); }), refusal);
    }
    EXPECT_EQ(messageOf([&] { ol::Extrapolate(*curve, 0, 0, 0); }),
              "Extrapolate: expecting a 3D lut");
    for (const unsigned mode : {4U, 0xffffffffU}) {
        EXPECT_EQ(messageOf([&, m = ol::InterpolationMode(mode)] {
                      ol::LUT3D().interpolate(point, m, false);
                  }),
                  "Unknown interpolation mode");
    }
}

TEST(Evaluation, ContinuesALinearTableAlongAStraightLine) {
    const auto plane = [](double r, double g, double b) { return 0.5 + r / 4 - g / 8 + b / 16; };
    const auto lut = makeLattice([&](const Index& i) {
        const auto value = static_cast<float>(plane(i[0], i[1], i[2]));
        return ol::RGB(value, value / 2.0F, -value);
    });
    // One face, an edge and a corner. The slope over a third of an input unit magnifies rounding
    // by three times the distance, which is at most 4.
    for (const Point& x : {Point{3.0, 1.5, 2.0}, Point{1.0, -4.0, 5.0}, Point{-2.0, 7.0, 5.0}}) {
        const double value = plane(x[0], x[1], x[2]);
        expectNear(lut->interpolate(toInput(x), ol::Trilinear, true), {value, value / 2, -value},
                   2 * 3 * 4 * 2 * kTrilinearError);
    }
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
    steps.inputShaper.entries.assign(5, ol::RGB(0.5F, 1.0F, 5.0F));
    steps.inputShaper.entries[0] = ol::RGB(0.0F, 0.0F, 5.0F);
    steps.inputShaper.entries[3][0] = 1.0F;
    steps.inputShaper.entries[4][0] = 2.0F;
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
        ol::LUT3D lut;
        lut.inputShaper.entries.assign(entryCount, ol::RGB(0.25F, 0.5F, 0.125F));
        lut.inputShaper.entries[0].fill(0.0F);
        lut.outputShaper.entries = lut.inputShaper.entries;
        for (const float count : kWild) {
            lut.inputShaper.counts.fill(count);
            lut.outputShaper.counts.fill(count);
            for (const float value : kWild) {
                SCOPED_TRACE(testing::Message()
                             << entryCount << " stored, " << count << " counted, at " << value);
                const ol::RGB shaped = lut.applyShaper({value, value, value});
                for (unsigned c = 0; c < 3; ++c)  // a position, an entry, or no number
                    EXPECT_FALSE(shaped[c] < 0.0F || shaped[c] > 1.0F) << shaped[c];
            }
        }
    }
}

TEST(Evaluation, ReadsNothingBeyondTheLatticeWhateverThePoint) {
    const auto lut = randomLattice();
    const auto curve = markedCurve(3);
    constexpr int kCount = std::size(kWild);
    for (const float scale : {0.5F, 0.0F, -1.0F, kNaN, kInfinity, 1e-38F}) {
        lut->transform[1][1] = lut->transform[3][2] = scale;
        forEachIndex({0, 0, 0}, {kCount - 1, kCount - 1, kCount - 1}, [&](const Index& i) {
            const ol::RGB point(kWild[i[0]], kWild[i[1]], kWild[i[2]]);
            for (const Method& method : kMethods) {
                lut->interpolate(point, method.mode, false);
                lut->interpolate(point, method.mode, true);
            }
            EXPECT_LE(std::fabs(ol::StepInterpolate(*lut, point)[0]), 1.0F);
            EXPECT_FALSE(curve->interpolate(point, ol::Step, false)[1] > 0.1002F);
        });
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
    const ol::RGB zeros(0.0F, 0.0F, 0.0F);
    const ol::RGB point(0.5F, -9.0F, kInfinity);
    for (const auto& [mode, interpolate, refusal] : kMethods) {
        for (const ol::LUT3D* const lut : {&empty, &flat}) {
            expectRGB(lut->interpolate(point, mode, true), zeros);
            expectRGB(interpolate(*lut, point), zeros);
        }
        expectNear(one.interpolate({0.3F, -9.0F, 9.0F}, mode, false), {0.25, 0.5, 0.75}, 1e-6);
    }
    expectRGB(ol::Extrapolate(empty, 1, -1, 0), zeros);
    expectRGB(ol::LUT1D().interpolate(point, ol::Step, false), zeros);
    expectRGB(markedCurve(1)->interpolate({0.5F, kNaN, 9.0F}, ol::Step, false), 0.0F, 0.1F, 0.2F);
}

}  // namespace
