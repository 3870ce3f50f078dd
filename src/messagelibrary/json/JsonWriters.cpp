#include "messagelibrary/json/JsonWriters.h"

#include <charconv>
#include <cmath>

#include "messagelibrary/json/Base64.h"
#include "messagelibrary/json/JsonEscape.h"

namespace Korvane::Veldra::VeldraMessageLibrary {
namespace {

template <typename T, typename... Format>
void AppendChars(JsonOutput& out, T value, Format... format) {
    constexpr std::size_t kMostChars = 40;
    char* at = out.Room(kMostChars);
    out.Advance(std::to_chars(at, at + kMostChars, value, format...).ptr);
}

// Texts this long are measured before they are written; shorter ones get
// room for the longest escape of every byte and are written in one pass.
constexpr std::size_t kMeasuredTextSize = 4096;

// A text in quotes, escaped, with a separator character before and after it
// ('\0' for none): single characters, so that no copy of a length known only
// at run time is made for them.
void AppendQuoted(JsonOutput& out, char before, std::string_view text, char after) {
    const std::size_t escaped =
        text.size() < kMeasuredTextSize ? text.size() * 6 : JsonEscapedLength(text);
    char* at = out.Room(escaped + 4);
    if (before != '\0') *at++ = before;
    *at++ = '"';
    at = WriteJsonEscaped(at, text);
    *at++ = '"';
    if (after != '\0') *at++ = after;
    out.Advance(at);
}

}  // namespace

void AppendJsonNull(JsonOutput& out) {
    out.Append("null", 4);
}

void AppendJsonBool(JsonOutput& out, bool value) {
    if (value) {
        out.Append("true", 4);
    } else {
        out.Append("false", 5);
    }
}

void AppendJsonInt32(JsonOutput& out, int32_t value) {
    AppendChars(out, value);
}

void AppendJsonInt64(JsonOutput& out, int64_t value) {
    AppendChars(out, value);
}

void AppendJsonDouble(JsonOutput& out, double value) {
    if (std::isnan(value)) {
        out.Append("NaN", 3);
    } else if (std::isinf(value)) {
        out.Append(value > 0 ? "Infinity" : "-Infinity");
    } else {
        // The same digits as "%.17g", but always with a "." whatever the locale.
        AppendChars(out, value, std::chars_format::general, 17);
    }
}

void AppendJsonTimestamp(JsonOutput& out, const Timestamp& value) {
    char* at = out.Room(kTimestampTextMax + 2);
    *at++ = '"';
    at = WriteTimestampText(value, at);
    *at++ = '"';
    out.Advance(at);
}

void AppendJsonString(JsonOutput& out, std::string_view text) {
    AppendQuoted(out, '\0', text, '\0');
}

void AppendJsonBase64(JsonOutput& out, const void* data, std::size_t size) {
    out.Put('"');
    const std::string text = Base64Encode(data, size);
    out.Append(text.data(), text.size());
    out.Put('"');
}

void JsonObjectWriter::AppendKey(std::string_view key) {
    AppendQuoted(out_, first_ ? '\0' : ',', key, ':');
    first_ = false;
}

namespace JsonWriteDetail {

void AppendEnum(JsonOutput& out, int32_t value, const JsonEnumTexts& texts) {
    const char* text = texts.TextOf(value);
    AppendJsonString(out, text == nullptr ? std::string_view() : std::string_view(text));
}

}  // namespace JsonWriteDetail

}  // namespace Korvane::Veldra::VeldraMessageLibrary
