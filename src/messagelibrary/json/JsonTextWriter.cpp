#include "messagelibrary/json/JsonTextWriter.h"

#include <charconv>
#include <cstring>
#include <string_view>

#include "messagelibrary/json/JsonEscape.h"
#include "messagelibrary/json/JsonRawAccess.h"
#include "messagelibrary/json/JsonScanner.h"

namespace Korvane::Veldra::VeldraMessageLibrary::Jsonz {
namespace {

bool IsOpening(char c) noexcept {
    return c == '[' || c == '{';
}
bool IsClosing(char c) noexcept {
    return c == ']' || c == '}';
}

// What one write inserts: an optional key and a value text, the latter
// either as it stands or escaped and quoted.
struct Content {
    const char* key;
    std::string_view value;
    bool quoted;

    std::size_t Length() const noexcept {
        std::size_t length = quoted ? JsonEscapedLength(value) + 2 : value.size();
        if (key != nullptr) length += JsonEscapedLength(key) + 3;
        return length;
    }

    char* Emit(char* p) const noexcept {
        if (key != nullptr) {
            *p++ = '"';
            p = WriteJsonEscaped(p, key);
            *p++ = '"';
            *p++ = ':';
        }
        if (quoted) {
            *p++ = '"';
            p = WriteJsonEscaped(p, value);
            *p++ = '"';
        } else {
            std::memcpy(p, value.data(), value.size());
            p += value.size();
        }
        return p;
    }
};

// True when the count bytes behind the terminator at end are all free (zero):
// the sentinel stops the look before the buffer ends.
bool HasRoom(const char* end, std::size_t count) noexcept {
    for (std::size_t i = 1; i <= count; ++i) {
        if (end[i] != '\0') return false;
    }
    return true;
}

// One attempt: inserts content at `at` with the comma it needs and returns the
// position behind the inserted value, or null when there is no room.
char* TryInsert(char* at, const Content& content) noexcept {
    const bool afterOpening = IsOpening(at[-1]);
    const char* next = SkipJsonSpace(at);
    const bool commaBefore = !afterOpening;
    const bool commaAfter = afterOpening && !IsClosing(*next);
    const std::size_t length = content.Length();
    const std::size_t total = length + (commaBefore || commaAfter ? 1 : 0);
    char* end = at + std::strlen(at);
    if (!HasRoom(end, total)) return nullptr;
    std::memmove(at + total, at, static_cast<std::size_t>(end - at) + 1);
    char* p = at;
    if (commaBefore) *p++ = ',';
    p = content.Emit(p);
    if (commaAfter) *p = ',';
    return p;
}

char* Insert(char* at, const Content& content, const JsonGrow* grow) {
    if (at == nullptr) return nullptr;
    for (;;) {
        if (char* behind = TryInsert(at, content)) return behind;
        if (grow == nullptr || grow->callback == nullptr) return nullptr;
        at = grow->callback(grow->context, at);
        if (at == nullptr) return nullptr;
    }
}

char* InsertPlain(char* at, const char* key, std::string_view value, const JsonGrow* grow) {
    return Insert(at, Content{key, value, false}, grow);
}

template <typename T, typename... Format>
char* InsertNumber(char* at, const char* key, T value, const JsonGrow* grow, Format... format) {
    char buffer[64];
    const auto result = std::to_chars(buffer, buffer + sizeof(buffer), value, format...);
    return InsertPlain(at, key, std::string_view(buffer, result.ptr - buffer), grow);
}

// Inserts an empty container and returns the position of its closing bracket.
char* InsertContainer(char* at, const char* key, const char* empty, const JsonGrow* grow) {
    char* behind = InsertPlain(at, key, empty, grow);
    return behind == nullptr ? nullptr : behind - 1;
}

}  // namespace

char* InitDocument(char* buffer, std::size_t size, const char* initial) noexcept {
    if (buffer == nullptr || initial == nullptr) return nullptr;
    const std::size_t length = std::strlen(initial);
    // A container of at least two characters, its terminator and the sentinel.
    if (length < 2 || size < length + 2) return nullptr;
    if (buffer != initial) std::memmove(buffer, initial, length);
    std::memset(buffer + length, 0, size - length - 1);
    buffer[size - 1] = kJsonSentinel;
    return buffer + length - 1;
}

char* WriteArray(char* at, const char* key, const JsonGrow* grow) {
    return InsertContainer(at, key, "[]", grow);
}

char* WriteObject(char* at, const char* key, const JsonGrow* grow) {
    return InsertContainer(at, key, "{}", grow);
}

char* CloseContainer(char* at) noexcept {
    if (at == nullptr) return nullptr;
    at = const_cast<char*>(SkipJsonSpace(at));
    return IsClosing(*at) ? at + 1 : nullptr;
}

char* WriteNull(char* at, const char* key, const JsonGrow* grow) {
    return InsertPlain(at, key, "null", grow);
}

char* WriteBool(char* at, const char* key, bool value, const JsonGrow* grow) {
    return InsertPlain(at, key, value ? "true" : "false", grow);
}

char* WriteString(char* at, const char* key, const char* text, const JsonGrow* grow) {
    return Insert(at, Content{key, text == nullptr ? "" : text, true}, grow);
}

char* WriteDouble(char* at, const char* key, double value, const JsonGrow* grow) {
    // "%.20g" digits, with "." whatever the locale.
    return InsertNumber(at, key, value, grow, std::chars_format::general, 20);
}

char* WriteUInt64(char* at, const char* key, uint64_t value, const JsonGrow* grow) {
    return InsertNumber(at, key, value, grow);
}

char* WriteInt64(char* at, const char* key, int64_t value, const JsonGrow* grow) {
    return InsertNumber(at, key, value, grow);
}

char* WriteUInt32(char* at, const char* key, uint32_t value, const JsonGrow* grow) {
    return InsertNumber(at, key, value, grow);
}

char* WriteInt32(char* at, const char* key, int32_t value, const JsonGrow* grow) {
    return InsertNumber(at, key, value, grow);
}

char* WriteRaw(char* at, const char* key, const char* raw, const JsonGrow* grow) {
    return InsertPlain(at, key, raw == nullptr ? "" : raw, grow);
}

char* RemoveRange(char* begin, char* end) noexcept {
    if (begin == nullptr || end == nullptr || end < begin) return begin;
    const char* afterSpace = SkipJsonSpace(end);
    if (*afterSpace == ',') {
        end = const_cast<char*>(SkipJsonSpace(afterSpace + 1));
    } else if (begin[-1] == ',') {
        --begin;
    }
    const std::size_t removed = static_cast<std::size_t>(end - begin);
    const std::size_t tail = std::strlen(end) + 1;
    std::memmove(begin, end, tail);
    std::memset(begin + tail, 0, removed);
    return begin;
}

bool RemoveElement(char* array, std::size_t index) noexcept {
    char* element = const_cast<char*>(RawElementAt(array, index));
    if (element == nullptr) return false;
    JsonToken token;
    JsonError error;
    char* end = const_cast<char*>(ScanValue(element, token, error));
    if (end == nullptr) return false;
    RemoveRange(element, end);
    return true;
}

bool RemoveMember(char* object, const char* key) noexcept {
    if (key == nullptr) return false;
    const std::string_view wanted(key);
    for (const char* member = RawFirstMember(object); member != nullptr;
         member = RawNextMember(member)) {
        std::size_t length = 0;
        const char* raw = RawMemberKey(member, length);
        if (raw == nullptr || std::string_view(raw, length) != wanted) continue;
        JsonToken token;
        JsonError error;
        const char* end = ScanValue(RawMemberValue(member), token, error);
        if (end == nullptr) return false;
        RemoveRange(const_cast<char*>(member), const_cast<char*>(end));
        return true;
    }
    return false;
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::Jsonz
