#pragma once

#include <pybind11/numpy.h>

#include "lut/io/table/Reading.h"

namespace python {

/// The test pattern of size x size x size colours as an image (height, width, 3), its top line
/// first.
/// @throws pybind11::value_error  a size that is not within 2 to 129
pybind11::array makePattern(int size);

/// The table that a pattern holds behind any colour operators: the centres of its patches.
/// @param image  (height, width, 3 or more channels, of which the first three count)
/// @throws pybind11::value_error  a size that no pattern has
Orlith::LUT::Table tableOfPattern(const pybind11::object& image);

}  // namespace python
