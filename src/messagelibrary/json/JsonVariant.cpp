#include "messagelibrary/json/JsonVariant.h"

#include <algorithm>
#include <cmath>
#include <cstring>
#include <limits>
#include <new>

#include "messagelibrary/json/JsonBlock.h"
#include "messagelibrary/json/JsonPooledTree.h"
#include "messagelibrary/json/JsonText.h"

namespace Korvane::Veldra::VeldraMessageLibrary {
namespace {

constexpr std::size_t kInlineCapacity = JsonVariant::kInlineTextCapacity;
constexpr std::size_t kMarker = 11;  // byte: 11 - length, or kHeapText
constexpr unsigned char kHeapText = 0xFF;
constexpr std::size_t kWord = 4;  // offset of a number or container pointer
// Byte 0 of a container: kPooledRoot when it is the root of a parsed tree
// that owns its pool (JsonPooledTree.h), else 0.
constexpr std::size_t kPooledRootByte = 0;
constexpr unsigned char kPooledRoot = 1;
// Objects of up to this many members are searched from the front.
constexpr std::size_t kScanLimit = 8;

using Members = JsonBlock::Block<JsonMember>;

// Whether text starts with the bytes of key. Keys are short: a plain loop
// beats a call to memcmp here.
bool SameBytes(const char* text, std::string_view key) noexcept {
    for (std::size_t i = 0; i < key.size(); ++i) {
        if (text[i] != key[i]) return false;
    }
    return true;
}

bool KeyLess(const JsonMember& member, std::string_view key) noexcept {
    return JsonKeyLess(member.key, key);
}

// The member with key, or the position where it would be inserted.
JsonMember* LowerBound(Members* members, std::string_view key) noexcept {
    if (members == nullptr) return nullptr;
    return std::lower_bound(members->begin(), members->end(), key, KeyLess);
}

bool IsAt(const Members* members, const JsonMember* position, std::string_view key) noexcept {
    return position != nullptr && position != members->end() && position->key == key;
}

// Sorts by key, keeping the order of equal keys, then keeps only the last of
// each run of equal keys.
void SortAndDeduplicate(Members* members) {
    if (members == nullptr || members->size < 2) return;
    JsonMember* first = members->begin();
    const std::size_t size = members->size;
    SortByJsonKey(first, size, [](const JsonMember& member) { return member.key.View(); });
    std::size_t kept = 0;
    for (std::size_t i = 0; i < size; ++i) {
        if (i + 1 < size && first[i].key == first[i + 1].key) continue;
        if (kept != i) first[kept] = std::move(first[i]);
        ++kept;
    }
    JsonBlock::Erase(members, kept, size);
}

}  // namespace

template <typename T>
T JsonVariant::Load(std::size_t offset) const noexcept {
    T value;
    std::memcpy(&value, payload_ + offset, sizeof(T));
    return value;
}

template <typename T>
void JsonVariant::Store(std::size_t offset, T value) noexcept {
    std::memcpy(payload_ + offset, &value, sizeof(T));
}

// ---- Construction and destruction ---------------------------------------------

JsonVariant::JsonVariant(JsonKind kind) {
    switch (kind) {
        case JsonKind::None:
        case JsonKind::Null:
        case JsonKind::Boolean:
        case JsonKind::Number:
        case JsonKind::Array:
        case JsonKind::Object:
            // All zero: false, 0.0, an empty container without storage.
            kind_ = kind;
            break;
        case JsonKind::String:
            SetInlineText(std::string_view());
            break;
        default:
            throw std::bad_alloc();
    }
}

JsonVariant::JsonVariant(bool value) noexcept : kind_(JsonKind::Boolean) {
    payload_[0] = value ? 1 : 0;
}

JsonVariant::JsonVariant(double value) noexcept : kind_(JsonKind::Number) {
    Store(kWord, value);
}

JsonVariant::JsonVariant(std::string_view text) {
    if (text.size() <= kInlineCapacity) {
        SetInlineText(text);
        return;
    }
    SetHeapText(JsonText::Allocate(text));
}

JsonVariant::JsonVariant(const char* text) : JsonVariant(std::string_view(text ? text : "")) {}

JsonVariant& JsonVariant::operator=(JsonVariant&& other) noexcept {
    if (this != &other) {
        // Take the content first: other may live inside this variant's tree.
        const JsonKind kind = other.kind_;
        unsigned char payload[sizeof(payload_)];
        std::memcpy(payload, other.payload_, sizeof(payload_));
        other.kind_ = JsonKind::None;
        Destroy();
        kind_ = kind;
        std::memcpy(payload_, payload, sizeof(payload_));
    }
    return *this;
}

JsonVariant::~JsonVariant() {
    Destroy();
}

void JsonVariant::Destroy() noexcept {
    switch (kind_) {
        case JsonKind::String:
            if (payload_[kMarker] == kHeapText) JsonText::Free(Load<char*>(0));
            break;
        case JsonKind::Array:
            if (IsPooledRoot()) {
                JsonPooledTree::Release(*this);
            } else {
                JsonBlock::Free(Load<Array*>(kWord));
            }
            break;
        case JsonKind::Object:
            if (IsPooledRoot()) {
                JsonPooledTree::Release(*this);
            } else {
                JsonBlock::Free(Load<Object*>(kWord));
            }
            break;
        default:
            break;
    }
    kind_ = JsonKind::None;
}

void JsonVariant::SetInlineText(std::string_view text) noexcept {
    if (!text.empty()) std::memcpy(payload_, text.data(), text.size());
    payload_[text.size()] = 0;
    payload_[kMarker] = static_cast<unsigned char>(kInlineCapacity - text.size());
    kind_ = JsonKind::String;
}

void JsonVariant::SetBlock(JsonKind kind, void* block) noexcept {
    Destroy();
    Store(kWord, block);
    payload_[kPooledRootByte] = 0;
    kind_ = kind;
}

void JsonVariant::SetHeapText(char* text) noexcept {
    Store(0, text);
    payload_[kMarker] = kHeapText;
    kind_ = JsonKind::String;
}

bool JsonVariant::IsPooledRoot() const noexcept {
    return (kind_ == JsonKind::Array || kind_ == JsonKind::Object) &&
           payload_[kPooledRootByte] == kPooledRoot;
}

void JsonVariant::SetRootBlock(void* block) noexcept {
    Store(kWord, block);
    payload_[kPooledRootByte] = kPooledRoot;
}

void JsonVariant::Own() {
    // The copy is whole before the pool goes: assignment takes it first.
    if (IsPooledRoot()) *this = JsonPooledTree::Clone(*this);
}

void JsonVariant::Reset() noexcept {
    Destroy();
}

void JsonVariant::SetNull() noexcept {
    Destroy();
    kind_ = JsonKind::Null;
}

// ---- Scalars ------------------------------------------------------------------

bool JsonVariant::AsBool() const noexcept {
    return IsBool() && payload_[0] != 0;
}

double JsonVariant::AsNumber() const noexcept {
    return IsNumber() ? Load<double>(kWord) : 0.0;
}

std::string_view JsonVariant::AsText() const noexcept {
    if (!IsString()) return std::string_view();
    if (payload_[kMarker] == kHeapText) return JsonText::View(Load<const char*>(0));
    return {reinterpret_cast<const char*>(payload_), kInlineCapacity - payload_[kMarker]};
}

const char* JsonVariant::AsCString() const noexcept {
    if (!IsString()) return nullptr;
    if (payload_[kMarker] == kHeapText) return Load<const char*>(0);
    return reinterpret_cast<const char*>(payload_);
}

void JsonVariant::SetString(std::string_view text) {
    // Built apart first: text may point into this variant.
    *this = JsonVariant(text);
}

void JsonVariant::SetEmptyObject() {
    if (IsObject()) {
        Clear();
        return;
    }
    SetBlock(JsonKind::Object, nullptr);
}

void JsonVariant::SetEmptyArray() {
    if (IsArray()) {
        Clear();
        return;
    }
    SetBlock(JsonKind::Array, nullptr);
}

void JsonVariant::SetEmptyString() {
    Destroy();
    SetInlineText(std::string_view());
}

void JsonVariant::Clear() {
    Own();
    switch (kind_) {
        case JsonKind::String:
            SetEmptyString();
            break;
        case JsonKind::Array:
            if (Array* elements = ArrayBlock()) JsonBlock::Clear(elements);
            break;
        case JsonKind::Object:
            if (Object* members = ObjectBlock()) JsonBlock::Clear(members);
            break;
        default:
            Destroy();
            break;
    }
}

// ---- Containers ---------------------------------------------------------------

JsonVariant::Array* JsonVariant::ArrayBlock() const noexcept {
    return IsArray() ? Load<Array*>(kWord) : nullptr;
}

JsonVariant::Object* JsonVariant::ObjectBlock() const noexcept {
    return IsObject() ? Load<Object*>(kWord) : nullptr;
}

// The container's block after turning the variant into one. Operations that
// may move the block store the new pointer back when they are done.
JsonVariant::Array* JsonVariant::MakeArray() {
    Own();
    if (!IsArray()) SetBlock(JsonKind::Array, nullptr);
    return Load<Array*>(kWord);
}

JsonVariant::Object* JsonVariant::MakeObject() {
    Own();
    if (!IsObject()) SetBlock(JsonKind::Object, nullptr);
    return Load<Object*>(kWord);
}

std::size_t JsonVariant::Size() const noexcept {
    switch (kind_) {
        case JsonKind::String:
            return AsText().size();
        case JsonKind::Array: {
            const Array* elements = ArrayBlock();
            return elements == nullptr ? 0 : elements->size;
        }
        case JsonKind::Object: {
            const Object* members = ObjectBlock();
            return members == nullptr ? 0 : members->size;
        }
        default:
            return 0;
    }
}

// ---- Object members -------------------------------------------------------------

const JsonVariant* JsonVariant::Find(std::string_view key) const noexcept {
    Object* members = ObjectBlock();
    if (members == nullptr) return nullptr;
    // A message's record has a handful of members: a scan that compares
    // lengths first beats a binary search there.
    if (members->size <= kScanLimit) {
        for (const JsonMember& member : *members) {
            if (member.key.size() == key.size() && SameBytes(member.key.c_str(), key)) {
                return &member.value;
            }
        }
        return nullptr;
    }
    JsonMember* position = LowerBound(members, key);
    return IsAt(members, position, key) ? &position->value : nullptr;
}

JsonVariant* JsonVariant::Find(std::string_view key) {
    Own();
    return const_cast<JsonVariant*>(static_cast<const JsonVariant*>(this)->Find(key));
}

const JsonVariant* JsonVariant::Find(const char* key) const noexcept {
    return key == nullptr ? nullptr : Find(std::string_view(key));
}

JsonVariant* JsonVariant::Find(const char* key) {
    return key == nullptr ? nullptr : Find(std::string_view(key));
}

bool JsonVariant::GetString(std::string_view key, std::string& out) const {
    const JsonVariant* value = Find(key);
    if (value == nullptr || !value->IsString()) return false;
    out.assign(value->AsText());
    return true;
}

const char* JsonVariant::GetStringPointer(std::string_view key) const noexcept {
    const JsonVariant* value = Find(key);
    return value == nullptr ? nullptr : value->AsCString();
}

bool JsonVariant::GetDouble(std::string_view key, double& out) const noexcept {
    const JsonVariant* value = Find(key);
    if (value == nullptr || !value->IsNumber()) return false;
    out = value->AsNumber();
    return true;
}

bool JsonVariant::GetFloat(std::string_view key, float& out, bool strict) const noexcept {
    double number = 0.0;
    if (!GetDouble(key, number)) return false;
    // A finite value beyond float's range has no conversion.
    if (std::isfinite(number) && std::fabs(number) > std::numeric_limits<float>::max()) {
        return false;
    }
    const float converted = static_cast<float>(number);
    if (strict && static_cast<double>(converted) != number) return false;
    out = converted;
    return true;
}

JsonVariant& JsonVariant::InsertMember(std::string_view key) {
    Object* members = MakeObject();
    JsonMember* position = LowerBound(members, key);
    if (IsAt(members, position, key)) return position->value;
    const std::size_t index =
        members == nullptr ? 0 : static_cast<std::size_t>(position - members->begin());
    JsonMember member{JsonKey(key), JsonVariant()};
    if (members == nullptr) members = JsonBlock::Create<JsonMember>(4);
    JsonVariant& value = JsonBlock::Insert(members, index, std::move(member)).value;
    Store(kWord, members);
    return value;
}

JsonVariant& JsonVariant::Set(std::string_view key, JsonVariant&& value) {
    // value may live inside this object: take it out before inserting.
    JsonVariant moved(std::move(value));
    JsonVariant& slot = InsertMember(key);
    slot = std::move(moved);
    return slot;
}

void JsonVariant::SetNumber(std::string_view key, double value) {
    Set(key, JsonVariant(value));
}

void JsonVariant::SetNumber(std::string_view key, uint32_t value) {
    Set(key, JsonVariant(static_cast<double>(value)));
}

void JsonVariant::SetBool(std::string_view key, bool value) {
    Set(key, JsonVariant(value));
}

void JsonVariant::SetString(std::string_view key, std::string_view text) {
    Set(key, JsonVariant(text));
}

JsonVariant& JsonVariant::GetOrAddObject(std::string_view key, bool clear) {
    JsonVariant& member = InsertMember(key);
    if (!member.IsObject() || clear) member.SetEmptyObject();
    return member;
}

JsonVariant& JsonVariant::GetOrAddArray(std::string_view key, bool clear) {
    JsonVariant& member = InsertMember(key);
    if (!member.IsArray() || clear) member.SetEmptyArray();
    return member;
}

bool JsonVariant::Remove(std::string_view key) {
    Own();
    Object* members = ObjectBlock();
    JsonMember* position = LowerBound(members, key);
    if (!IsAt(members, position, key)) return false;
    const auto index = static_cast<std::size_t>(position - members->begin());
    JsonBlock::Erase(members, index, index + 1);
    return true;
}

void JsonVariant::RemoveAllExcept(std::string_view key) {
    Own();
    Object* members = ObjectBlock();
    if (members == nullptr) return;
    JsonMember* position = LowerBound(members, key);
    if (!IsAt(members, position, key)) {
        JsonBlock::Clear(members);
        return;
    }
    const auto index = static_cast<std::size_t>(position - members->begin());
    JsonBlock::Erase(members, index + 1, members->size);
    JsonBlock::Erase(members, 0, index);
}

JsonRange<const JsonMember> JsonVariant::Members() const noexcept {
    const Object* members = ObjectBlock();
    if (members == nullptr) return {};
    return {members->begin(), members->end()};
}

// ---- Array elements -------------------------------------------------------------

void JsonVariant::Reserve(std::size_t count) {
    Array* elements = MakeArray();
    if (elements == nullptr) {
        if (count > 0) Store(kWord, JsonBlock::Create<JsonVariant>(count));
        return;
    }
    JsonBlock::Reserve(elements, count);
    Store(kWord, elements);
}

JsonVariant& JsonVariant::Append(JsonVariant&& value) {
    JsonVariant moved(std::move(value));
    Array* elements = MakeArray();
    if (elements == nullptr) elements = JsonBlock::Create<JsonVariant>(4);
    JsonVariant& added = JsonBlock::Append(elements, std::move(moved));
    Store(kWord, elements);
    return added;
}

JsonVariant& JsonVariant::Append(std::string_view text) {
    return Append(JsonVariant(text));
}

JsonVariant& JsonVariant::Append(double value) {
    return Append(JsonVariant(value));
}

JsonVariant& JsonVariant::Append(bool value) {
    return Append(JsonVariant(value));
}

JsonVariant& JsonVariant::AppendNull() {
    return Append(JsonVariant(JsonKind::Null));
}

JsonRange<JsonVariant> JsonVariant::Elements() {
    Own();
    Array* elements = ArrayBlock();
    if (elements == nullptr) return {};
    return {elements->begin(), elements->end()};
}

JsonRange<const JsonVariant> JsonVariant::Elements() const noexcept {
    const Array* elements = ArrayBlock();
    if (elements == nullptr) return {};
    return {elements->begin(), elements->end()};
}

const JsonVariant* JsonVariant::At(std::size_t index) const noexcept {
    const Array* elements = ArrayBlock();
    if (elements == nullptr || index >= elements->size) return nullptr;
    return &(*elements)[index];
}

JsonVariant* JsonVariant::At(std::size_t index) {
    Own();
    return const_cast<JsonVariant*>(static_cast<const JsonVariant*>(this)->At(index));
}

bool JsonVariant::RemoveAt(std::size_t index) {
    Own();
    Array* elements = ArrayBlock();
    if (elements == nullptr || index >= elements->size) return false;
    JsonBlock::Erase(elements, index, index + 1);
    return true;
}

// ---- Comparison ---------------------------------------------------------------

bool operator==(const JsonVariant& a, const JsonVariant& b) noexcept {
    if (a.kind_ != b.kind_) return false;
    switch (a.kind_) {
        case JsonKind::Boolean:
            return a.AsBool() == b.AsBool();
        case JsonKind::Number:
            return a.AsNumber() == b.AsNumber();
        case JsonKind::String:
            return a.AsText() == b.AsText();
        case JsonKind::Array: {
            const auto x = a.Elements();
            const auto y = b.Elements();
            return x.size() == y.size() && std::equal(x.begin(), x.end(), y.begin());
        }
        case JsonKind::Object: {
            const auto x = a.Members();
            const auto y = b.Members();
            if (x.size() != y.size()) return false;
            for (std::size_t i = 0; i < x.size(); ++i) {
                if (x[i].key != y[i].key || x[i].value != y[i].value) return false;
            }
            return true;
        }
        default:
            return true;
    }
}

// ---- Builder ------------------------------------------------------------------

JsonObjectBuilder::~JsonObjectBuilder() {
    JsonBlock::Free(members_);
}

void JsonObjectBuilder::Reserve(std::size_t count) {
    if (members_ == nullptr) {
        if (count > 0) members_ = JsonBlock::Create<JsonMember>(count);
        return;
    }
    JsonBlock::Reserve(members_, count);
}

void JsonObjectBuilder::Add(std::string_view key, JsonVariant&& value) {
    if (members_ == nullptr) members_ = JsonBlock::Create<JsonMember>(4);
    JsonBlock::Emplace(members_, JsonKey(key), std::move(value));
}

void JsonObjectBuilder::Finish(JsonVariant& target) {
    SortAndDeduplicate(members_);
    Members* members = members_;
    members_ = nullptr;
    target.SetBlock(JsonKind::Object, members);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary
