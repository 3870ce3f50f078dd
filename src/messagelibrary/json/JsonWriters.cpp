#include "messagelibrary/json/JsonWriters.h"

#include <charconv>
#include <cmath>

#include "messagelibrary/json/Base64.h"
#include "messagelibrary/json/JsonEscape.h"

namespace Korvane::Veldra::VeldraMessageLibrary {
namespace {

template <typename T, typename... Format>
void AppendChars(std::string& out, T value, Format... format) {
    char buffer[40];
    const auto result = std::to_chars(buffer, buffer + sizeof(buffer), value, format...);
    out.append(buffer, result.ptr);
}

}  // namespace

void AppendJsonNull(std::string& out) {
    out.append("null", 4);
}

void AppendJsonBool(std::string& out, bool value) {
    if (value) {
        out.append("true", 4);
    } else {
        out.append("false", 5);
    }
}

void AppendJsonInt32(std::string& out, int32_t value) {
    AppendChars(out, value);
}

void AppendJsonInt64(std::string& out, int64_t value) {
    AppendChars(out, value);
}

void AppendJsonDouble(std::string& out, double value) {
    if (std::isnan(value)) {
        out.append("NaN", 3);
    } else if (std::isinf(value)) {
        out.append(value > 0 ? "Infinity" : "-Infinity");
    } else {
        // The same digits as "%.17g", but always with a "." whatever the locale.
        AppendChars(out, value, std::chars_format::general, 17);
    }
}

void AppendJsonTimestamp(std::string& out, const Timestamp& value) {
    out.push_back('"');
    AppendTimestampText(value, out);
    out.push_back('"');
}

void AppendJsonString(std::string& out, std::string_view text) {
    // Most texts need no escape: they are copied in one piece.
    const std::size_t plain = JsonPlainPrefix(text);
    if (plain == text.size() || text[plain] == '\0') {
        out.push_back('"');
        out.append(text.data(), plain);
        out.push_back('"');
        return;
    }
    const std::size_t length = JsonEscapedLength(text);
    const std::size_t start = out.size();
    out.resize(start + length + 2);
    char* p = out.data() + start;
    *p++ = '"';
    p = WriteJsonEscaped(p, text);
    *p = '"';
}

void AppendJsonBase64(std::string& out, const void* data, std::size_t size) {
    out.push_back('"');
    AppendBase64(out, data, size);
    out.push_back('"');
}

void JsonObjectWriter::AppendKey(std::string_view key) {
    if (!first_) out_.push_back(',');
    first_ = false;
    AppendJsonString(out_, key);
    out_.push_back(':');
}

namespace JsonWriteDetail {

void AppendEnum(std::string& out, int32_t value, const JsonEnumTexts& texts) {
    const char* text = texts.TextOf(value);
    AppendJsonString(out, text == nullptr ? std::string_view() : std::string_view(text));
}

}  // namespace JsonWriteDetail

}  // namespace Korvane::Veldra::VeldraMessageLibrary
