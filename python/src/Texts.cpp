#include "Texts.h"

namespace py = pybind11;

namespace kvveldra_python {
namespace {

std::string TypeNameOf(py::handle value) {
    return py::str(py::type::handle_of(value).attr("__name__"));
}

std::string Text(py::handle value, const std::string& what) {
    if (!py::isinstance<py::str>(value)) {
        throw py::type_error(what + " must hold str, not " + TypeNameOf(value));
    }
    return value.cast<std::string>();
}

}  // namespace

std::vector<std::string> TextList(py::handle texts, const std::string& what) {
    if (py::isinstance<py::str>(texts) || !py::isinstance<py::iterable>(texts)) {
        throw py::type_error(what + " must be a list of str, not " + TypeNameOf(texts));
    }
    std::vector<std::string> result;
    for (const py::handle text : texts) result.push_back(Text(text, what));
    return result;
}

TagConsoleProperties TextMap(py::handle mapping, const std::string& what) {
    if (!py::hasattr(mapping, "items")) {
        throw py::type_error(what + " must be a dict of str to str, not " + TypeNameOf(mapping));
    }
    TagConsoleProperties result;
    for (const py::handle item : mapping.attr("items")()) {
        const py::object key = item[py::int_(0)];
        result[Text(key, what)] = Text(item[py::int_(1)], what);
    }
    return result;
}

}  // namespace kvveldra_python
