#pragma once

#include <pybind11/numpy.h>

#include <string>

#include "lut/Evaluator.h"
#include "lut/io/table/Reading.h"
#include "python/Arrays.h"

namespace python {

using Orlith::LUT::Table;

/// A new table, all black, and without a domain.
/// @param sides  points along each axis: one number for a curve, three for a lattice
/// @throws pybind11::value_error  more points than a table has
Table emptyTable(const Shape& sides);

/// A new table, all black.
/// @param sides   as of emptyTable
/// @param domain  None for 0 to 1; otherwise what broadcasts to (2, 3) when there are two numbers,
///                or two triples: least and largest inputs
/// @throws pybind11::value_error  fewer than two points a side, a domain that does not rise
Table makeTable(const Shape& sides, const pybind11::object& domain);

/// A table of samples (N, 3) or (R, G, B, 3), which are copied.
Table tableOfSamples(const pybind11::object& samples, const pybind11::object& domain);

/// A table of what a function gives for the inputs of its points.
/// @param kind  "1D" or "3D"
Table tableOfFunction(const pybind11::function& function, int size, const pybind11::object& domain,
                      const std::string& kind);

/// The samples where they are, indexed [r, g, b, channel], or [i, channel] for a curve.
/// @param owner  keeps the table alive as long as the array lives; None: the caller does
pybind11::array samplesOf(const Table& table, const pybind11::object& owner);

/// "1D" or "3D".
std::string kindOf(const Table& table);

/// (N,) or (R, G, B).
pybind11::tuple sizeOf(const Table& table);

/// The least and the largest inputs, (2, 3).
pybind11::array domainOf(const Table& table);

/// None, or for each channel an array (n, 2): inputs, and the places from 0 to 1 that they lead to.
pybind11::object shaperOf(const Table& table);

/// A list of (line or None, text).
pybind11::list remarksOf(const Table& table);

/// @throws pybind11::value_error  no such method
Orlith::LUT::Evaluator::Method toMethod(const std::string& mode);
Orlith::LUT::Evaluator::Outside toOutside(bool extrapolates);

/// Sends colours (..., 3) through a table; other threads of Python run meanwhile.
pybind11::object evaluate(const Table& table, const pybind11::object& colours,
                          const std::string& mode, bool extrapolates);

}  // namespace python
