#include "JsonWriter.h"

#include <cmath>
#include <cstdio>
#include <cstdlib>

namespace kvtag {

std::string NumberText(double value) {
    char text[40];
    for (const int digits : {15, 16, 17}) {
        std::snprintf(text, sizeof text, "%.*g", digits, value);
        if (std::strtod(text, nullptr) == value) break;
    }
    return text;
}

std::string JsonQuote(std::string_view text) {
    std::string out = "\"";
    for (const char c : text) {
        switch (c) {
            case '"':
                out += "\\\"";
                break;
            case '\\':
                out += "\\\\";
                break;
            case '\b':
                out += "\\b";
                break;
            case '\f':
                out += "\\f";
                break;
            case '\n':
                out += "\\n";
                break;
            case '\r':
                out += "\\r";
                break;
            case '\t':
                out += "\\t";
                break;
            default:
                if (static_cast<unsigned char>(c) < 0x20) {
                    char escape[8];
                    std::snprintf(escape, sizeof escape, "\\u%04x", static_cast<unsigned>(c));
                    out += escape;
                } else {
                    out += c;
                }
        }
    }
    out += '"';
    return out;
}

void JsonWriter::BeforeValue() {
    if (afterKey_) {
        afterKey_ = false;
        return;
    }
    if (!first_.empty()) {
        if (!first_.back()) text_ += ',';
        first_.back() = false;
    }
}

JsonWriter& JsonWriter::Open(char bracket) {
    BeforeValue();
    text_ += bracket;
    first_.push_back(true);
    return *this;
}

JsonWriter& JsonWriter::Close(char bracket) {
    text_ += bracket;
    first_.pop_back();
    return *this;
}

JsonWriter& JsonWriter::BeginObject() { return Open('{'); }
JsonWriter& JsonWriter::EndObject() { return Close('}'); }
JsonWriter& JsonWriter::BeginArray() { return Open('['); }
JsonWriter& JsonWriter::EndArray() { return Close(']'); }

JsonWriter& JsonWriter::Key(std::string_view key) {
    BeforeValue();
    text_ += JsonQuote(key);
    text_ += ':';
    afterKey_ = true;
    return *this;
}

JsonWriter& JsonWriter::Value(std::string_view json) {
    BeforeValue();
    text_ += json;
    return *this;
}

JsonWriter& JsonWriter::String(std::string_view text) { return Value(JsonQuote(text)); }
JsonWriter& JsonWriter::Integer(int64_t value) { return Value(std::to_string(value)); }
JsonWriter& JsonWriter::Number(double value) {
    return std::isfinite(value) ? Value(NumberText(value)) : Null();
}
JsonWriter& JsonWriter::Bool(bool value) { return Value(value ? "true" : "false"); }
JsonWriter& JsonWriter::Null() { return Value("null"); }
JsonWriter& JsonWriter::Raw(std::string_view json) { return Value(json); }

}  // namespace kvtag
