#pragma once

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <ostream>
#include <string>
#include <string_view>
#include <utility>

namespace Korvane::Veldra::VeldraMessageLibrary {

// The key of an object member, in 16 bytes: a key of up to 15 bytes stands in
// place with its terminating zero, a longer one is on the heap (or, in a
// parsed tree, in the tree's pool). Keys are
// mostly short field names, so a parsed object costs no allocation for them,
// and members move as plain bytes when an object is sorted.
class JsonKey {
public:
    // Bytes of a key kept in place.
    static constexpr std::size_t kInlineCapacity = 15;

    JsonKey() noexcept { Clear(); }
    explicit JsonKey(std::string_view text) {
        if (text.size() <= kInline) {
            std::memcpy(bytes_, text.data(), text.size());
            bytes_[text.size()] = '\0';
            bytes_[kMarker] = static_cast<char>(kInline - text.size());
            return;
        }
        char* heap = new char[text.size() + 1];
        std::memcpy(heap, text.data(), text.size());
        heap[text.size()] = '\0';
        const uint64_t size = text.size();
        std::memcpy(bytes_, &heap, sizeof(heap));
        std::memcpy(bytes_ + sizeof(heap), &size, 7);  // little-endian: the low 7 bytes
        bytes_[kMarker] = kHeapMarker;
    }
    // A key whose text, zero-terminated, lives elsewhere for as long as the
    // key (a parsed tree's pool): it is not copied and not freed.
    static JsonKey Borrowed(const char* text, std::size_t size) noexcept {
        JsonKey key;
        const uint64_t length = size;
        std::memcpy(key.bytes_, &text, sizeof(text));
        std::memcpy(key.bytes_ + sizeof(text), &length, 7);
        key.bytes_[kMarker] = kBorrowedMarker;
        return key;
    }

    JsonKey(JsonKey&& other) noexcept {
        std::memcpy(bytes_, other.bytes_, sizeof(bytes_));
        other.Clear();
    }
    JsonKey& operator=(JsonKey&& other) noexcept {
        if (this != &other) {
            Free();
            std::memcpy(bytes_, other.bytes_, sizeof(bytes_));
            other.Clear();
        }
        return *this;
    }
    JsonKey(const JsonKey&) = delete;
    JsonKey& operator=(const JsonKey&) = delete;
    ~JsonKey() { Free(); }

    std::string_view View() const noexcept { return {c_str(), size()}; }
    operator std::string_view() const noexcept { return View(); }
    std::string ToString() const { return std::string(View()); }
    const char* c_str() const noexcept { return IsHeap() ? HeapText() : bytes_; }
    std::size_t size() const noexcept {
        if (!IsHeap()) return kInline - static_cast<unsigned char>(bytes_[kMarker]);
        uint64_t size = 0;
        std::memcpy(&size, bytes_ + sizeof(char*), 7);
        return static_cast<std::size_t>(size);
    }

    friend bool operator==(const JsonKey& a, std::string_view b) noexcept { return a.View() == b; }
    friend bool operator==(std::string_view a, const JsonKey& b) noexcept { return a == b.View(); }
    friend bool operator==(const JsonKey& a, const JsonKey& b) noexcept {
        return a.View() == b.View();
    }
    friend bool operator!=(const JsonKey& a, std::string_view b) noexcept { return !(a == b); }
    friend bool operator!=(const JsonKey& a, const JsonKey& b) noexcept { return !(a == b); }
    friend std::ostream& operator<<(std::ostream& out, const JsonKey& key) {
        return out << key.View();
    }

private:
    static constexpr std::size_t kInline = kInlineCapacity;
    static constexpr std::size_t kMarker = 15;  // 15 - length, or kHeapMarker
    static constexpr char kHeapMarker = static_cast<char>(0xFF);
    static constexpr char kBorrowedMarker = static_cast<char>(0xFE);

    // The text is elsewhere: on the heap (owned) or borrowed.
    bool IsHeap() const noexcept {
        return bytes_[kMarker] == kHeapMarker || bytes_[kMarker] == kBorrowedMarker;
    }
    char* HeapText() const noexcept {
        char* heap;
        std::memcpy(&heap, bytes_, sizeof(heap));
        return heap;
    }
    void Clear() noexcept {
        bytes_[0] = '\0';
        bytes_[kMarker] = static_cast<char>(kInline);
    }
    void Free() noexcept {
        if (bytes_[kMarker] == kHeapMarker) delete[] HeapText();
    }

    char bytes_[16];
};

static_assert(sizeof(JsonKey) == 16, "a key is two words");

// The order of keys: by bytes, then by length. Keys are short: a plain loop
// beats a call to memcmp here.
inline bool JsonKeyLess(std::string_view a, std::string_view b) noexcept {
    const std::size_t common = a.size() < b.size() ? a.size() : b.size();
    for (std::size_t i = 0; i < common; ++i) {
        if (a[i] != b[i])
            return static_cast<unsigned char>(a[i]) < static_cast<unsigned char>(b[i]);
    }
    return a.size() < b.size();
}

// Sorts count items by the key keyOf gives, keeping the order of equal keys:
// in place for the few members of a record, with a merge beyond.
template <typename T, typename KeyOf>
void SortByJsonKey(T* items, std::size_t count, KeyOf keyOf) {
    constexpr std::size_t kInPlaceLimit = 32;
    const auto less = [&keyOf](const T& a, const T& b) { return JsonKeyLess(keyOf(a), keyOf(b)); };
    if (count > kInPlaceLimit) {
        std::stable_sort(items, items + count, less);
        return;
    }
    for (std::size_t i = 1; i < count; ++i) {
        if (!less(items[i], items[i - 1])) continue;
        T moving = std::move(items[i]);
        std::size_t j = i;
        for (; j > 0 && less(moving, items[j - 1]); --j) items[j] = std::move(items[j - 1]);
        items[j] = std::move(moving);
    }
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary
