#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <functional>

#include "lut/LUT3D.h"

namespace generatelut {

/// What the size of a test pattern tells: the cube behind it and the patches to read.
struct PatternSize {
    // Those of the 32-point pattern, until an image has been seen.
    int lutSizeR = 32;
    int lutSizeG = 32;
    int lutSizeB = 32;
    int lutEntryCount = 32768;
    int patchRows = 181;
    int patchColumns = 182;

    /// From the size of an image in pixels. Only the width decides about the cube; an image that is
    /// too small for any gives 0 or 1 points a side.
    static PatternSize ofImage(int width, int height);

    /// Pixels of the whole patches.
    int pixelWidth() const;
    int pixelHeight() const;

    /// The lattice point of a patch, and the colour from 0 to 1 that it stands for (NaN for a cube
    /// of one point).
    /// @return false, and zeros, for an index that is no lattice point
    bool indexToLattice(int index, int (&rgb)[3]) const;
    bool indexToColour(int index, float (&rgb)[3]) const;
};

/// The ramp that stands in for a 1D pre-LUT.
struct PreLUT {
    int entryCount = 1024;
    bool isLinear = false;  ///< false: smoothstep, which is what "logarithmic" stands for
};

/// The processed pattern, as far as its analysis needs it: rows from a host, or from memory.
class Frame {
public:
    /// Pixels of one row; the first float is column 0.
    using UseRow = std::function<void(const float* red, const float* green, const float* blue)>;

    virtual ~Frame() = default;

    /// Fetches pixels 0 to width - 1 of row y, counted upward, hands them to `use` and lets them
    /// go.
    virtual void withRow(int y, int width, const UseRow& use) = 0;

    virtual void progressMessage(const char* text) = 0;
    virtual void progressFraction(double fraction) = 0;
    virtual bool aborted() = 0;
};

/// Reads the centre pixel of every patch into a table, as it is: not clamped, scaled or rounded.
/// The pre-LUT goes into the table's outputShaper, whose counts stay 0. Surplus patches are
/// ignored, missing ones leave zeros. One row is fetched for each row of patches.
/// @return an empty pointer when cancelled
boost::shared_ptr<Orlith::LUT::LUT3D> analyseFrame(const PatternSize& size, const PreLUT& preLUT,
                                                   Frame& frame);

}  // namespace generatelut
