#include "python/Arrays.h"

namespace python {

namespace py = pybind11;

py::array toNumbers(const py::object& given, const std::string& name) {
    if (!py::isinstance<py::array>(given)) {
        return py::module_::import("numpy").attr("asarray")(given, "float64");
    }
    auto array = py::reinterpret_borrow<py::array>(given);
    const char kind = array.dtype().kind();
    if (kind != 'f' || array.itemsize() > 8) {
        const bool isCode = kind == 'i' || kind == 'u';
        throw py::type_error(name + " have to be float16, float32 or float64, not " +
                             std::string(py::str(array.dtype())) +
                             (isCode ? ": divide codes by the largest" : ""));
    }
    return array;
}

Shape shapeOf(const py::array& array) {
    return {array.shape(), array.shape() + array.ndim()};
}

std::string shapeText(const py::array& array) {
    return py::str(py::object(array.attr("shape")));
}

}  // namespace python
