#pragma once

#include <cstddef>
#include <string>
#include <string_view>

// Escaping of text for a JSON string. The text ends at its first zero byte.
//   8, 9, 10, 12, 13        \b \t \n \f \r
//   quote and backslash     \" and \\ (a backslash before each)
//   other bytes < 32, 127   \u00XX, lower-case hexadecimal
//   everything else         as it stands (UTF-8 included; "/" is not escaped)
namespace Korvane::Veldra::VeldraMessageLibrary {

// The length of the escaped form, without quotes.
std::size_t JsonEscapedLength(std::string_view text) noexcept;
// Writes the escaped form to out, which has room for JsonEscapedLength;
// returns the position behind it.
char* WriteJsonEscaped(char* out, std::string_view text) noexcept;
// The escaped form. When nothing needs escaping (and no zero byte cuts the
// text), the input itself is returned and storage is untouched.
std::string_view EscapeJsonText(std::string_view text, std::string& storage);

}  // namespace Korvane::Veldra::VeldraMessageLibrary
