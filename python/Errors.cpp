#include "python/Errors.h"

#include <exception>
#include <utility>

#include "lut/Exception.h"
#include "lut/io/table/FileError.h"
#include "python/Text.h"

namespace python {
namespace {

namespace py = pybind11;
namespace ol = Orlith::LUT;

constexpr char kErrorText[] =
    R"(A file that cannot be read or written, or a table that its format cannot hold.

file    its name, as it was given
line    where the reader stumbled, counted from 1; None for the file as a whole
reason  what is wrong, without the place)";

/// The type of orlith.Error, which lives as long as the process.
PyObject* errorType = nullptr;

void setError(const py::object& text, const py::object& file, const py::object& line,
              const py::object& reason) {
    const py::object error = py::reinterpret_borrow<py::object>(errorType)(text);
    error.attr("file") = file;
    error.attr("line") = line;
    error.attr("reason") = reason;
    PyErr_SetObject(errorType, error.ptr());
}

void translate(std::exception_ptr failure) {
    try {
        if (failure) std::rethrow_exception(std::move(failure));
    } catch (const ol::FileError& error) {
        setError(toText(error.what()), toFileName(error.file()), toLine(error.line()),
                 toText(error.reason()));
    } catch (const ol::Exception& exception) {
        const py::object text = toText(exception.message());
        setError(text, py::none(), py::none(), text);
    }
}

}  // namespace

void defineError(py::module_& module) {
    py::dict none;
    for (const char* const name : {"file", "line", "reason"})
        none[name] = py::none();
    errorType = PyErr_NewExceptionWithDoc("orlith.Error", kErrorText, nullptr, none.ptr());
    if (errorType == nullptr) throw py::error_already_set();
    module.attr("Error") = py::reinterpret_borrow<py::object>(errorType);
    py::register_exception_translator(&translate);
}

}  // namespace python
