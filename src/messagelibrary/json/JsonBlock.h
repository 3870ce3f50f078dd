#pragma once

#include <cstddef>
#include <new>
#include <type_traits>
#include <utility>

// The storage of an array's elements or an object's members: a count, a
// capacity and the items, all in one heap block, so that a container costs
// one allocation. A variant holds a pointer to it; operations that grow the
// block may move it and therefore take that pointer by reference.
namespace Korvane::Veldra::VeldraMessageLibrary::JsonBlock {

template <typename T>
struct Block {
    static_assert(std::is_nothrow_move_constructible_v<T> && std::is_nothrow_move_assignable_v<T>,
                  "items move without throwing");
    static_assert(alignof(T) <= alignof(std::max_align_t), "items fit the block's alignment");

    std::size_t size;
    std::size_t capacity;

    T* begin() noexcept { return reinterpret_cast<T*>(this + 1); }
    T* end() noexcept { return begin() + size; }
    const T* begin() const noexcept { return reinterpret_cast<const T*>(this + 1); }
    const T* end() const noexcept { return begin() + size; }
    T& operator[](std::size_t index) noexcept { return begin()[index]; }
    const T& operator[](std::size_t index) const noexcept { return begin()[index]; }
};

template <typename T>
Block<T>* Create(std::size_t capacity) {
    void* memory = ::operator new(sizeof(Block<T>) + capacity * sizeof(T));
    auto* block = static_cast<Block<T>*>(memory);
    block->size = 0;
    block->capacity = capacity;
    return block;
}

template <typename T>
void Clear(Block<T>* block) noexcept {
    for (T* item = block->begin(); item != block->end(); ++item) item->~T();
    block->size = 0;
}

template <typename T>
void Free(Block<T>* block) noexcept {
    if (block == nullptr) return;
    Clear(block);
    ::operator delete(block);
}

// Room for at least capacity items; the block may move.
template <typename T>
void Reserve(Block<T>*& block, std::size_t capacity) {
    if (capacity <= block->capacity) return;
    Block<T>* grown = Create<T>(capacity);
    for (std::size_t i = 0; i < block->size; ++i) {
        new (grown->begin() + i) T(std::move((*block)[i]));
    }
    grown->size = block->size;
    Free(block);
    block = grown;
}

// Inserts item, which must not live in the block, before position index;
// the block may move.
template <typename T>
T& Insert(Block<T>*& block, std::size_t index, T&& item) {
    if (block->size == block->capacity) {
        Reserve(block, block->capacity < 4 ? 4 : block->capacity * 2);
    }
    T* items = block->begin();
    std::size_t size = block->size;
    if (index == size) {
        new (items + size) T(std::move(item));
    } else {
        new (items + size) T(std::move(items[size - 1]));
        for (std::size_t i = size - 1; i > index; --i) items[i] = std::move(items[i - 1]);
        items[index] = std::move(item);
    }
    ++block->size;
    return items[index];
}

template <typename T>
T& Append(Block<T>*& block, T&& item) {
    return Insert(block, block->size, std::move(item));
}

// Builds an item in place at the end; the block may move.
template <typename T, typename... Args>
T& Emplace(Block<T>*& block, Args&&... args) {
    if (block->size == block->capacity) {
        Reserve(block, block->capacity < 4 ? 4 : block->capacity * 2);
    }
    T* item = new (block->end()) T{std::forward<Args>(args)...};
    ++block->size;
    return *item;
}

// Removes the items [first, last).
template <typename T>
void Erase(Block<T>* block, std::size_t first, std::size_t last) noexcept {
    T* items = block->begin();
    const std::size_t removed = last - first;
    for (std::size_t i = first; i + removed < block->size; ++i) {
        items[i] = std::move(items[i + removed]);
    }
    for (std::size_t i = block->size - removed; i < block->size; ++i) items[i].~T();
    block->size -= removed;
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::JsonBlock
