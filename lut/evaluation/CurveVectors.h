#pragma once

#include <array>
#include <cstddef>
#include <optional>
#include <vector>

#include "lut/RGB.h"

namespace Orlith::LUT {

/// Three curves, each by itself.
struct CurveColumns {
    /// The points of each channel; two at least.
    std::array<std::vector<float>, 3> values;

    /// For a search: element i is the largest of values 1 to i + 1, the last value apart;
    /// infinities fill it up to one less than a power of two.
    std::array<std::vector<float>, 3> rising;
};

/// The points of a curve of triples that are in use.
/// @param counts  points on each channel
/// @param search  find `rising` too
/// @return nothing for counts below 2, or beyond what is stored, or not whole
std::optional<CurveColumns> toColumns(const RGB* entries, std::size_t entryCount, const RGB& counts,
                                      bool search);

/// The functions of CurveLookup on each channel of packed colours, to the bit; in place if wanted.
using CurveVectorFunction = void (*)(const CurveColumns& curves, const float* in, float* out,
                                     std::size_t colourCount);

struct CurveVectors {
    CurveVectorFunction interpolate;  ///< interpolateCurve
    CurveVectorFunction locate;       ///< locateInCurve; needs `rising`
};

/// The functions in vectors of this processor, or null when it has none that are worth it.
const CurveVectors* curveVectors();

}  // namespace Orlith::LUT
