#pragma once

#include <array>
#include <vector>

#include "zefra/Row.h"

namespace orlith {

/// From which value to which the pixels of a patch go. One that is processed pixel by pixel is
/// flat.
struct PatchExtent {
    struct Channel {
        double low;  ///< of the finite pixels; above `high` where there is none
        double high;
        int wildCount;  ///< pixels that are not finite
    };
    std::array<Channel, 3> channels;

    /// The largest difference between two of the pixels in a channel, in units of what is too much;
    /// infinite where only some are finite.
    double unevenness() const;

    /// The largest difference between two of the pixels in a channel.
    double spread() const;

    /// The least by which pixels of two patches differ; 0 where the extents overlap, infinite where
    /// only one has finite pixels.
    double gapTo(const PatchExtent& other) const;

    /// Whether both may be of one colour: the gap is not too much.
    bool agreesWith(const PatchExtent& other) const;
};

/// The extents of a row of patches, from its pixel rows in any order.
class PatchRowExtents {
public:
    explicit PatchRowExtents(int columns);

    /// Begins with the next row of patches.
    void clear();
    /// Takes in a row of pixels, from column 0 on.
    void add(const zefra::Row& row);
    PatchExtent patch(int column) const;

private:
    struct Channel {
        std::vector<float> low, high;  // of each column of pixels
        std::vector<int> wildCounts;
    };
    std::array<Channel, 3> channels_;
};

}  // namespace orlith
