#pragma once

#include <pybind11/pybind11.h>

namespace python {

/// Adds orlith.Error, as which the library's failures come to Python.
void defineError(pybind11::module_& module);

}  // namespace python
