#pragma once

#include <pybind11/pybind11.h>

#include <cstdint>
#include <string>

namespace python {

/// A path as the system takes it: of a str, of bytes, or of an object that stands for a path.
/// @throws pybind11::error_already_set  TypeError or ValueError, as for Python's own open
std::string toPath(const pybind11::object& given);

/// What open would take as the name of the same file.
pybind11::object toFileName(const std::string& path);

/// Bytes that may come from a file; what is no UTF-8 becomes "\xff".
pybind11::object toText(const std::string& bytes);

/// None for 0, which stands for the file as a whole.
pybind11::object toLine(std::uint64_t line);

}  // namespace python
