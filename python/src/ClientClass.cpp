#include <pybind11/stl.h>

#include "Bindings.h"
#include "ClientCalls.h"
#include "Texts.h"
#include "Values.h"

namespace py = pybind11;

namespace kvveldra_python {
namespace {

std::shared_ptr<Session> MakeClient(uint64_t instance, std::optional<std::string> configuration,
                                    std::optional<uint32_t> timeoutMs,
                                    std::optional<bool> allowFallback) {
    if (instance == 0 && (configuration || timeoutMs || allowFallback)) {
        throw py::value_error(
            "kvveldra: instance 0 always uses the configuration 'veldra_master' with fallback and "
            "a connect time-out of 180 s; choose another instance for other settings");
    }
    return std::make_shared<Session>(
        InstanceSettings{instance, std::move(configuration), timeoutMs, allowFallback});
}

py::object List(Session& session, py::handle patterns, uint32_t skip, uint32_t take,
                py::handle keywords, py::handle properties) {
    ListQuery query;
    query.patterns = py::isinstance<py::str>(patterns)
                         ? std::vector<std::string>{patterns.cast<std::string>()}
                         : TextList(patterns, "the patterns of list");
    query.skip = skip;
    query.take = take;
    if (!keywords.is_none()) query.keywords = TextList(keywords, "the keywords of list");
    if (!properties.is_none()) query.properties = TextMap(properties, "the properties of list");
    return ListTags(session, query);
}

}  // namespace

void BindClient(py::module_& module) {
    py::class_<Session, std::shared_ptr<Session>>(module, "Client", R"(
A connection to the tag services: the library reserved and one instance
initialized on the broker of a configuration of the data root.

Instance 0 always uses the configuration 'veldra_master' (with fallback) and
may take 180 s to give up on a broker that does not answer; another instance
takes the configuration id, connect time-out (ms) and fallback given, each
defaulting as in the C++ library. Only one open Client of a process may have
an instance. Use it as a context manager, or call close(): both close its
tags, the instance and the reservation. Threads may share one client.)")
        .def(py::init(&MakeClient), py::arg("instance") = 0, py::arg("configuration") = py::none(),
             py::arg("timeout_ms") = py::none(), py::arg("allow_fallback") = py::none())
        .def_property_readonly("instance", &Session::Instance, "The instance id.")
        .def_property_readonly("closed", &Session::Closed, "True once the client is closed.")
        .def("open", &OpenTag, py::arg("path"), R"(
The tag of a path that the service has; NoSuchTagError when it has none.
Nothing is created.)")
        .def(
            "create",
            [](Session& session, const std::string& path, int32_t dataType) {
                RequireDataType(dataType);
                return CreateTag(session, path, dataType);
            },
            py::arg("path"), py::arg("data_type"), R"(
The tag of a path, created with the data type (DOUBLE, INT, STRING, BOOL,
UINT64 or DATETIME) when the service has none. A tag of another type
raises Error (-251907).)")
        .def("list", &List, py::arg("pattern"), py::arg("skip") = 0, py::arg("take") = 100,
             py::kw_only(), py::arg("keywords") = py::none(), py::arg("properties") = py::none(),
             R"(
A Listing (tags, total) of one page of the tags matching a path pattern
with '*' (or a list of patterns), and having all the keywords and
properties given: skip matches, then at most take tags (0: all). Each
listed tag is open; total counts all matches. No match is an empty page.)")
        .def("read_many", &ReadValues, py::arg("tags"), R"(
The Value of several tags of this client in one request, in the service's
order; an empty list reads nothing and gives [].)")
        .def("close", &Session::Close, R"(
Closes the client's open tags, its instance and its reservation; a second
close does nothing. A call after it raises ClosedError.)")
        .def("__enter__", [](py::object self) { return self; })
        .def("__exit__", [](Session& session, py::args) { session.Close(); })
        .def("__repr__", [](const Session& session) {
            return "<kvveldra.Client instance " + std::to_string(session.Instance()) +
                   (session.Closed() ? ", closed>" : ">");
        });
}

}  // namespace kvveldra_python
