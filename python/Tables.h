#pragma once

#include <pybind11/numpy.h>

#include <string>

#include "lut/Evaluator.h"
#include "lut/io/table/Reading.h"
#include "python/Arrays.h"

namespace python {

using Orlith::LUT::Table;

/// A new table, all black.
/// @param sides   points along each axis: one number for a curve, three for a lattice
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

/// What a caller says of the way through a table; as objects, since what the binding says of other
/// types shows all arguments, images too.
/// @throws pybind11::type_error   no str, no bool
/// @throws pybind11::value_error  no such method
Orlith::LUT::Evaluator::Method toMethod(const pybind11::object& mode);
Orlith::LUT::Evaluator::Outside toOutside(const pybind11::object& extrapolate);

/// Sends colours (..., 3) through a table; other threads of Python run meanwhile.
pybind11::object evaluate(const Table& table, const pybind11::object& colours,
                          const pybind11::object& mode, const pybind11::object& extrapolate);

}  // namespace python

namespace pybind11::detail {

/// Python can make an object without its __init__, and hand it on. It holds no table yet.
template <>
class type_caster<Orlith::LUT::Table> : public type_caster_base<Orlith::LUT::Table> {
public:
    bool load(handle source, bool convert) {
        const auto* const type = get_type_info(typeid(Orlith::LUT::Table));
        if (isinstance(source, reinterpret_cast<PyObject*>(type->type)) &&
            !reinterpret_cast<instance*>(source.ptr())
                 ->get_value_and_holder(type)
                 .holder_constructed()) {
            throw type_error("this Table is empty: its __init__ was not called");
        }
        return type_caster_base<Orlith::LUT::Table>::load(source, convert);
    }
};

}  // namespace pybind11::detail
