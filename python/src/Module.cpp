// The extension kvveldra._kvveldra: the Client and Tag classes over the
// TagConsole* functions, and the data type constants. kvveldra/__init__.py
// gathers them with the exceptions and records of the pure-Python parts.
#include <pybind11/pybind11.h>

#include "Bindings.h"
#include "Times.h"
#include "Values.h"

namespace py = pybind11;
using namespace kvveldra_python;

PYBIND11_MODULE(_kvveldra, module) {
    module.doc() = "The Client and Tag classes of kvveldra over the TagConsole functions.";
    module.attr("DOUBLE") = static_cast<int>(kDouble);
    module.attr("INT") = static_cast<int>(kInt);
    module.attr("STRING") = static_cast<int>(kString);
    module.attr("BOOL") = static_cast<int>(kBool);
    module.attr("UINT64") = static_cast<int>(kUInt64);
    module.attr("DATETIME") = static_cast<int>(kDateTime);
    PrepareTimes();
    BindClient(module);
    BindTag(module);
}
