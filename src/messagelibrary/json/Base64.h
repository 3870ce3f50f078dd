#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace Korvane::Veldra::VeldraMessageLibrary {

// Standard alphabet with "=" padding and no line breaks; empty input gives
// an empty text.
std::size_t Base64EncodedLength(std::size_t size) noexcept;
void AppendBase64(std::string& out, const void* data, std::size_t size);
std::string Base64Encode(const void* data, std::size_t size);

// The reverse; false on a character outside the alphabet, a length that is
// no multiple of four, or misplaced padding.
bool Base64Decode(std::string_view text, std::vector<uint8_t>& out);

}  // namespace Korvane::Veldra::VeldraMessageLibrary
