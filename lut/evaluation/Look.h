#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <vector>

#include "lut/Evaluator.h"
#include "lut/evaluation/Range.h"

namespace Orlith::LUT {

/// The inputs that a table tells apart, for each channel: those of its input shaper where it has
/// one, 0 to 1 in front of an output shaper, otherwise those of its points.
Range inputRangeOf(const LUT& lut);

/// Inputs along red, green and blue.
using ChannelInputs = std::array<std::vector<float>, 3>;

/// The inputs of a table's points along each channel; behind a pre-LUT, places evenly spaced along
/// it.
/// @param stepsPerCell  1: the points alone; 2: the places half-way to the next as well; and so on
ChannelInputs inputsAlong(const LUT& lut, int stepsPerCell);

using UseColour = std::function<void(const RGB& colour)>;

/// Visits the colours that inputsAlong spans.
/// @param withHalfWays  visit the places half-way to the next point as well
void forEachInput(const LUT& lut, bool withHalfWays, const UseColour& use);

/// Visits random colours, the same ones each time.
void forEachRandom(const Range& range, int count, const UseColour& use);

constexpr int kRandomColours = 10000;

/// How far two looks are apart, on one channel.
struct Difference {
    double largest = 0.0;            ///< infinite where only one of them is a number
    RGB at = RGB(0.0F, 0.0F, 0.0F);  ///< the input where it is
    double mean = 0.0;
    double rootMeanSquare = 0.0;
};
using Differences = std::array<Difference, 3>;

/// The largest of the three channels.
double largestOf(const Differences& differences);

/// Sends so many colours, triples red, green, blue, through something in place.
using ColourWay = std::function<void(float* rgb, std::size_t colourCount)>;

/// Sends colours through two looks and keeps the differences.
class LookComparison {
public:
    LookComparison(ColourWay a, ColourWay b);
    /// Of two tables; their Evaluators outlive this.
    LookComparison(const Evaluator& a, const Evaluator& b);

    void add(const RGB& colour);

    /// Of all that was added.
    Differences finish();

private:
    void flush();

    const ColourWay a_;
    const ColourWay b_;
    std::vector<float> colours_;  // that wait
    std::vector<float> resultsA_;
    std::vector<float> resultsB_;
    std::uint64_t count_ = 0;
    Differences differences_;
};

/// How far two tables are apart as people see them: at the points of the larger one and at 10,000
/// random colours, half of them of each table's domain.
Differences compareLooks(const LUT& a, ColourWay lookA, const LUT& b, ColourWay lookB);

/// Adds two results of a channel to its difference; mean and square are sums until the end.
void addDifference(Difference& difference, float a, float b, const RGB& at);

/// Turns the sums into means.
void finishDifferences(Differences& differences, std::uint64_t count);

}  // namespace Orlith::LUT
