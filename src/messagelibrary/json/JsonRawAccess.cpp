#include "messagelibrary/json/JsonRawAccess.h"

#include <cstring>
#include <string_view>

#include "messagelibrary/json/JsonNumberText.h"
#include "messagelibrary/json/JsonScanner.h"

namespace Korvane::Veldra::VeldraMessageLibrary::Jsonz {
namespace {

// The token of the value at text, or false when there is none.
bool TokenAt(const char* text, JsonToken& token, const char** end = nullptr) noexcept {
    if (text == nullptr) return false;
    JsonError error;
    const char* behind = ScanValue(text, token, error);
    if (end != nullptr) *end = behind;
    return behind != nullptr;
}

// The position behind the separator after a value: the next item, or null at
// the container's end or on malformed text.
const char* AfterComma(const char* valueEnd, char opening) noexcept {
    if (valueEnd == nullptr) return nullptr;
    const char* p = SkipJsonSpace(valueEnd);
    if (*p != ',') return nullptr;
    p = SkipJsonSpace(p + 1);
    if (opening == '{' && *p != '"') return nullptr;
    return (*p == '\0' || *p == ']' || *p == '}') ? nullptr : p;
}

}  // namespace

bool RawBool(const char* value, bool fallback) noexcept {
    JsonToken token;
    return TokenAt(value, token) && token.kind == 2 ? token.boolean : fallback;
}

const char* RawText(const char* value, std::size_t& length, const char* fallback) noexcept {
    JsonToken token;
    if (!TokenAt(value, token) || token.kind != 4) return fallback;
    length = token.length;
    return token.start;
}

uint64_t RawUInt64(const char* value, uint64_t fallback) noexcept {
    JsonToken token;
    uint64_t result = 0;
    if (!TokenAt(value, token) || token.kind != 3) return fallback;
    return ConvertJsonUInt64(token.start, token.length, token.isFloat, result) ? result : fallback;
}

uint32_t RawUInt32(const char* value, uint32_t fallback) noexcept {
    JsonToken token;
    uint32_t result = 0;
    if (!TokenAt(value, token) || token.kind != 3) return fallback;
    return ConvertJsonUInt32(token.start, token.length, token.isFloat, result) ? result : fallback;
}

double RawDouble(const char* value, double fallback) noexcept {
    JsonToken token;
    double result = 0.0;
    if (!TokenAt(value, token) || token.kind != 3) return fallback;
    return ConvertJsonDouble(token.start, token.length, result) ? result : fallback;
}

const char* RawFirstMember(const char* object) noexcept {
    if (object == nullptr) return nullptr;
    const char* p = SkipJsonSpace(object);
    if (*p != '{') return nullptr;
    p = SkipJsonSpace(p + 1);
    return *p == '"' ? p : nullptr;
}

const char* RawMemberKey(const char* member, std::size_t& length) noexcept {
    JsonToken token;
    if (!TokenAt(member, token) || token.kind != 4) return nullptr;
    length = token.length;
    return token.start;
}

const char* RawMemberValue(const char* member) noexcept {
    JsonToken token;
    const char* end = nullptr;
    if (!TokenAt(member, token, &end) || token.kind != 4) return nullptr;
    end = SkipJsonSpace(end);
    return *end == ':' ? SkipJsonSpace(end + 1) : nullptr;
}

const char* RawNextMember(const char* member) noexcept {
    JsonToken token;
    const char* end = nullptr;
    if (!TokenAt(RawMemberValue(member), token, &end)) return nullptr;
    return AfterComma(end, '{');
}

const char* RawFindMember(const char* object, const char* key) noexcept {
    if (key == nullptr) return nullptr;
    const std::string_view wanted(key);
    for (const char* member = RawFirstMember(object); member != nullptr;
         member = RawNextMember(member)) {
        std::size_t length = 0;
        const char* raw = RawMemberKey(member, length);
        if (raw != nullptr && std::string_view(raw, length) == wanted) {
            return RawMemberValue(member);
        }
    }
    return nullptr;
}

const char* RawFirstElement(const char* array) noexcept {
    if (array == nullptr) return nullptr;
    const char* p = SkipJsonSpace(array);
    if (*p != '[') return nullptr;
    p = SkipJsonSpace(p + 1);
    return (*p == ']' || *p == '\0') ? nullptr : p;
}

const char* RawNextElement(const char* element) noexcept {
    JsonToken token;
    const char* end = nullptr;
    if (!TokenAt(element, token, &end)) return nullptr;
    return AfterComma(end, '[');
}

std::size_t RawElementCount(const char* array) noexcept {
    std::size_t count = 0;
    for (const char* e = RawFirstElement(array); e != nullptr; e = RawNextElement(e)) ++count;
    return count;
}

const char* RawElementAt(const char* array, std::size_t index) noexcept {
    const char* element = RawFirstElement(array);
    for (; element != nullptr && index > 0; --index) element = RawNextElement(element);
    return element;
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::Jsonz
