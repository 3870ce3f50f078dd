#include "Values.h"

#include <cmath>
#include <cstdio>

#include "Times.h"

namespace py = pybind11;

namespace kvveldra_python {
namespace {

const char* const kTypeNames[] = {"DOUBLE", "INT", "STRING", "BOOL", "UINT64", "DATETIME"};
// What a tag of each type takes, for the messages.
const char* const kTakes[] = {"a float (or int)", "an int", "a str", "a bool", "an int",
                              "a timezone-aware datetime"};

[[noreturn]] void WrongType(py::handle value, int32_t type, const std::string& path) {
    throw py::type_error("tag '" + path + "' is " + TypeName(type) + " and takes " +
                         kTakes[type] + ", not " +
                         std::string(py::str(py::type::handle_of(value).attr("__name__"))));
}

// A bool is an int to Python; no tag but BOOL takes it.
bool IsInt(py::handle value) {
    return py::isinstance<py::int_>(value) && !py::isinstance<py::bool_>(value);
}

std::string DoubleText(double value) {
    if (std::isnan(value)) return "NaN";
    if (std::isinf(value)) return value > 0 ? "Infinity" : "-Infinity";
    char text[32];
    std::snprintf(text, sizeof text, "%.17g", value);
    return text;
}

// The decimal text of an int within [low, high] (as Python ints).
std::string IntText(py::handle value, const py::object& low, const py::object& high,
                    int32_t type, const std::string& path) {
    if (value < low || value > high) {
        throw py::value_error("tag '" + path + "' is " + TypeName(type) + ": " +
                              std::string(py::str(value)) + " is outside " +
                              std::string(py::str(low.ptr())) + " to " + std::string(py::str(high.ptr())));
    }
    return py::str(value);
}

}  // namespace

const char* TypeName(int32_t type) {
    return type >= kDouble && type <= kDateTime ? kTypeNames[type] : "none";
}

void RequireDataType(int32_t type) {
    if (type < kDouble || type > kDateTime) {
        throw py::value_error("data type " + std::to_string(type) +
                              " is none of DOUBLE, INT, STRING, BOOL, UINT64, DATETIME (0 to 5)");
    }
}

std::string ValueText(py::handle value, int32_t type, const std::string& path) {
    RequireDataType(type);
    switch (type) {
        case kDouble:
            if (py::isinstance<py::float_>(value) || IsInt(value)) {
                const double number = PyFloat_AsDouble(value.ptr());
                if (number == -1.0 && PyErr_Occurred()) {
                    PyErr_Clear();
                    throw py::value_error("tag '" + path + "' is DOUBLE: " +
                                          std::string(py::str(value)) +
                                          " is beyond the range of a float");
                }
                return DoubleText(number);
            }
            break;
        case kInt:
            if (IsInt(value)) return IntText(value, py::int_(INT32_MIN), py::int_(INT32_MAX), type, path);
            break;
        case kUInt64:
            if (IsInt(value)) return IntText(value, py::int_(0), py::int_(UINT64_MAX), type, path);
            break;
        case kBool:
            if (py::isinstance<py::bool_>(value)) return value.ptr() == Py_True ? "True" : "False";
            break;
        case kString:
            if (py::isinstance<py::str>(value)) return value.cast<std::string>();
            break;
        default:
            return TimeText(value, "the value for tag '" + path + "'");
    }
    WrongType(value, type, path);
}

py::object ValueOfText(const std::string& text, int32_t type, const std::string& path) {
    if (type == kString) return py::str(text);
    if (text.empty()) return py::none();
    const std::string what = "tag '" + path + "'";
    switch (type) {
        case kBool:
            return py::bool_(text == "true" || text == "True" || text == "TRUE" || text == "1");
        case kDateTime:
            return DatetimeOfText(text, what);
        default:
            break;
    }
    try {
        const py::str number(text);
        return type == kDouble ? py::object(py::float_(number)) : py::object(py::int_(number));
    } catch (const py::error_already_set&) {
        throw py::value_error(what + " of type " + std::string(TypeName(type)) + " holds '" +
                              text + "', which does not read as one");
    }
}

}  // namespace kvveldra_python
