#include "messagelibrary/json/JsonPooledTree.h"

#include <new>
#include <utility>

#include "messagelibrary/json/JsonBlock.h"
#include "messagelibrary/json/JsonKey.h"
#include "messagelibrary/json/JsonText.h"

namespace Korvane::Veldra::VeldraMessageLibrary {
namespace {

// What stands before the root's block: the pool it owns. Sixteen bytes, so
// that the block after it keeps the alignment of a new allocation.
struct RootPrefix {
    JsonPool* pool;
    std::size_t unused;
};

template <typename T>
JsonBlock::Block<T>* PoolBlock(JsonPool& pool, std::size_t count) {
    auto* block = static_cast<JsonBlock::Block<T>*>(
        pool.Allocate(sizeof(JsonBlock::Block<T>) + count * sizeof(T)));
    block->size = count;
    block->capacity = count;
    return block;
}

// A copy of the text in the pool, laid out as JsonText keeps it.
char* PoolText(JsonPool& pool, std::string_view text) {
    return JsonText::Place(pool.Allocate(JsonText::BlockSize(text.size())), text);
}

JsonKey PoolKey(JsonPool& pool, std::string_view key) {
    if (key.size() <= JsonKey::kInlineCapacity) return JsonKey(key);
    return JsonKey::Borrowed(PoolText(pool, key), key.size());
}

// The root's block, moved out of the pool into an allocation of its own
// behind a RootPrefix.
template <typename T>
JsonBlock::Block<T>* RootBlock(JsonBlock::Block<T>* pooled, JsonPool* pool) {
    const std::size_t count = pooled->size;
    void* memory =
        ::operator new(sizeof(RootPrefix) + sizeof(JsonBlock::Block<T>) + count * sizeof(T));
    auto* prefix = static_cast<RootPrefix*>(memory);
    prefix->pool = pool;
    auto* block = reinterpret_cast<JsonBlock::Block<T>*>(prefix + 1);
    block->size = count;
    block->capacity = count;
    // The items are nodes of the pool: they move as bytes, and the ones left
    // behind in the pool are never destroyed.
    for (std::size_t i = 0; i < count; ++i) new (block->begin() + i) T(std::move((*pooled)[i]));
    return block;
}

}  // namespace

JsonVariant JsonPooledTree::String(JsonPool& pool, std::string_view text) {
    JsonVariant node;
    if (text.size() <= JsonVariant::kInlineTextCapacity) {
        node.SetInlineText(text);
    } else {
        node.SetHeapText(PoolText(pool, text));
    }
    return node;
}

JsonVariant JsonPooledTree::Array(JsonPool& pool, JsonVariant* values, std::size_t count) {
    JsonVariant node;
    JsonBlock::Block<JsonVariant>* block = nullptr;
    if (count > 0) {
        block = PoolBlock<JsonVariant>(pool, count);
        for (std::size_t i = 0; i < count; ++i) {
            new (block->begin() + i) JsonVariant(std::move(values[i]));
        }
    }
    node.SetBlock(JsonKind::Array, block);
    return node;
}

JsonVariant JsonPooledTree::Object(JsonPool& pool, Member* members, std::size_t count) {
    SortByJsonKey(members, count, [](const Member& member) { return member.key; });
    // Of each run of equal keys only the last stays.
    std::size_t kept = 0;
    for (std::size_t i = 0; i < count; ++i) {
        if (i + 1 < count && members[i].key == members[i + 1].key) {
            Forget(*members[i].value);
            continue;
        }
        members[kept++] = members[i];
    }
    JsonVariant node;
    JsonBlock::Block<JsonMember>* block = nullptr;
    if (kept > 0) {
        block = PoolBlock<JsonMember>(pool, kept);
        for (std::size_t i = 0; i < kept; ++i) {
            new (block->begin() + i) JsonMember{PoolKey(pool, members[i].key),
                                                JsonVariant(std::move(*members[i].value))};
        }
    }
    node.SetBlock(JsonKind::Object, block);
    return node;
}

void JsonPooledTree::Adopt(JsonVariant& root, std::unique_ptr<JsonPool> pool) {
    switch (root.kind_) {
        case JsonKind::String:
            // A long text is in the pool: the root takes a copy of its own.
            if (root.AsText().size() > JsonVariant::kInlineTextCapacity) {
                JsonVariant own(root.AsText());
                Forget(root);
                root = std::move(own);
            }
            return;
        case JsonKind::Array:
            if (auto* elements = root.ArrayBlock()) {
                root.SetRootBlock(RootBlock(elements, pool.get()));
                pool.release();  // the root owns it now
            }
            return;
        case JsonKind::Object:
            if (auto* members = root.ObjectBlock()) {
                root.SetRootBlock(RootBlock(members, pool.get()));
                pool.release();  // the root owns it now
            }
            return;
        default:
            return;
    }
}

JsonVariant JsonPooledTree::Clone(const JsonVariant& node) {
    switch (node.Kind()) {
        case JsonKind::Null:
            return JsonVariant(JsonKind::Null);
        case JsonKind::Boolean:
            return JsonVariant(node.AsBool());
        case JsonKind::Number:
            return JsonVariant(node.AsNumber());
        case JsonKind::String:
            return JsonVariant(node.AsText());
        case JsonKind::Array: {
            JsonVariant copy(JsonKind::Array);
            const auto elements = node.Elements();
            copy.Reserve(elements.size());
            for (const JsonVariant& element : elements) copy.Append(Clone(element));
            return copy;
        }
        case JsonKind::Object: {
            JsonObjectBuilder builder;
            const auto members = node.Members();
            builder.Reserve(members.size());
            for (const JsonMember& member : members) builder.Add(member.key, Clone(member.value));
            JsonVariant copy(JsonKind::Object);
            builder.Finish(copy);
            return copy;
        }
        default:
            return JsonVariant();
    }
}

void JsonPooledTree::Release(JsonVariant& root) noexcept {
    void* block = root.IsArray() ? static_cast<void*>(root.ArrayBlock())
                                 : static_cast<void*>(root.ObjectBlock());
    auto* prefix = static_cast<RootPrefix*>(block) - 1;
    delete prefix->pool;
    ::operator delete(prefix);
    root.kind_ = JsonKind::None;
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary
