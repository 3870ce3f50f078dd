#pragma once

#include <cstddef>
#include <cstdint>
#include <string_view>
#include <type_traits>
#include <utility>

namespace Korvane::Veldra::VeldraMessageLibrary {

// One value of an enumeration and its text form on the wire ("U_INT64").
struct JsonEnumText {
    int32_t value;
    const char* text;
};

// The text forms of one enumeration, a view of a constant table.
class JsonEnumTexts {
public:
    template <std::size_t N>
    constexpr JsonEnumTexts(const JsonEnumText (&entries)[N]) noexcept
        : entries_(entries), count_(N) {}

    // The text of value, or null when the value has none.
    const char* TextOf(int32_t value) const noexcept;
    // The value whose text equals text exactly (case included).
    bool ValueOf(std::string_view text, int32_t& value) const noexcept;

private:
    const JsonEnumText* entries_;
    std::size_t count_;
};

// An enumeration E (a 32-bit enum class) takes part in the readers and
// writers by one overload in its own namespace, found by argument-dependent
// lookup:
//
//     enum class TagDataType : int32_t { None = 0, Double = 1, ... };
//     constexpr JsonEnumText kTagDataTypeTexts[] = {{0, "NONE"}, {1, "DOUBLE"}, ...};
//     inline JsonEnumTexts JsonEnumTextsOf(TagDataType) { return kTagDataTypeTexts; }
//
// A value without a text form (a number read from the wire) is kept as it
// is and written as "".
template <typename E, typename = void>
struct IsJsonEnum : std::false_type {};
template <typename E>
struct IsJsonEnum<E, std::void_t<decltype(JsonEnumTextsOf(std::declval<E>()))>>
    : std::bool_constant<std::is_enum_v<E> && sizeof(E) == sizeof(int32_t)> {};
template <typename E>
inline constexpr bool kIsJsonEnum = IsJsonEnum<E>::value;

}  // namespace Korvane::Veldra::VeldraMessageLibrary
