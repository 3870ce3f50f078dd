#pragma once

#include <string>

#include "messagelibrary/json/JsonVariant.h"

namespace Korvane::Veldra::VeldraMessageLibrary {

// Parses one whole JSON document, a zero-terminated text, into variant.
// Returns false on malformed text (JsonScanner.h tells the rules), on a
// number text that has no value ("-", "1e+") and on nesting deeper than
// Jsonz::kJsonMaxDepth levels; variant is then None. A string whose escapes
// fail to decode (a lone surrogate) becomes "" without failing. Never throws
// for bad text; only std::bad_alloc.
bool Parse(JsonVariant& variant, const char* text);
// The same for the text up to its first zero byte.
bool Parse(JsonVariant& variant, const std::string& text);

}  // namespace Korvane::Veldra::VeldraMessageLibrary
