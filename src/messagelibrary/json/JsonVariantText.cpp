#include "messagelibrary/json/JsonVariantText.h"

#include <charconv>
#include <cmath>
#include <cstdlib>
#include <memory>
#include <new>

#include "messagelibrary/json/JsonEscape.h"
#include "messagelibrary/json/JsonTextWriter.h"

namespace Korvane::Veldra::VeldraMessageLibrary {
namespace {

using namespace Jsonz;

// The growing buffer of one conversion.
struct Document {
    struct Free {
        void operator()(char* p) const noexcept { std::free(p); }
    };
    std::unique_ptr<char, Free> buffer;
    std::size_t size = 0;
};

// Doubles the buffer (at least 10 bytes) and re-establishes the zeros and
// the sentinel behind the text.
char* Grow(void* context, char* insertionPoint) {
    auto& document = *static_cast<Document*>(context);
    const std::size_t offset = static_cast<std::size_t>(insertionPoint - document.buffer.get());
    const std::size_t size = document.size * 2 < 10 ? 10 : document.size * 2;
    char* grown = static_cast<char*>(std::realloc(document.buffer.get(), size));
    if (grown == nullptr) {
        document.buffer.reset();
        throw std::bad_alloc();
    }
    document.buffer.release();
    document.buffer.reset(grown);
    document.size = size;
    InitDocument(grown, size, grown);
    return grown + offset;
}

// A number that is a whole 64-bit value is written as one.
bool IsWholeInt64(double value) noexcept {
    return value >= -9223372036854775808.0 && value < 9223372036854775808.0 &&
           std::trunc(value) == value;
}

char* WriteValue(char* at, const char* key, const JsonVariant& value, const JsonGrow& grow) {
    switch (value.Kind()) {
        case JsonKind::Null:
            return WriteNull(at, key, &grow);
        case JsonKind::Boolean:
            return WriteBool(at, key, value.AsBool(), &grow);
        case JsonKind::Number: {
            const double number = value.AsNumber();
            return IsWholeInt64(number) ? WriteInt64(at, key, static_cast<int64_t>(number), &grow)
                                        : WriteDouble(at, key, number, &grow);
        }
        case JsonKind::String:
            return WriteString(at, key, value.AsCString(), &grow);
        case JsonKind::Array: {
            char* inside = WriteArray(at, key, &grow);
            for (const JsonVariant& element : value.Elements()) {
                inside = WriteValue(inside, nullptr, element, grow);
            }
            return CloseContainer(inside);
        }
        case JsonKind::Object: {
            char* inside = WriteObject(at, key, &grow);
            for (const JsonMember& member : value.Members()) {
                inside = WriteValue(inside, member.key.c_str(), member.value, grow);
            }
            return CloseContainer(inside);
        }
        default:
            // A None inside a container has no text of its own.
            return WriteNull(at, key, &grow);
    }
}

std::string ScalarText(const JsonVariant& value) {
    switch (value.Kind()) {
        case JsonKind::Null:
            return "null";
        case JsonKind::Boolean:
            return value.AsBool() ? "true" : "false";
        case JsonKind::Number: {
            char buffer[64];
            const double number = value.AsNumber();
            const auto result =
                IsWholeInt64(number)
                    ? std::to_chars(buffer, buffer + sizeof(buffer), static_cast<int64_t>(number))
                    : std::to_chars(buffer, buffer + sizeof(buffer), number,
                                    std::chars_format::general, 20);
            return std::string(buffer, result.ptr);
        }
        case JsonKind::String: {
            std::string storage;
            const std::string_view escaped = EscapeJsonText(value.AsText(), storage);
            std::string text;
            text.reserve(escaped.size() + 2);
            text.push_back('"');
            text.append(escaped);
            text.push_back('"');
            return text;
        }
        default:
            return std::string();
    }
}

}  // namespace

std::string ToJsonText(const JsonVariant& variant) {
    if (!variant.IsArray() && !variant.IsObject()) return ScalarText(variant);
    Document document;
    const std::size_t initial = 64;
    document.buffer.reset(static_cast<char*>(std::malloc(initial)));
    if (!document.buffer) throw std::bad_alloc();
    document.size = initial;
    char* at = InitDocument(document.buffer.get(), document.size, variant.IsArray() ? "[]" : "{}");
    const JsonGrow grow{&Grow, &document};
    for (const JsonVariant& element : variant.Elements()) {
        at = WriteValue(at, nullptr, element, grow);
    }
    for (const JsonMember& member : variant.Members()) {
        at = WriteValue(at, member.key.c_str(), member.value, grow);
    }
    return std::string(document.buffer.get());
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary
