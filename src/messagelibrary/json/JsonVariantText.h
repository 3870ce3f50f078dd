#pragma once

#include <string>

#include "messagelibrary/json/JsonVariant.h"

namespace Korvane::Veldra::VeldraMessageLibrary {

// The text of a variant, without white space: null, true/false, a number
// ("%lld" when it equals its 64-bit truncation, else "%.20g"), an escaped
// string, arrays in order and objects sorted by key. None gives "".
// Only std::bad_alloc is thrown.
std::string ToJsonText(const JsonVariant& variant);

}  // namespace Korvane::Veldra::VeldraMessageLibrary
