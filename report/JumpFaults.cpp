#include "report/JumpFaults.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <limits>
#include <map>

#include "report/Lines.h"

namespace report {
namespace {

namespace ol = Orlith::LUT;

// A step of a hundredth is seen as an edge in a smooth ramp; and rounding to 8 bits, which moves
// two neighbours by half a code each, may set two steps apart by 2 / 255.
constexpr double kJumpLimit = 0.01;

// Of a straight line's step from point to point: looks that are made of straight pieces (saturation
// by the largest and the smallest channel) have such steps where two bends share a cell.
constexpr double kJumpLimitInSteps = 0.5;

// A jump is at least so many times the change from step to step beside it, on the calmer side: a
// steep curve's steps change by themselves.
constexpr double kJumpOverBend = 2.0;

// Jumps in neighbouring parts of the lattice, of so many along the longest side, are one place; of
// more places than a person looks at the further ones are counted with the last.
constexpr int kParts = 16;
constexpr std::size_t kMostPlaces = 8;

// Interpolated and rounded equal samples: of the extent.
constexpr double kSameLevel = 1e-6;

/// A jump between two points, or, where it goes back at once, at one.
struct Jump {
    double amount = 0.0;
    Point from = {0, 0, 0};
    Point to = {0, 0, 0};
    std::array<bool, 3> channels = {false, false, false};
};

/// The samples of a channel along a line, and the steps from one to the next.
class Row {
public:
    void read(const Line& line, unsigned channel, const FiniteRange& range) {
        least_ = static_cast<double>(range.min[channel]);
        most_ = static_cast<double>(range.max[channel]);
        tolerance_ = kSameLevel * range.extent();
        values_.resize(static_cast<std::size_t>(line.pointCount));
        for (int i = 0; i < line.pointCount; ++i)
            values_[static_cast<std::size_t>(i)] = static_cast<double>(line.value(i, channel));
    }

    int stepCount() const { return static_cast<int>(values_.size()) - 1; }
    double value(int i) const { return values_[static_cast<std::size_t>(i)]; }
    double step(int i) const { return value(i + 1) - value(i); }

    /// How far step i lies beyond the two steps on each side of it, upward or, negative, downward;
    /// 0 where there is none on one side. A bend's steps lie between those beside them.
    double beyond(int i) const {
        if (i < 1 || i + 1 >= stepCount()) return 0.0;
        const double here = step(i);
        double least = std::numeric_limits<double>::infinity();
        double most = -least;
        if (!std::isfinite(step(i - 1)) || !std::isfinite(step(i + 1))) return 0.0;
        for (int other = std::max(i - 2, 0); other <= std::min(i + 2, stepCount() - 1); ++other) {
            if (other == i || !std::isfinite(step(other))) continue;
            least = std::min(least, step(other));
            most = std::max(most, step(other));
        }
        return here > most ? here - most : here < least ? here - least : 0.0;
    }

    /// The change from step to step beside step i, on the calmer side.
    double bendBeside(int i) const {
        double bend = std::numeric_limits<double>::infinity();
        if (i >= 2) bend = std::min(bend, std::fabs(step(i - 1) - step(i - 2)));
        if (i + 2 < stepCount()) bend = std::min(bend, std::fabs(step(i + 2) - step(i + 1)));
        return std::isfinite(bend) ? bend : 0.0;
    }

    /// Whether step i, or the one before it, leaves a clip for good. A wide gamut is clipped before
    /// a display's power function: its saturated colours begin with a steep step, and bright ones
    /// may go from one end of the range to the other within a cell.
    bool leavesClip(int i) const { return leavesClip(i, 1) || leavesClip(i, -1); }

private:
    /// 0 and 1 too: a table that is clipped there may go beyond elsewhere.
    bool isEnd(double value) const {
        for (const double end : {least_, most_, 0.0, 1.0}) {
            if (std::fabs(value - end) <= tolerance_) return true;
        }
        return false;
    }

    /// Whether a point is at such an end, and the one outside of it too, if there is one.
    bool isClipped(int point, int outside) const {
        const auto count = static_cast<int>(values_.size());
        if (point < 0 || point >= count || !isEnd(value(point))) return false;
        return outside < 0 || outside >= count || isEnd(value(outside));
    }

    /// @param ahead  1: the clip is before the step; -1: behind it
    bool leavesClip(int i, int ahead) const {
        const int from = ahead > 0 ? i : i + 1;
        if (!isClipped(from, from - ahead) && !isClipped(from - ahead, from - 2 * ahead))
            return false;
        const int next = i + ahead;
        const double goesOn =
            next >= 0 && next < stepCount() ? step(next) * (step(i) < 0 ? -1 : 1) : 0.0;
        return goesOn > tolerance_ ||
               (goesOn >= -tolerance_ && isEnd(value(ahead > 0 ? i + 1 : i)));
    }

    std::vector<double> values_;
    double least_ = 0.0;
    double most_ = 0.0;
    double tolerance_ = 0.0;
};

/// The step of a row that jumps most, or -1.
int largestJump(const Row& row, double extent) {
    const double straight = extent / std::max(row.stepCount(), 1);
    const double limit = std::max(kJumpLimit * extent, kJumpLimitInSteps * straight);
    int largest = -1;
    double amount = limit;
    for (int i = 1; i + 1 < row.stepCount(); ++i) {
        const double beyond = std::fabs(row.beyond(i));
        if (beyond <= amount || beyond <= kJumpOverBend * row.bendBeside(i)) continue;
        if (row.leavesClip(i)) continue;
        largest = i;
        amount = beyond;
    }
    return largest;
}

/// Where step i of a row jumps: at one point if the step beside it goes most of the way back.
Jump jumpAt(const Line& line, const Row& row, int i) {
    const double amount = row.beyond(i);
    const auto goesBack = [&](int other) { return row.beyond(other) / amount < -0.5; };
    Jump jump;
    jump.amount = std::fabs(amount);
    jump.from = line.point(goesBack(i + 1) ? i + 1 : i);
    jump.to = line.point(!goesBack(i + 1) && goesBack(i - 1) ? i : i + 1);
    return jump;
}

/// The largest jump of each row of a table that has one.
std::vector<Jump> jumpsOf(const ol::LUT& lut, const FiniteRange& range) {
    std::vector<Jump> jumps;
    Row row;
    for (unsigned axis = 0; axis < (lut.is1D() ? 1U : 3U); ++axis) {
        forEachLine(lut, axis, [&](const Line& line) {
            Jump largest;
            std::array<bool, 3> channels = {false, false, false};
            for (unsigned c = 0; c < 3; ++c) {
                row.read(line, c, range);
                const int step = largestJump(row, range.extent());
                if (step < 0) continue;
                channels[c] = true;
                const Jump jump = jumpAt(line, row, step);
                if (jump.amount > largest.amount) largest = jump;
            }
            largest.channels = channels;
            if (largest.amount > 0.0) jumps.push_back(largest);
        });
    }
    std::stable_sort(jumps.begin(), jumps.end(),
                     [](const Jump& a, const Jump& b) { return a.amount > b.amount; });
    return jumps;
}

/// The places that jumps belong to: parts of the lattice that touch each other, numbered from the
/// largest jump on.
class Places {
public:
    explicit Places(const ol::LUT& lut) {
        const ol::LatticeSize size =
            lut.is1D() ? ol::LatticeSize{lut.width(), 1, 1} : ol::LatticeSize::of(lut);
        const int longest = std::max({size.width, size.height, size.depth});
        points_ = std::max(2, (longest + kParts - 1) / kParts);
        isCurve_ = lut.is1D();
    }

    void add(const Jump& jump) { places_.emplace(partOf(jump), kNone); }

    /// The number of a jump's place, after all of them were added.
    std::size_t placeOf(const Jump& jump) {
        const Point part = partOf(jump);
        if (places_[part] == kNone) fill(part, count_++);
        return places_[part];
    }

private:
    static constexpr std::size_t kNone = std::numeric_limits<std::size_t>::max();

    Point partOf(const Jump& jump) const {
        const Point& at = jump.from;
        return {at[0] / points_, isCurve_ ? 0 : at[1] / points_, isCurve_ ? 0 : at[2] / points_};
    }

    /// Numbers a part and all that it touches.
    void fill(const Point& first, std::size_t number) {
        std::vector<Point> open = {first};
        while (!open.empty()) {
            const Point part = open.back();
            open.pop_back();
            const auto found = places_.find(part);
            if (found == places_.end() || found->second != kNone) continue;
            found->second = number;
            for (int b = -1; b <= 1; ++b) {
                for (int g = -1; g <= 1; ++g) {
                    for (int r = -1; r <= 1; ++r)
                        open.push_back({part[0] + r, part[1] + g, part[2] + b});
                }
            }
        }
    }

    int points_ = 2;  // along a part
    bool isCurve_ = false;
    std::map<Point, std::size_t> places_;
    std::size_t count_ = 0;
};

}  // namespace

std::vector<Fault> jumpFaults(const ol::LUT& lut, const PointInputs& inputs,
                              const FiniteRange& range) {
    const std::vector<Jump> jumps = jumpsOf(lut, range);
    Places places(lut);
    for (const Jump& jump : jumps)
        places.add(jump);
    std::vector<Fault> found;
    for (const Jump& jump : jumps) {
        const std::size_t place = std::min(places.placeOf(jump), kMostPlaces - 1);
        if (place == found.size()) {
            Fault fault;
            fault.kind = FaultKind::Jump;
            fault.count = 0;
            fault.from = inputs.at(jump.from);
            fault.to = inputs.at(jump.to);
            fault.amount = jump.amount;
            found.push_back(fault);
        }
        ++found[place].count;
        for (unsigned c = 0; c < 3; ++c)
            found[place].channels[c] = found[place].channels[c] || jump.channels[c];
    }
    return found;
}

}  // namespace report
