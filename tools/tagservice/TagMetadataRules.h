#pragma once

#include <optional>
#include <string>

#include "StoredTag.h"
#include "messagelibrary/json/JsonReaders.h"

namespace Korvane::Veldra::TagService {

using VeldraMessageLibrary::JsonStringList;
using VeldraMessageLibrary::JsonStringMap;

// Merging joins the keywords (the old ones first, then each new one not yet
// there, in its order); otherwise the new list replaces the old. An absent
// list counts as empty.
void ChangeKeywords(TagRecord& tag, const std::optional<JsonStringList>& keywords, bool merge);

// Merging writes each new pair over the old one of its key; otherwise the
// new map replaces the old. An absent map counts as empty.
void ChangeProperties(TagRecord& tag, const std::optional<JsonStringMap>& properties, bool merge);

// Turns collecting aggregates on or off; either way the aggregates start
// from zero when the flag changes. A String tag cannot collect: the error
// name comes back and nothing changes.
std::optional<std::string> ChangeCollectAggregates(StoredTag& tag, bool collect);

// A new tag from the record of a create: the path and type as given, empty
// keywords and properties where absent. The error name when the record
// cannot be a tag: a bad path, no type or None, a String that collects.
std::optional<std::string> NewTag(const TagRecord& record, StoredTag& tag);

}  // namespace Korvane::Veldra::TagService
