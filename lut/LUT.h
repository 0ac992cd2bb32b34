#pragma once

#include <vnl/vnl_matrix_fixed.h>

#include <cstdint>
#include <vector>

#include "lut/RGB.h"
#include "lut/SampleArray.h"

namespace Orlith::LUT {

/// How a lattice is read between its points; see Interpolation.h.
enum InterpolationMode : std::uint32_t { Step = 0, LinearStaggered = 1, Trilinear = 2, Cubic = 3 };

/// One side of the pre-LUT: three curves of up to entries.size() points.
struct Shaper {
    std::vector<RGB> entries;            ///< empty: there is no shaper
    RGB counts = RGB(0.0F, 0.0F, 0.0F);  ///< points in use on each channel, as floats

    bool empty() const noexcept { return entries.empty(); }
};

/// 4 x 4, row vectors: transform[row][column], translation in row 3.
using Transform = vnl_matrix_fixed<float, 4, 4>;

/// A colour look-up table; the common face of LUT1D and LUT3D.
///
/// A file's reader fills one, writers and evaluation only read it. Tables are handed on in a
/// boost::shared_ptr<LUT> and never copied.
///
/// Threads  const members may run at once; the others may overlap nothing.
/// Binary   the order of the virtual functions and of the data members is what plug-ins were
///          compiled against: new ones go last.
class LUT {
public:
    LUT();
    LUT(const LUT&) = delete;
    LUT& operator=(const LUT&) = delete;
    virtual ~LUT();

    /// Points along red (a curve: its length), green and blue.
    /// @throws Exception "width: not available" (height, depth) for a kind that has none
    virtual int width() const;
    virtual int height() const;
    virtual int depth() const;

    /// Gives the table n points on each axis, or width x height x depth points. Samples keep their
    /// place in storage, new ones are zero; the same sizes again are no work at all.
    /// @throws Exception          "resize: not available" for a kind that cannot
    /// @throws std::length_error  a negative side, or more than 2^31 - 1 points; nothing changes
    /// @throws std::bad_alloc     no memory; nothing changes
    virtual void resize(int n);
    virtual void resize(int width, int height, int depth);

    /// The sample at lattice point (r, g, b), or at place i of a curve. Indices are not checked;
    /// the reference is good until the next resize.
    /// @throws Exception "get: not available" for a kind that is indexed the other way
    virtual RGB& get(int r, int g, int b);
    virtual const RGB& get(int r, int g, int b) const;
    virtual RGB& get(int i);
    virtual const RGB& get(int i) const;

    /// All samples as floats r, g, b, r, g, b, ... in storage order; null when there are none.
    virtual float* data();
    virtual const float* data() const;

    /// Bytes behind data(), cut to 32 bits.
    virtual std::uint32_t dataSize() const;

    /// Tells a curve from a lattice.
    virtual bool is1D() const = 0;

    /// Sends a colour through the pre-LUT: inputShaper finds its position from 0 to 1,
    /// outputShaper maps that position. Unchanged where there are no shapers.
    virtual RGB applyShaper(const RGB& point) const;

    /// The table's output for an input colour.
    ///
    /// A lattice applies the pre-LUT, then the mode's method; outside its domain it continues along
    /// a straight line if extrapolate is set. A curve ignores the pre-LUT, the transform, mode and
    /// extrapolate and covers 0 to 1. A table without samples gives zeros.
    /// @throws Exception "Unknown interpolation mode" for a lattice and a mode above Cubic
    virtual RGB interpolate(const RGB& point, InterpolationMode mode, bool extrapolate) const = 0;

    /// The domain: the inputs that the first and the last point of each channel stand for.
    /// @throws Exception "minmax: not available" for a kind that has none
    virtual void minmax(RGB& min, RGB& max) const;

protected:
    SampleArray values;

public:
    /// Pre-LUT. Entry i of channel c of inputShaper is the input at position i / (counts[c] - 1);
    /// outputShaper is read at a position from 0 to 1.
    Shaper inputShaper;
    Shaper outputShaper;

    /// From lattice index to input: input_c = index_c * transform[c][c] + transform[3][c].
    /// Nothing else of the matrix is ever read. Identity to begin with.
    Transform transform;
};

/// Sets the transform of a table that covers 0 to 1 with the given points along each channel: the
/// diagonal becomes 1 / (points - 1) in single precision (infinite for one point).
void setUnitDomain(LUT& lut, int width, int height, int depth);

}  // namespace Orlith::LUT
