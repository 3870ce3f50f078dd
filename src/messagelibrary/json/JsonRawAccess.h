#pragma once

#include <cstddef>
#include <cstdint>

// Reading values straight from a JSON text, without building a tree. Each
// accessor takes a position at (or before white space ahead of) a value and
// returns the default when the value is of another kind or malformed.
namespace Korvane::Veldra::VeldraMessageLibrary::Jsonz {

bool RawBool(const char* value, bool fallback) noexcept;
// The raw characters of a string (escapes unresolved) and their count.
const char* RawText(const char* value, std::size_t& length, const char* fallback) noexcept;
uint64_t RawUInt64(const char* value, uint64_t fallback) noexcept;
uint32_t RawUInt32(const char* value, uint32_t fallback) noexcept;
double RawDouble(const char* value, double fallback) noexcept;

// Objects: a member is addressed by the position of its key's opening quote.
// First and next give null at the end; MemberKey gives the raw key.
const char* RawFirstMember(const char* object) noexcept;
const char* RawNextMember(const char* member) noexcept;
const char* RawMemberKey(const char* member, std::size_t& length) noexcept;
const char* RawMemberValue(const char* member) noexcept;
// The value of the first member whose raw key equals key, or null.
const char* RawFindMember(const char* object, const char* key) noexcept;

// Arrays: an element is addressed by the position of its value.
const char* RawFirstElement(const char* array) noexcept;
const char* RawNextElement(const char* element) noexcept;
std::size_t RawElementCount(const char* array) noexcept;
const char* RawElementAt(const char* array, std::size_t index) noexcept;

}  // namespace Korvane::Veldra::VeldraMessageLibrary::Jsonz
