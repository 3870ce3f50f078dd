#pragma once

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <string>
#include <string_view>

#include "messagelibrary/json/JsonKey.h"

namespace Korvane::Veldra::VeldraMessageLibrary {

// The kinds of a JsonVariant. The numbers are fixed: they are also the token
// kinds of the text scanner (JsonScanner.h).
enum class JsonKind : int32_t {
    None = 0,     // default-constructed; nothing at all
    Null = 1,     // JSON null
    Boolean = 2,  // true / false
    Number = 3,   // every JSON number, integers included, as a double
    String = 4,   // UTF-8 bytes, owned
    Array = 5,    // ordered elements, owned
    Object = 6,   // members sorted by key (bytes, then length), owned
};

class JsonVariant;
struct JsonMember;
namespace JsonBlock {
template <typename T>
struct Block;
}  // namespace JsonBlock

// A contiguous run of elements or members, for range-for loops.
template <typename T>
class JsonRange {
public:
    JsonRange() = default;
    JsonRange(T* first, T* last) : first_(first), last_(last) {}
    T* begin() const { return first_; }
    T* end() const { return last_; }
    std::size_t size() const { return static_cast<std::size_t>(last_ - first_); }
    bool empty() const { return first_ == last_; }
    T& operator[](std::size_t index) const { return first_[index]; }

private:
    T* first_ = nullptr;
    T* last_ = nullptr;
};

// The in-memory tree of one JSON document: a kind and one word of payload.
//
// A variant owns its subtree. It cannot be copied; construction and
// assignment from another variant move: the target's old content is
// destroyed, and the source is left with kind None.
//
// Pointers and references into an array or an object (from Find, At,
// GetOrAdd*, Append, Elements, Members) stay valid until that same
// container is changed by an insertion or removal.
//
// A tree made by Parse lives in one pool owned by its root
// (JsonPooledTree.h): reading it costs nothing extra, and dropping it frees
// the pool at once. The first change through its root copies the tree to
// storage of its own; pointers taken from it before that are then invalid.
//
// Text is parsed into a variant with Parse (JsonParser.h) and turned back into
// text with ToJsonText (JsonVariantText.h). Messages read it only through the
// reader helpers of JsonReaders.h.
class alignas(8) JsonVariant {
public:
    // Bytes of a text kept inside the variant; a longer one is stored apart.
    static constexpr std::size_t kInlineTextCapacity = 11;

    JsonVariant() noexcept = default;
    // An empty value of the kind: null, false, 0.0, "", [] or {}. A kind
    // outside 0..6 throws std::bad_alloc.
    explicit JsonVariant(JsonKind kind);
    explicit JsonVariant(bool value) noexcept;
    explicit JsonVariant(double value) noexcept;
    explicit JsonVariant(std::string_view text);
    explicit JsonVariant(const char* text);  // null gives ""
    explicit JsonVariant(const std::string& text) : JsonVariant(std::string_view(text)) {}

    JsonVariant(JsonVariant&& other) noexcept : kind_(other.kind_) {
        // A copy of constant size, which the compiler turns into two moves (a
        // byte loop would become a call of memcpy).
        std::memcpy(payload_, other.payload_, sizeof(payload_));
        other.kind_ = JsonKind::None;
    }
    JsonVariant& operator=(JsonVariant&& other) noexcept;
    JsonVariant(const JsonVariant&) = delete;
    JsonVariant& operator=(const JsonVariant&) = delete;
    ~JsonVariant();

    // ---- Kind -------------------------------------------------------------
    JsonKind Kind() const noexcept { return kind_; }
    bool IsNone() const noexcept { return kind_ == JsonKind::None; }
    bool IsNull() const noexcept { return kind_ == JsonKind::Null; }
    bool IsBool() const noexcept { return kind_ == JsonKind::Boolean; }
    bool IsNumber() const noexcept { return kind_ == JsonKind::Number; }
    bool IsString() const noexcept { return kind_ == JsonKind::String; }
    bool IsArray() const noexcept { return kind_ == JsonKind::Array; }
    bool IsObject() const noexcept { return kind_ == JsonKind::Object; }

    // ---- Scalar values (a default on a kind mismatch) ---------------------
    // A short text is kept inside the variant: the text pointers stay valid
    // while the variant is neither changed nor moved.
    bool AsBool() const noexcept;              // false unless Boolean
    double AsNumber() const noexcept;          // 0.0 unless Number
    std::string_view AsText() const noexcept;  // "" unless String
    const char* AsCString() const noexcept;    // zero-terminated; null unless String

    // ---- Changing the kind in place ---------------------------------------
    // Destroys the content; kind None.
    void Reset() noexcept;
    void SetNull() noexcept;
    // Becomes a string with this text (assigned in place when already one).
    void SetString(std::string_view text);
    void SetString(const char* text) { SetString(std::string_view(text ? text : "")); }
    void SetString(const std::string& text) { SetString(std::string_view(text)); }
    // Become empty containers / an empty string; an existing value of the
    // wanted kind is only cleared.
    void SetEmptyObject();
    void SetEmptyArray();
    void SetEmptyString();
    // Empties an object, array or string, keeping the kind; any other kind
    // becomes None.
    void Clear();

    // ---- Object members ----------------------------------------------------
    // The member's value, or null when this is no object or the key is absent.
    const JsonVariant* Find(std::string_view key) const noexcept;
    JsonVariant* Find(std::string_view key);
    const JsonVariant* Find(const char* key) const noexcept;
    JsonVariant* Find(const char* key);

    // True and out assigned when the member exists and is a string.
    bool GetString(std::string_view key, std::string& out) const;
    // The member's zero-terminated text, or null when it is no string.
    const char* GetStringPointer(std::string_view key) const noexcept;
    // True and out assigned when the member is a number.
    bool GetDouble(std::string_view key, double& out) const noexcept;
    // The member converted to float; with strict, only when that is exact.
    bool GetFloat(std::string_view key, float& out, bool strict) const noexcept;

    // Insert or replace a member. A None variant becomes an object first; a
    // variant of any other non-object kind is replaced by an empty object.
    void SetNumber(std::string_view key, double value);
    void SetNumber(std::string_view key, uint32_t value);
    void SetBool(std::string_view key, bool value);
    void SetString(std::string_view key, std::string_view text);
    void SetString(std::string_view key, const char* text) {
        SetString(key, std::string_view(text ? text : ""));
    }
    // Inserts or replaces a member with a value that is moved in.
    JsonVariant& Set(std::string_view key, JsonVariant&& value);

    // The member of that kind, created when absent. A member of another kind
    // is replaced by an empty one; with clear an existing one is emptied.
    JsonVariant& GetOrAddObject(std::string_view key, bool clear = false);
    JsonVariant& GetOrAddArray(std::string_view key, bool clear = false);

    // Removes one member; false when it was not there.
    bool Remove(std::string_view key);
    // Removes every member whose key differs from key.
    void RemoveAllExcept(std::string_view key);

    // Members in key order; empty when this is no object.
    JsonRange<const JsonMember> Members() const noexcept;

    // ---- Array elements ----------------------------------------------------
    // Each makes the variant an array when it is none (or any other non-array
    // kind) and appends; returns the new element.
    JsonVariant& Append(JsonVariant&& value);
    JsonVariant& Append(std::string_view text);
    JsonVariant& Append(const char* text) { return Append(std::string_view(text ? text : "")); }
    JsonVariant& Append(const std::string& text) { return Append(std::string_view(text)); }
    JsonVariant& Append(double value);
    JsonVariant& Append(bool value);
    JsonVariant& AppendNull();

    // Makes the variant an array (as Append does) with room for count
    // elements, so that appending them moves nothing.
    void Reserve(std::size_t count);

    // Elements in order; empty when this is no array.
    JsonRange<JsonVariant> Elements();
    JsonRange<const JsonVariant> Elements() const noexcept;
    // Element at index, or null when out of range or no array.
    const JsonVariant* At(std::size_t index) const noexcept;
    JsonVariant* At(std::size_t index);
    // Removes the element at index; false when out of range or no array.
    bool RemoveAt(std::size_t index);

    // Elements of an array, members of an object, bytes of a string; else 0.
    std::size_t Size() const noexcept;

    // ---- Comparison --------------------------------------------------------
    // Equal kinds and equal content. None equals None and Null equals Null;
    // numbers compare as doubles (NaN differs from itself); objects compare
    // member by member in key order.
    friend bool operator==(const JsonVariant& a, const JsonVariant& b) noexcept;
    friend bool operator!=(const JsonVariant& a, const JsonVariant& b) noexcept {
        return !(a == b);
    }

private:
    friend class JsonObjectBuilder;
    friend class JsonPooledTree;
    using Array = JsonBlock::Block<JsonVariant>;
    using Object = JsonBlock::Block<JsonMember>;

    void Destroy() noexcept;
    void SetInlineText(std::string_view text) noexcept;
    void SetBlock(JsonKind kind, void* block) noexcept;
    void SetHeapText(char* text) noexcept;
    // The root of a parsed tree that owns its pool (JsonPooledTree.h).
    bool IsPooledRoot() const noexcept;
    // Puts the block of a pooled tree's root in place and marks the root.
    void SetRootBlock(void* block) noexcept;
    // Before a change: a pooled tree is copied to storage of its own.
    void Own();
    Array* ArrayBlock() const noexcept;
    Object* ObjectBlock() const noexcept;
    Array* MakeArray();
    Object* MakeObject();
    JsonVariant& InsertMember(std::string_view key);  // found or default-inserted

    template <typename T>
    T Load(std::size_t offset) const noexcept;
    template <typename T>
    void Store(std::size_t offset, T value) noexcept;

    JsonKind kind_ = JsonKind::None;
    // The payload's bytes. A boolean is byte 0. A number, or the pointer to
    // the elements or members (null while the container is empty), is bytes
    // 4 to 11. A text of up to 11 bytes stands in place from byte 0 with its
    // zero, and byte 11 holds 11 minus its length; a longer text is on the
    // heap (JsonText.h), its pointer in bytes 0 to 7 and 0xFF in byte 11.
    unsigned char payload_[12] = {};
};

// One member of an object.
struct JsonMember {
    JsonKey key;
    JsonVariant value;
};

// Builds an object from members given in any order, faster than one Set per
// member: members are collected, then sorted once. A repeated key keeps the
// value given last.
class JsonObjectBuilder {
public:
    JsonObjectBuilder() = default;
    JsonObjectBuilder(const JsonObjectBuilder&) = delete;
    JsonObjectBuilder& operator=(const JsonObjectBuilder&) = delete;
    ~JsonObjectBuilder();

    void Reserve(std::size_t count);
    void Add(std::string_view key, JsonVariant&& value);
    // Turns target into the object (its old content is destroyed) and leaves
    // the builder empty.
    void Finish(JsonVariant& target);

private:
    JsonBlock::Block<JsonMember>* members_ = nullptr;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary
