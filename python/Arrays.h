#pragma once

#include <pybind11/numpy.h>

#include <string>
#include <vector>

namespace python {

/// Floats in the order of their indices, one behind the other; a copy only where they are not so.
using Floats = pybind11::array_t<float, pybind11::array::c_style | pybind11::array::forcecast |
                                            pybind11::detail::npy_api::NPY_ARRAY_ALIGNED_>;

using Shape = std::vector<pybind11::ssize_t>;

/// What was given as an array of numbers. Lists and the like count as float64.
/// @param name  of the argument, for the error
/// @throws pybind11::type_error  an array of other numbers than float16, float32 and float64
pybind11::array toNumbers(const pybind11::object& given, const std::string& name);

Shape shapeOf(const pybind11::array& array);

/// As Python writes it: "(33, 33, 33, 3)".
std::string shapeText(const pybind11::array& array);

}  // namespace python
