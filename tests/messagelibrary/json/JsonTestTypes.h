#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/json/JsonWriters.h"

// An enumeration and a record declared the way message families declare
// theirs, for the reader and writer tests.
namespace Korvane::Veldra::VeldraMessageLibrary::JsonTestTypes {

enum class Color : int32_t { None = 0, Red = 1, DarkBlue = 2 };
constexpr JsonEnumText kColorTexts[] = {{0, "NONE"}, {1, "RED"}, {2, "DARK_BLUE"}};
inline JsonEnumTexts JsonEnumTextsOf(Color) {
    return kColorTexts;
}

struct Sample {
    std::optional<std::string> name;
    int32_t count = 0;
    std::optional<Color> color;
    std::optional<JsonStringList> tags;
};

inline bool ReadJsonFields(Sample& out, const JsonVariant& object) {
    return ReadField(out.name, object, "name") && ReadField(out.count, object, "count") &&
           ReadField(out.color, object, "color") && ReadField(out.tags, object, "tags");
}

inline void WriteJsonFields(JsonObjectWriter& out, const Sample& sample) {
    out.Field("name", sample.name)
        .Field("count", sample.count)
        .Field("color", sample.color)
        .Field("tags", sample.tags);
}

inline bool operator==(const Sample& a, const Sample& b) {
    return a.name == b.name && a.count == b.count && a.color == b.color && a.tags == b.tags;
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::JsonTestTypes
