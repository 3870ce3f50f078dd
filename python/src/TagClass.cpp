#include <pybind11/stl.h>

#include "Bindings.h"
#include "TagCalls.h"
#include "Values.h"

namespace py = pybind11;

namespace kvveldra_python {

void BindTag(py::module_& module) {
    py::class_<TagHandle, std::shared_ptr<TagHandle>>(module, "Tag", R"(
An open tag of a Client, made by Client.open, create or list. Its data type
decides the Python type of its values. Close it, or use it as a context
manager; the close of its client closes it too.)")
        .def_property_readonly("path", &TagHandle::Path, "The tag's path.")
        .def_property_readonly("data_type", &TagHandle::DataType,
                               "The data type (DOUBLE, INT, STRING, BOOL, UINT64, DATETIME).")
        .def_property_readonly("closed", [](const TagHandle& tag) { return !tag.Open(); },
                               "True once the tag or its client is closed.")
        .def("write", &WriteValue, py::arg("value"), py::arg("timestamp") = py::none(), R"(
Writes one value, at the aware datetime given or now. The value's type
must fit the tag: TypeError otherwise.)")
        .def("write_many", &WriteValues, py::arg("values"), R"(
Writes values, or (value, timestamp) pairs, in order in one message.
No values raise ValueError.)")
        .def("read", &ReadValue, R"(
The current Value: value, UTC timestamp (None for a tag never written) and
aggregates.)")
        .def_property("keywords", &Keywords, &SetKeywords,
                      "The tag's keywords: a list of str, read from and set on the service.")
        .def_property("properties", &Properties, &SetProperties,
                      "The tag's properties: a dict of str to str, read from and set on the service.")
        .def_property_readonly("collect_aggregates", &CollectAggregates,
                               "Whether the service counts aggregates for the tag.")
        .def("set_collect_aggregates", &SetCollectAggregates, py::arg("collect"),
             "Makes the service count aggregates for the tag, or stop.")
        .def("reset_aggregates", &ResetAggregates, "Starts the tag's aggregates afresh.")
        .def("delete", &DeleteTag, R"(
Deletes the tag on the service. The Tag stays open until closed; its other
calls then raise NoSuchTagError.)")
        .def("close", &CloseTag, "Closes the tag; a second close does nothing.")
        .def("__enter__", [](py::object self) { return self; })
        .def("__exit__", [](TagHandle& tag, py::args) { CloseTag(tag); })
        .def("__repr__", [](const TagHandle& tag) {
            return "<kvveldra.Tag '" + tag.Path() + "' " + TypeName(tag.DataType()) +
                   (tag.Open() ? ">" : ", closed>");
        });
}

}  // namespace kvveldra_python
