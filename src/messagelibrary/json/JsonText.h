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

// The bytes a text of this length takes: its length, its bytes, a zero.
inline std::size_t BlockSize(std::size_t length) noexcept {
    return sizeof(std::size_t) + length + 1;
}

// Writes content into a block of BlockSize(content.size()) bytes; returns the
// pointer to its bytes, which is what a variant keeps.
inline char* Place(void* block, std::string_view content) noexcept {
    char* text = static_cast<char*>(block) + sizeof(std::size_t);
    SetLength(text, content.size());
    if (!content.empty()) std::memcpy(text, content.data(), content.size());
    text[content.size()] = '\0';
    return text;
}

inline char* Allocate(std::string_view content) {
    return Place(new char[BlockSize(content.size())], content);
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
