#pragma once

#include <pybind11/pybind11.h>

namespace kvveldra_python {

// The module's classes, each with its docstrings.
void BindClient(pybind11::module_& module);
void BindTag(pybind11::module_& module);

}  // namespace kvveldra_python
