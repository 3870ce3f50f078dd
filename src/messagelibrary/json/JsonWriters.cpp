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

// `text` escaped and between quotes, after `before` and followed by `after`
// (each of at most two bytes).
void AppendQuoted(JsonOutput& out, std::string_view before, std::string_view text,
                  std::string_view after) {
    const std::size_t escaped =
        text.size() < kMeasuredTextSize ? text.size() * 6 : JsonEscapedLength(text);
    char* at = out.Room(before.size() + escaped + after.size() + 2);
    for (const char c : before) *at++ = c;
    *at++ = '"';
    at = WriteJsonEscaped(at, text);
    *at++ = '"';
    for (const char c : after) *at++ = c;
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
    AppendQuoted(out, {}, text, {});
}

void AppendJsonBase64(JsonOutput& out, const void* data, std::size_t size) {
    out.Put('"');
    const std::string text = Base64Encode(data, size);
    out.Append(text.data(), text.size());
    out.Put('"');
}

void JsonObjectWriter::AppendKey(std::string_view key) {
    AppendQuoted(out_, first_ ? std::string_view() : std::string_view(","), key, ":");
    first_ = false;
}

namespace JsonWriteDetail {

void AppendEnum(JsonOutput& out, int32_t value, const JsonEnumTexts& texts) {
    const char* text = texts.TextOf(value);
    AppendJsonString(out, text == nullptr ? std::string_view() : std::string_view(text));
}

}  // namespace JsonWriteDetail

}  // namespace Korvane::Veldra::VeldraMessageLibrary
