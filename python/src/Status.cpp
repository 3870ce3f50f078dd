#include "Status.h"

#include <pybind11/pybind11.h>

namespace py = pybind11;

namespace kvveldra_python {
namespace {

[[noreturn]] void Raise(const py::object& exception) {
    PyErr_SetObject(reinterpret_cast<PyObject*>(Py_TYPE(exception.ptr())), exception.ptr());
    throw py::error_already_set();
}

py::module_ Errors() {
    return py::module_::import("kvveldra._errors");
}

}  // namespace

void RaiseStatus(int32_t status, const std::string& text) {
    Raise(Errors().attr("error_for")(status, status == 1 && text.empty() ? "nothing to act on" : text));
}

void RaiseClosed(const std::string& text) {
    Raise(Errors().attr("closed")(text));
}

}  // namespace kvveldra_python
