#pragma once

#include "lut/LUT.h"

namespace Orlith::LUT {

// Evaluation of a lattice at any colour. Each function takes a point in input coordinates and finds
// its lattice position per channel, x_c = (p_c - offset_c) / scale_c, from the table's transform.
// Everything is single precision unless a comment says otherwise, and no point, NaN and infinities
// included, leads outside the stored samples; a table without samples gives zeros.

/// The sample below the point on every axis: sample i covers [i, i + 1).
/// @throws Exception "StepInterpolate: expecting a 3D lut"
RGB StepInterpolate(const LUT& lut, const RGB& point);

/// Each output channel linear on a grid that is shifted by half a cell along its own axis.
/// @throws Exception "LinearStaggeredInterpolate: expecting a 3D lut"
RGB LinearStaggeredInterpolate(const LUT& lut, const RGB& point);

/// The weighted mean of the cell's eight corners. The lower corner is not clamped: do not ask for
/// points below the domain.
/// @throws Exception "TrilinearInterpolate: expecting a 3D lut"
RGB TrilinearInterpolate(const LUT& lut, const RGB& point);

/// Four corners of the cell, which falls into six tetrahedra around the diagonal from its lowest to
/// its highest corner. Along the axes in the order of the position's fractions, the largest first
/// (of equal ones red, then green), lead the four corners p0 to p3 of the point's own tetrahedron.
/// With these fractions f0 >= f1 >= f2 the result is, in this order of operations,
/// (((1 - f0) p0 + (f0 - f1) p1) + (f1 - f2) p2) + f2 p3. On the face between two tetrahedra the
/// corner in which they differ weighs 0: the pieces meet. Beyond the lattice its edge goes on.
/// Not one of the modes of LUT::interpolate.
/// @throws Exception "TetrahedralInterpolate: expecting a 3D lut"
RGB TetrahedralInterpolate(const LUT& lut, const RGB& point);

/// Catmull-Rom over the 4 x 4 x 4 neighbourhood, continued linearly beyond the lattice.
/// @throws Exception "CubicInterpolate: expecting a 3D lut"
RGB CubicInterpolate(const LUT& lut, const RGB& point);

/// The sample at lattice indices that may lie outside: beyond one face the edge's slope goes on in
/// a straight line; beyond several, the lines of each axis are blended by how far outside it lies.
/// @throws Exception "Extrapolate: expecting a 3D lut"
RGB Extrapolate(const LUT& lut, int r, int g, int b);

/// One of the methods above, or one of the same form.
using InterpolationMethod = RGB (*)(const LUT& lut, const RGB& point);

/// A lattice's output at a point behind the pre-LUT: by the method within the domain; outside, from
/// the nearest point of the domain on in a straight line, whose slope is measured over a step of
/// 1 / width back into the domain.
RGB interpolateOrContinue(const LUT& lut, const RGB& point, InterpolationMethod method);

}  // namespace Orlith::LUT
