#pragma once

#include <pybind11/pybind11.h>
#include <kvveldra/TagConsole.h>

#include <string>

namespace kvveldra_python {

// The console time of a timezone-aware datetime. A naive datetime raises
// ValueError and anything else TypeError, both naming `what` (a tag's time or
// value).
TagConsoleTime TimeOf(pybind11::handle value, const std::string& what);
// "YYYY-MM-DDThh:mm:ss.ffffffZ" in UTC for an aware datetime, as TimeOf checks it.
std::string TimeText(pybind11::handle value, const std::string& what);
// The time as an aware datetime in UTC, or None for the two boundless times.
pybind11::object DatetimeOf(TagConsoleTime time);
// An aware datetime in UTC of an ISO 8601 text, as the service keeps a
// date-time value; ValueError naming `what` when it does not read as one.
pybind11::object DatetimeOfText(const std::string& text, const std::string& what);
TagConsoleTime Now();

// Takes the datetime module's names; the module's start calls it once, so
// that no later call does that work.
void PrepareTimes();

}  // namespace kvveldra_python
