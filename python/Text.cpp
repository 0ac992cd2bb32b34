#include "python/Text.h"

namespace python {

namespace py = pybind11;

std::string toPath(const py::object& given) {
    PyObject* bytes = nullptr;
    if (PyUnicode_FSConverter(given.ptr(), &bytes) == 0) throw py::error_already_set();
    return py::reinterpret_steal<py::bytes>(bytes);
}

py::object toFileName(const std::string& path) {
    return py::reinterpret_steal<py::object>(
        PyUnicode_DecodeFSDefaultAndSize(path.data(), static_cast<py::ssize_t>(path.size())));
}

py::object toText(const std::string& bytes) {
    return py::reinterpret_steal<py::object>(PyUnicode_DecodeUTF8(
        bytes.data(), static_cast<py::ssize_t>(bytes.size()), "backslashreplace"));
}

py::object toLine(std::uint64_t line) {
    if (line == 0) return py::none();
    return py::int_(line);
}

}  // namespace python
