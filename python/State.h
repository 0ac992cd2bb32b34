#pragma once

#include <pybind11/pybind11.h>

#include "python/Tables.h"

namespace python {

/// All that makes a table, as objects that can be copied, pickled and sent to another process.
pybind11::tuple stateOf(const Table& table);

/// The table that a state was taken of.
/// @throws pybind11::value_error  it is none
Table tableOfState(const pybind11::tuple& state);

}  // namespace python
