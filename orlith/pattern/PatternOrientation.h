#pragma once

#include <string>
#include <vector>

#include "lut/LUT3D.h"
#include "orlith/pattern/PatchExtent.h"

namespace orlith {

/// The patches along the four sides of an image of patches. Rows are counted upward.
class PatchBorder {
public:
    PatchBorder(int columns, int rows);

    void set(int column, int row, const PatchExtent& patch);
    /// @param column, row  of a patch at a side
    const PatchExtent& at(int column, int row) const;

    int columns() const { return static_cast<int>(bottom_.size()); }
    int rows() const { return static_cast<int>(left_.size()); }

private:
    std::vector<PatchExtent> bottom_, top_, left_, right_;
};

/// How far the padding of an upright pattern is from the colour of its first patch: both were
/// black, and any look keeps them the same. 0 where they may be, and where there is no padding.
double paddingGap(const PatchBorder& border, int points);

/// What was done to a pattern that is not upright: where the padding should be there is something
/// else, and it is just where this would have put it. Few where padding leaves a choice; none
/// where the pattern may be upright, or where padding is nowhere.
///
/// The padding tells nothing where there is none, that is where the points are a square number,
/// nor the turn by 180 degrees where it is one patch (2 and 11 points).
///
/// @param points  of the pattern that has as many columns and rows, or as many rows and columns
std::vector<std::string> findOrientations(const PatchBorder& border, int points);

/// What was probably done to a pattern without padding: colours that are neighbours in the cube are
/// nearer to each other if it is undone, by more than any sensible look can make them. None where
/// the pattern may be upright, and where there is padding.
///
/// Two at a time, of which one is the other and a turn by 180 degrees. That alone is not seen: it
/// is the pattern of a look that reverses all three axes, as a negative does.
///
/// @param table  the centres of the patches, taken as if the pattern were upright
std::vector<std::string> findSmootherOrientations(const Orlith::LUT::LUT3D& table);

}  // namespace orlith
