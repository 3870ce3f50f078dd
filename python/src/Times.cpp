#include "Times.h"

#include <chrono>
#include <cstdio>

namespace py = pybind11;

namespace kvveldra_python {
namespace {

// The datetime module's objects, taken once and kept for the process's life
// (never released, so that nothing is freed after the interpreter ends).
struct DatetimeNames {
    py::handle datetime, timedelta, utc, epoch;
};

const DatetimeNames& Names() {
    static const DatetimeNames names = [] {
        const py::module_ module = py::module_::import("datetime");
        py::object datetime = module.attr("datetime");
        py::object timedelta = module.attr("timedelta");
        py::object utc = module.attr("timezone").attr("utc");
        py::object epoch = datetime(1970, 1, 1, py::arg("tzinfo") = utc);
        return DatetimeNames{datetime.release(), timedelta.release(), utc.release(),
                             epoch.release()};
    }();
    return names;
}

// value, checked to be an aware datetime.
void RequireAware(py::handle value, const std::string& what) {
    if (!py::isinstance(value, Names().datetime)) {
        throw py::type_error(what + " must be a timezone-aware datetime, not " +
                             std::string(py::str(py::type::handle_of(value).attr("__name__"))));
    }
    if (value.attr("utcoffset")().is_none()) {
        throw py::value_error(what + " is a naive datetime; give it a time zone, as in "
                              "datetime.now(timezone.utc)");
    }
}

}  // namespace

TagConsoleTime TimeOf(py::handle value, const std::string& what) {
    RequireAware(value, what);
    const py::object delta = py::reinterpret_steal<py::object>(
        PyNumber_Subtract(value.ptr(), Names().epoch.ptr()));
    if (!delta) throw py::error_already_set();
    const auto days = delta.attr("days").cast<int64_t>();
    const auto seconds = delta.attr("seconds").cast<int64_t>();
    const auto micros = delta.attr("microseconds").cast<int64_t>();
    return TagConsoleTime(std::chrono::microseconds((days * 86400 + seconds) * 1000000 + micros));
}

std::string TimeText(py::handle value, const std::string& what) {
    RequireAware(value, what);
    const py::object utc = value.attr("astimezone")(Names().utc);
    const auto field = [&utc](const char* name) { return utc.attr(name).cast<int>(); };
    char text[40];
    std::snprintf(text, sizeof text, "%04d-%02d-%02dT%02d:%02d:%02d.%06dZ", field("year"),
                  field("month"), field("day"), field("hour"), field("minute"), field("second"),
                  field("microsecond"));
    return text;
}

py::object DatetimeOf(TagConsoleTime time) {
    if (time == TagConsoleTime::min() || time == TagConsoleTime::max()) return py::none();
    const py::object delta =
        Names().timedelta(0, 0, static_cast<long long>(time.time_since_epoch().count()));
    const py::object result =
        py::reinterpret_steal<py::object>(PyNumber_Add(Names().epoch.ptr(), delta.ptr()));
    if (!result) throw py::error_already_set();
    return result;
}

py::object DatetimeOfText(const std::string& text, const std::string& what) {
    try {
        const py::object parsed = Names().datetime.attr("fromisoformat")(text);
        if (parsed.attr("utcoffset")().is_none()) return parsed.attr("replace")(py::arg("tzinfo") = Names().utc);
        return parsed.attr("astimezone")(Names().utc);
    } catch (const py::error_already_set&) {
        throw py::value_error(what + " holds '" + text + "', which does not read as a date-time");
    }
}

void PrepareTimes() {
    Names();
}

TagConsoleTime Now() {
    return std::chrono::time_point_cast<std::chrono::microseconds>(
        std::chrono::system_clock::now());
}

}  // namespace kvveldra_python
