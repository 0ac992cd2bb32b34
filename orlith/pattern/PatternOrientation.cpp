#include "orlith/pattern/PatternOrientation.h"

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <utility>

#include "zefra/PatternLayout.h"

namespace orlith {
namespace {

using Layout = zefra::PatternLayout;

/// Exchanges columns and rows first, then runs them from the other side.
struct Orientation {
    bool isTransposed, isColumnReversed, isRowReversed;
    const char* name;
};

constexpr Orientation kUpright = {false, false, false, ""};
constexpr Orientation kOrientations[] = {
    {false, true, false, "mirrored left to right"},
    {false, false, true, "mirrored top to bottom"},
    {false, true, true, "turned by 180 degrees"},
    {true, false, true, "turned by 90 degrees clockwise"},
    {true, true, false, "turned by 90 degrees counterclockwise"},
    // Images are transposed about the diagonal from their top left.
    {true, true, true, "transposed"},
    {true, false, false, "turned by 180 degrees and transposed"},
};

/// A pattern in an image that shows it in some orientation.
class OrientedPattern {
public:
    OrientedPattern(const PatchBorder& border, int points, const Orientation& orientation)
        : border_(border),
          columns_(Layout::columns(points)),
          rows_(Layout::rows(points)),
          pointCount_(std::int64_t{points} * points * points),
          orientation_(orientation) {}

    bool fits() const {
        return orientation_.isTransposed ? border_.columns() == rows_ && border_.rows() == columns_
                                         : border_.columns() == columns_ && border_.rows() == rows_;
    }

    /// Whether the patches behind the last point, and it not, have the colour of the first.
    bool endsInPadding() const {
        return hasPadding() && !patch(pointCount_ - 1).agreesWith(patch(0));
    }

    bool hasPadding() const {
        for (std::int64_t i = pointCount_; i < patchCount(); ++i) {
            if (!patch(i).agreesWith(patch(0))) return false;
        }
        return true;
    }

    double paddingGap() const {
        double most = 0.0;
        for (std::int64_t i = pointCount_; i < patchCount(); ++i) {
            if (!patch(i).agreesWith(patch(0))) most = std::max(most, patch(i).gapTo(patch(0)));
        }
        return most;
    }

private:
    std::int64_t patchCount() const { return std::int64_t{columns_} * rows_; }

    /// A patch of the first or last row by its index in the pattern.
    const PatchExtent& patch(std::int64_t index) const {
        int column = static_cast<int>(index % columns_);
        int row = static_cast<int>(index / columns_);
        if (orientation_.isTransposed) std::swap(column, row);
        if (orientation_.isColumnReversed) column = border_.columns() - 1 - column;
        if (orientation_.isRowReversed) row = border_.rows() - 1 - row;
        return border_.at(column, row);
    }

    const PatchBorder& border_;
    const int columns_, rows_;
    const std::int64_t pointCount_;
    const Orientation& orientation_;
};

// By so much are neighbours nearer to each other in the right orientation: 1.22 times (4 points) to
// 1.6 times (121) in a pattern that was mirrored, more in one that was turned. In a wrong one it
// takes a look of several waves along an axis to have them 1.1 times nearer.
constexpr double kClearlySmoother = 1.15;

/// Where each point's sample stands in a table that was read upright from a square pattern.
std::vector<std::size_t> placesOf(int points, const Orientation& orientation) {
    const int columns = Layout::columns(points);
    std::vector<std::size_t> places;
    places.reserve(static_cast<std::size_t>(columns) * static_cast<std::size_t>(columns));
    for (int row = 0; row < columns; ++row) {
        for (int column = 0; column < columns; ++column) {
            int x = orientation.isTransposed ? row : column;
            int y = orientation.isTransposed ? column : row;
            if (orientation.isColumnReversed) x = columns - 1 - x;
            if (orientation.isRowReversed) y = columns - 1 - y;
            places.push_back(static_cast<std::size_t>(y * columns + x));
        }
    }
    return places;
}

/// How far all neighbours in the cube are apart, added up.
double roughness(const Orlith::LUT::LUT3D& table, const Orientation& orientation) {
    const auto points = static_cast<std::size_t>(table.width());
    const auto places = placesOf(table.width(), orientation);
    const float* const samples = table.data();
    double sum = 0.0;
    for (const std::size_t stride : {std::size_t{1}, points, points * points}) {
        for (std::size_t i = 0; i + stride < places.size(); ++i) {
            if (i / stride % points == points - 1) continue;
            const float* const one = samples + 3 * places[i];
            const float* const next = samples + 3 * places[i + stride];
            for (int c = 0; c < 3; ++c)
                sum += std::fabs(static_cast<double>(next[c]) - static_cast<double>(one[c]));
        }
    }
    return sum;
}

}  // namespace

PatchBorder::PatchBorder(int columns, int rows)
    : bottom_(static_cast<std::size_t>(columns)),
      top_(bottom_.size()),
      left_(static_cast<std::size_t>(rows)),
      right_(left_.size()) {}

void PatchBorder::set(int column, int row, const PatchExtent& patch) {
    const auto x = static_cast<std::size_t>(column);
    const auto y = static_cast<std::size_t>(row);
    if (row == 0) bottom_[x] = patch;
    if (row == rows() - 1) top_[x] = patch;
    if (column == 0) left_[y] = patch;
    if (column == columns() - 1) right_[y] = patch;
}

const PatchExtent& PatchBorder::at(int column, int row) const {
    if (row == 0) return bottom_[static_cast<std::size_t>(column)];
    if (row == rows() - 1) return top_[static_cast<std::size_t>(column)];
    return (column == 0 ? left_ : right_)[static_cast<std::size_t>(row)];
}

double paddingGap(const PatchBorder& border, int points) {
    return OrientedPattern(border, points, kUpright).paddingGap();
}

std::vector<std::string> findOrientations(const PatchBorder& border, int points) {
    const OrientedPattern upright(border, points, kUpright);
    if (upright.fits() && upright.hasPadding()) return {};
    std::vector<std::string> names;
    for (const Orientation& each : kOrientations) {
        const OrientedPattern pattern(border, points, each);
        if (pattern.fits() && pattern.endsInPadding()) names.emplace_back(each.name);
    }
    return names;
}

std::vector<std::string> findSmootherOrientations(const Orlith::LUT::LUT3D& table) {
    const int columns = Layout::columns(table.width());
    const auto pointCount = std::int64_t{table.width()} * table.width() * table.width();
    if (std::int64_t{columns} * columns != pointCount) return {};

    const double upright = roughness(table, kUpright);
    double least = upright;
    std::vector<std::pair<double, const char*>> candidates;
    for (const Orientation& each : kOrientations) {
        candidates.emplace_back(roughness(table, each), each.name);
        least = std::min(least, candidates.back().first);
    }
    if (!(upright > kClearlySmoother * least)) return {};
    std::vector<std::string> names;
    for (const auto& [sum, name] : candidates) {
        constexpr double kRounding = 1e-6;  // those of a pair add the same in another order
        if (sum <= least * (1.0 + kRounding)) names.emplace_back(name);
    }
    return names;
}

}  // namespace orlith
