#pragma once

#include <pybind11/pybind11.h>

#include <cstdint>
#include <string>

namespace kvveldra_python {

// The data types of the console functions, as kvveldra's constants.
enum DataType : int32_t { kDouble = 0, kInt = 1, kString = 2, kBool = 3, kUInt64 = 4, kDateTime = 5 };

// The constant's name of a data type, or "none".
const char* TypeName(int32_t type);
// ValueError unless type is one of the six.
void RequireDataType(int32_t type);

// The text that a value goes out as to the tag `path` of data type `type`:
// "%.17g" ("NaN", "Infinity", "-Infinity") for a float or int on a DOUBLE
// tag, decimal digits for an int on INT (32 bits) and UINT64 (0 to 2**64-1),
// "True"/"False" for a bool, the text of a str, and
// "YYYY-MM-DDThh:mm:ss.ffffffZ" for an aware datetime. A value of another
// Python type raises TypeError naming the tag and its type; an int out of
// range or a naive datetime ValueError.
std::string ValueText(pybind11::handle value, int32_t type, const std::string& path);

// The Python value of a text that the tag `path` of data type `type` holds;
// None for an empty text, except on a STRING tag.
pybind11::object ValueOfText(const std::string& text, int32_t type, const std::string& path);

}  // namespace kvveldra_python
