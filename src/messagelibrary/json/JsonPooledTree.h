#pragma once

#include <cstddef>
#include <memory>
#include <string_view>

#include "messagelibrary/json/JsonPool.h"
#include "messagelibrary/json/JsonVariant.h"

namespace Korvane::Veldra::VeldraMessageLibrary {

// A parsed tree in one pool (JsonPool.h); used by the parser.
//
// Every node below the root lives in the pool and is never freed on its own.
// The root is an ordinary variant that owns the pool: destroying it, or
// assigning to it, gives the whole pool back at once, without a walk over the
// tree. Moving the root moves the ownership.
//
// The tree is read as it stands. The first change through the root (any
// non-const operation of JsonVariant other than a move, an assignment or a
// reset) first copies the tree to storage of its own and gives the pool
// back; nodes below the root can only be reached for a change through such
// an operation. Pointers taken from the tree before that copy refer to the
// pooled tree and are invalid after it.
class JsonPooledTree {
public:
    // One key and the value it names, for Object.
    struct Member {
        std::string_view key;
        JsonVariant* value;
    };

    // A string; a text too long to stand in place goes into the pool.
    static JsonVariant String(JsonPool& pool, std::string_view text);
    // Moves count values, in order, into an array in the pool.
    static JsonVariant Array(JsonPool& pool, JsonVariant* values, std::size_t count);
    // Moves the values into an object in the pool, sorted by key; of a
    // repeated key the value given last is kept. Sorts members in place.
    static JsonVariant Object(JsonPool& pool, Member* members, std::size_t count);
    // Makes the finished tree's root the owner of the pool in which its
    // nodes were built; a root without nodes there lets the pool go.
    static void Adopt(JsonVariant& root, std::unique_ptr<JsonPool> pool);
    // Leaves a node that lives in a pool without freeing anything.
    static void Forget(JsonVariant& node) noexcept { node.kind_ = JsonKind::None; }

private:
    friend class JsonVariant;
    // A copy of the tree in storage of its own.
    static JsonVariant Clone(const JsonVariant& node);
    // Gives back the pool and the root's block; the root is left None.
    static void Release(JsonVariant& root) noexcept;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary
