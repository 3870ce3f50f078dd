#include "Records.h"

#include "Times.h"
#include "Values.h"

namespace py = pybind11;

namespace kvveldra_python {
namespace {

py::module_ RecordsModule() {
    return py::module_::import("kvveldra._records");
}

}  // namespace

py::object ValueRecord(const TagConsoleValue& value) {
    const py::module_ records = RecordsModule();
    const bool counted = value.aggregateCount > 0;
    const py::object aggregates = records.attr("Aggregates")(
        value.aggregateCount, counted ? py::object(py::float_(value.aggregateAverage)) : py::none(),
        counted ? ValueOfText(value.aggregateMinimum, value.dataType, value.path) : py::none(),
        counted ? ValueOfText(value.aggregateMaximum, value.dataType, value.path) : py::none());
    const bool written = !value.value.empty() || value.timestamp != TagConsoleTime::min();
    return records.attr("Value")(
        value.path, value.dataType,
        written ? ValueOfText(value.value, value.dataType, value.path) : py::none(),
        DatetimeOf(value.timestamp), aggregates);
}

py::object ListingRecord(py::list tags, uint32_t total) {
    return RecordsModule().attr("Listing")(std::move(tags), total);
}

}  // namespace kvveldra_python
