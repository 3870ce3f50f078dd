#pragma once

#include <pybind11/pybind11.h>
#include <kvveldra/TagConsole.h>

#include <string>
#include <vector>

#include "TagHandle.h"

namespace kvveldra_python {

// The calls of a kvveldra.Tag; each raises kvveldra.ClosedError when the tag
// or its Client is closed, and kvveldra.Error when the library refuses.

// One sample: the value, at the time given or now.
void WriteValue(TagHandle& tag, pybind11::handle value, pybind11::handle timestamp);
// Samples of values or (value, time) pairs, in order, in one message;
// ValueError for none.
void WriteValues(TagHandle& tag, pybind11::handle values);
// The tag's kvveldra.Value; kvveldra.NoSuchTagError when the service has no
// record of it.
pybind11::object ReadValue(TagHandle& tag);

std::vector<std::string> Keywords(TagHandle& tag);
void SetKeywords(TagHandle& tag, pybind11::handle keywords);
TagConsoleProperties Properties(TagHandle& tag);
void SetProperties(TagHandle& tag, pybind11::handle properties);
bool CollectAggregates(TagHandle& tag);
void SetCollectAggregates(TagHandle& tag, bool collect);
void ResetAggregates(TagHandle& tag);
void DeleteTag(TagHandle& tag);
// Gives the reference's close; nothing when the tag or its Client is closed.
void CloseTag(TagHandle& tag);

}  // namespace kvveldra_python
