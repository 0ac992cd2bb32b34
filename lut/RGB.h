#pragma once

#include <vnl/vnl_vector_fixed.h>

namespace Orlith::LUT {

/// One sample: red, green and blue in single precision.
using RGB = vnl_vector_fixed<float, 3>;

static_assert(sizeof(RGB) == 3 * sizeof(float), "tables are streamed as plain floats");

}  // namespace Orlith::LUT
