#pragma once

#include <cstddef>
#include <cstdint>

// The in-place writer of the JSON text library.
//
// A document lives in a buffer of its own: a zero-terminated text, then only
// zero bytes, then the sentinel 'J' in the last byte. An insertion learns how
// much room is left by looking for the sentinel behind the terminator, so
// writers need no size. Each writer takes the insertion point (a position
// inside a container, as returned by the previous write), an optional member
// key (null inside an array) and the value; it inserts a comma where one is
// needed and returns the new insertion point, or null when the room does not
// suffice. A writer given a JsonGrow calls it on lack of room and retries
// with the insertion point it returns, until the write fits or the callback
// gives null.
namespace Korvane::Veldra::VeldraMessageLibrary::Jsonz {

constexpr char kJsonSentinel = 'J';

// Makes more room: called with the insertion point, returns the insertion
// point in the new buffer (with the sentinel re-established) or null.
struct JsonGrow {
    char* (*callback)(void* context, char* insertionPoint);
    void* context;
};

// Copies initial (for example "{}" or "[]"), zero-fills the rest and puts the
// sentinel in the last byte. Returns the position of the last character of
// initial (the closing bracket), or null when the buffer is too small or
// initial is shorter than two characters. initial may be the buffer itself,
// which re-establishes the zeros and the sentinel behind an existing text.
char* InitDocument(char* buffer, std::size_t size, const char* initial) noexcept;

// A nested empty container; returns the point inside it. Close it with
// CloseContainer, which returns the point behind its closing bracket.
char* WriteArray(char* at, const char* key, const JsonGrow* grow = nullptr);
char* WriteObject(char* at, const char* key, const JsonGrow* grow = nullptr);
char* CloseContainer(char* at) noexcept;

char* WriteNull(char* at, const char* key, const JsonGrow* grow = nullptr);
char* WriteBool(char* at, const char* key, bool value, const JsonGrow* grow = nullptr);
// text is zero-terminated and is escaped.
char* WriteString(char* at, const char* key, const char* text, const JsonGrow* grow = nullptr);
char* WriteDouble(char* at, const char* key, double value, const JsonGrow* grow = nullptr);
char* WriteUInt64(char* at, const char* key, uint64_t value, const JsonGrow* grow = nullptr);
char* WriteInt64(char* at, const char* key, int64_t value, const JsonGrow* grow = nullptr);
char* WriteUInt32(char* at, const char* key, uint32_t value, const JsonGrow* grow = nullptr);
char* WriteInt32(char* at, const char* key, int32_t value, const JsonGrow* grow = nullptr);
// raw is inserted as it stands; the caller vouches that it is JSON.
char* WriteRaw(char* at, const char* key, const char* raw, const JsonGrow* grow = nullptr);

// Removes the bytes [begin, end) of a document (a value, or a member from
// its key to its value) together with the comma that would otherwise be left
// dangling, and zero-fills the freed bytes. Returns begin.
char* RemoveRange(char* begin, char* end) noexcept;
// Removes an array's element at index, or an object's member by key (raw
// comparison of the key's characters). False when there is none.
bool RemoveElement(char* array, std::size_t index) noexcept;
bool RemoveMember(char* object, const char* key) noexcept;

}  // namespace Korvane::Veldra::VeldraMessageLibrary::Jsonz
