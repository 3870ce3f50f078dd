#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace kvtag {

// kvtag's own small reader of a configuration file: it checks the JSON
// syntax, to say where a file that the library could not parse goes wrong,
// and keeps the members of the top-level object, to tell which key the
// library refused, and the items of a member that is an array (for the
// small request bodies of kvtag serve). It builds no deeper tree.
enum class JsonKind { Null, Bool, Number, String, Array, Object };

struct JsonScalar {
    JsonKind kind = JsonKind::Null;
    std::string text;    // a string's characters (escapes resolved), a number as written
    bool truth = false;  // a boolean's value
    // A top-level member's array items; an item that is itself a container
    // keeps its kind only.
    std::vector<JsonScalar> items;
};

struct JsonDocument {
    // "line L, column C: what was wrong"; nothing for a whole document.
    std::optional<std::string> error;
    JsonKind rootKind = JsonKind::Null;
    // The members of a top-level object, in the file's order.
    std::vector<std::pair<std::string, JsonScalar>> members;
};

// Reads the text up to its first zero byte, as the library does.
JsonDocument ReadJsonDocument(std::string_view text);

// "null", "a boolean", "a number", "a text", "an array", "an object".
const char* JsonKindName(JsonKind kind);

}  // namespace kvtag
