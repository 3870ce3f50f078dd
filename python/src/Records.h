#pragma once

#include <pybind11/pybind11.h>
#include <kvveldra/TagConsole.h>

namespace kvveldra_python {

// A kvveldra.Value (kvveldra/_records.py) of one record of a read: the
// value and the aggregates' minimum and maximum as Python values of the
// tag's type, the time as an aware datetime. A value that was never written
// (no time, no text) reads as None.
pybind11::object ValueRecord(const TagConsoleValue& value);

// A kvveldra.Listing of the page's tags and the count of all matches.
pybind11::object ListingRecord(pybind11::list tags, uint32_t total);

}  // namespace kvveldra_python
