#pragma once

#include <cstddef>
#include <cstring>
#include <string_view>

// The heap text of a string variant: one allocation holding the length, the
// bytes and a terminating zero. The variant keeps a pointer to the bytes.
namespace Korvane::Veldra::VeldraMessageLibrary::JsonText {

inline void SetLength(char* text, std::size_t length) noexcept {
    std::memcpy(text - sizeof(std::size_t), &length, sizeof(length));
}

inline char* Allocate(std::string_view content) {
    char* block = new char[sizeof(std::size_t) + content.size() + 1];
    char* text = block + sizeof(std::size_t);
    SetLength(text, content.size());
    if (!content.empty()) std::memcpy(text, content.data(), content.size());
    text[content.size()] = '\0';
    return text;
}

inline void Free(char* text) noexcept {
    delete[](text - sizeof(std::size_t));
}

inline std::size_t Length(const char* text) noexcept {
    std::size_t length;
    std::memcpy(&length, text - sizeof(std::size_t), sizeof(length));
    return length;
}

inline std::string_view View(const char* text) noexcept {
    return {text, Length(text)};
}

inline void Truncate(char* text) noexcept {
    SetLength(text, 0);
    text[0] = '\0';
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::JsonText
