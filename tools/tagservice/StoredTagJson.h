#pragma once

#include <string>

#include "StoredTag.h"

namespace Korvane::Veldra::TagService {

// The text form of a stored tag, as the store on disk keeps it:
// {"tag":<TagRecord>,"current":<TagValueSample or null>,"aggregates":<TagAggregates>}.
std::string StoredTagToJson(const StoredTag& tag);
// Reads the text form back; throws VeldraException (Veldra.FailedToParse)
// when the text is not one, or lacks the path or the type.
StoredTag StoredTagFromJson(const std::string& text);

}  // namespace Korvane::Veldra::TagService
