#pragma once

#include <array>
#include <boost/smart_ptr/shared_ptr.hpp>
#include <functional>
#include <vector>

#include "lut/Evaluator.h"

namespace orlith {

/// The inputs that a table tells apart, for each channel: those of its input shaper where it has
/// one, 0 to 1 in front of an output shaper, otherwise those of its points.
struct Domain {
    Orlith::LUT::RGB min;
    Orlith::LUT::RGB max;
};
Domain domainOf(const Orlith::LUT::LUT& lut);

/// What both have; empty where max is below min.
Domain intersection(const Domain& a, const Domain& b);

using UseColour = std::function<void(const Orlith::LUT::RGB& colour)>;

/// Visits the inputs of a table's points; behind a pre-LUT, points evenly spaced along it.
/// @param withHalfWays  visit the places half-way to the next point as well
void forEachInput(const Orlith::LUT::LUT& lut, bool withHalfWays, const UseColour& use);

/// Visits random colours, the same ones each time.
void forEachRandom(const Domain& domain, int count, const UseColour& use);

constexpr int kRandomColours = 10000;

/// How far two looks are apart, on one channel.
struct Difference {
    double largest = 0.0;  ///< infinite where only one of them is a number
    Orlith::LUT::RGB at = Orlith::LUT::RGB(0.0F, 0.0F, 0.0F);  ///< the input where it is
    double mean = 0.0;
    double rootMeanSquare = 0.0;
};
using Differences = std::array<Difference, 3>;

/// The largest of the three channels.
double largestOf(const Differences& differences);

/// Sends colours through two tables and keeps the differences.
class LookComparison {
public:
    LookComparison(const Orlith::LUT::Evaluator& a, const Orlith::LUT::Evaluator& b);

    void add(const Orlith::LUT::RGB& colour);

    /// Of all that was added.
    Differences finish();

private:
    void flush();

    const Orlith::LUT::Evaluator& a_;
    const Orlith::LUT::Evaluator& b_;
    std::vector<float> colours_;  // that wait
    std::vector<float> resultsA_;
    std::vector<float> resultsB_;
    std::uint64_t count_ = 0;
    Differences differences_;
};

/// Adds two results of a channel to its difference; mean and square are sums until the end.
void addDifference(Difference& difference, float a, float b, const Orlith::LUT::RGB& at);

/// Turns the sums into means.
void finishDifferences(Differences& differences, std::uint64_t count);

}  // namespace orlith
