#pragma once

#include <pybind11/pybind11.h>

#include "python/Tables.h"

namespace python {

/// A function of the package, and its arguments that make the same table again: class, samples, and
/// what the table has beside them.
pybind11::tuple partsOf(const pybind11::object& table);

/// @throws pybind11::value_error  no such state
void restore(Table& table, const pybind11::tuple& state);

}  // namespace python
