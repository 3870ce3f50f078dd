#pragma once

#include <cstdint>
#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <type_traits>
#include <utility>
#include <vector>

#include "errors/ErrorCodes.h"
#include "messagelibrary/json/JsonEnum.h"
#include "messagelibrary/json/JsonVariant.h"
#include "messagelibrary/json/Timestamp.h"

// Reading message fields out of a parsed body.
//
// Every reader takes (destination, variant, key, required). An empty key
// means the variant itself is the value; otherwise the value is the member
// key. A missing member is never a failure unless required is true: the
// destination gets its default. Each returns false when it refuses the
// value; the destination is then unspecified.
//
//   type of destination         key absent          JSON null    accepted
//   bool                        false               refused      true/false
//   int32_t                     0                   refused      number (truncated toward
//                                                                zero, must fit), decimal text
//   double                      0.0                 refused      number; "NaN", "Infinity",
//                                                                "-Infinity"; decimal text
//   Timestamp                   not-a-date-time     refused      text (ParseTimestamp)
//   std::optional<X>            not set             not set      as X
//   std::string                 ""                  ""           text
//   enumeration (JsonEnum.h)    value 0             value 0      its text, exactly; a number
//   JsonStringList, vector<T>   empty               empty        array, each element as T
//   JsonStringMap               empty               empty        object of texts (null: "")
//   map<std::string, T>         empty               empty        object, each member as T
//   record (see below)          default             default      object, field by field
//
// A text that a numeric reader cannot convert throws boost::bad_lexical_cast.
// A refused element refuses the whole list; a refused field refuses the
// whole record.
//
// A record type R takes part by one overload in its own namespace, found by
// argument-dependent lookup, that reads its fields from an object:
//
//     bool ReadJsonFields(TagValue& out, const JsonVariant& object) {
//         return ReadField(out.type, object, "type") && ReadField(out.value, object, "value");
//     }
//
// A message's parsing constructor reads through JsonBodyReader, which turns a
// refusal into the exception that callers match on.

namespace Korvane::Veldra::VeldraMessageLibrary {

using JsonStringList = std::vector<std::string>;
using JsonStringMap = std::map<std::string, std::string>;

// Codes of the exceptions thrown for a refused field.
constexpr int32_t kJsonFieldRefusedCode = ErrorCodes::kFailedToParse;
constexpr int32_t kJsonRecordFieldRefusedCode = ErrorCodes::kException;

class JsonRecordReader;

// A record lists its fields in a static member template JsonFields (see
// messagelibrary/MessageFields.h), or reads them in a ReadJsonFields overload.
template <typename R, typename = void>
struct ListsJsonRecordFields : std::false_type {};
template <typename R>
struct ListsJsonRecordFields<
    R, std::void_t<decltype(R::JsonFields(std::declval<R&>(), std::declval<JsonRecordReader&>()))>>
    : std::true_type {};

template <typename R, typename = void>
struct IsJsonReadableRecord : ListsJsonRecordFields<R> {};
template <typename R>
struct IsJsonReadableRecord<R, std::void_t<decltype(ReadJsonFields(
                                   std::declval<R&>(), std::declval<const JsonVariant&>()))>>
    : std::true_type {};

// ---- Readers of one value ---------------------------------------------------
// value is null when the member is absent (a None variant counts as absent).

bool ReadJsonValue(bool& out, const JsonVariant* value);
bool ReadJsonValue(int32_t& out, const JsonVariant* value);
bool ReadJsonValue(double& out, const JsonVariant* value);
bool ReadJsonValue(Timestamp& out, const JsonVariant* value);
bool ReadJsonValue(std::string& out, const JsonVariant* value);
bool ReadJsonValue(JsonStringMap& out, const JsonVariant* value);
// 64-bit integers are not representable: a present value throws
// VeldraException(-251004, "Int64 not supported by JsonVariant").
bool ReadJsonValue(int64_t& out, const JsonVariant* value);

template <typename E, std::enable_if_t<kIsJsonEnum<E>, int> = 0>
bool ReadJsonValue(E& out, const JsonVariant* value);
template <typename R, std::enable_if_t<IsJsonReadableRecord<R>::value, int> = 0>
bool ReadJsonValue(R& out, const JsonVariant* value);
template <typename T>
bool ReadJsonValue(std::vector<T>& out, const JsonVariant* value);
template <typename T>
bool ReadJsonValue(std::map<std::string, T>& out, const JsonVariant* value);
template <typename T>
bool ReadJsonValue(std::optional<T>& out, const JsonVariant* value);

// ---- Readers of one field ---------------------------------------------------

// Any type of the table above.
template <typename T>
bool ReadField(T& out, const JsonVariant& json, std::string_view key, bool required = false);

// The named forms, for the common field types.
bool ReadBool(bool& out, const JsonVariant& json, std::string_view key, bool required = false);
bool ReadInt32(int32_t& out, const JsonVariant& json, std::string_view key, bool required = false);
bool ReadDouble(double& out, const JsonVariant& json, std::string_view key, bool required = false);
bool ReadTimestamp(Timestamp& out, const JsonVariant& json, std::string_view key,
                   bool required = false);
bool ReadOptionalTimestamp(std::optional<Timestamp>& out, const JsonVariant& json,
                           std::string_view key, bool required = false);
bool ReadOptionalString(std::optional<std::string>& out, const JsonVariant& json,
                        std::string_view key, bool required = false);
bool ReadOptionalStringList(std::optional<JsonStringList>& out, const JsonVariant& json,
                            std::string_view key, bool required = false);
bool ReadOptionalStringMap(std::optional<JsonStringMap>& out, const JsonVariant& json,
                           std::string_view key, bool required = false);
template <typename E>
bool ReadOptionalEnum(std::optional<E>& out, const JsonVariant& json, std::string_view key,
                      bool required = false) {
    static_assert(kIsJsonEnum<E>, "E needs JsonEnumTextsOf(E) in its namespace");
    return ReadField(out, json, key, required);
}
template <typename T>
bool ReadOptionalList(std::optional<std::vector<T>>& out, const JsonVariant& json,
                      std::string_view key, bool required = false) {
    return ReadField(out, json, key, required);
}
template <typename R>
bool ReadOptionalRecord(std::optional<R>& out, const JsonVariant& json, std::string_view key,
                        bool required = false) {
    static_assert(IsJsonReadableRecord<R>::value, "R needs ReadJsonFields(R&, const JsonVariant&)");
    return ReadField(out, json, key, required);
}

// The code a refused field of type T is thrown with: -251004 for an
// enumeration or a record (also when optional), -251005 for everything else.
template <typename T>
struct JsonRefusalCode
    : std::integral_constant<int32_t, (kIsJsonEnum<T> || IsJsonReadableRecord<T>::value)
                                          ? kJsonRecordFieldRefusedCode
                                          : kJsonFieldRefusedCode> {};
template <typename T>
struct JsonRefusalCode<std::optional<T>> : JsonRefusalCode<T> {};

// Throws VeldraException(code, "Failed to parse: " + key).
[[noreturn]] void ThrowFieldRefused(std::string_view key, int32_t code);

// Parses a message body; malformed text throws
// VeldraException(-251005, "Failed to parse: " + messageType).
JsonVariant ParseJsonBody(const std::string& body, const std::string& messageType);

// The reader of a message's parsing constructor:
//
//     const JsonVariant json = ParseJsonBody(body.ToString(), MessageType());
//     JsonBodyReader(json).Field("paths", paths_).Field("allowStale", allowStale_);
//
// A refused field throws VeldraException with "Failed to parse: <key>" and
// the code of JsonRefusalCode.
class JsonBodyReader {
public:
    explicit JsonBodyReader(const JsonVariant& body) noexcept : body_(body) {}

    template <typename T>
    const JsonBodyReader& Field(std::string_view key, T& out) const {
        if (!ReadField(out, body_, key)) ThrowFieldRefused(key, JsonRefusalCode<T>::value);
        return *this;
    }

private:
    const JsonVariant& body_;
};

// The reader a record's field list is called with: the first refused field
// refuses the record, and the fields after it are left alone.
class JsonRecordReader {
public:
    explicit JsonRecordReader(const JsonVariant& object) noexcept : object_(object) {}

    template <typename T>
    JsonRecordReader& Field(std::string_view key, T& out) {
        if (ok_) ok_ = ReadField(out, object_, key);
        return *this;
    }
    bool Ok() const noexcept { return ok_; }

private:
    const JsonVariant& object_;
    bool ok_ = true;
};

// ---- Template definitions ---------------------------------------------------

namespace JsonReadDetail {
// The 32-bit value of a number truncated to 32 bits, or of a text form.
bool ReadEnumValue(int32_t& out, const JsonVariant* value, const JsonEnumTexts& texts);
inline const JsonVariant* Present(const JsonVariant* value) noexcept {
    return value != nullptr && !value->IsNone() ? value : nullptr;
}
}  // namespace JsonReadDetail

template <typename E, std::enable_if_t<kIsJsonEnum<E>, int>>
bool ReadJsonValue(E& out, const JsonVariant* value) {
    int32_t raw = 0;
    if (!JsonReadDetail::ReadEnumValue(raw, value, JsonEnumTextsOf(E{}))) return false;
    out = static_cast<E>(raw);
    return true;
}

template <typename R, std::enable_if_t<IsJsonReadableRecord<R>::value, int>>
bool ReadJsonValue(R& out, const JsonVariant* value) {
    value = JsonReadDetail::Present(value);
    out = R{};
    if (value == nullptr || value->IsNull()) return true;
    if (!value->IsObject()) return false;
    if constexpr (ListsJsonRecordFields<R>::value) {
        JsonRecordReader reader(*value);
        R::JsonFields(out, reader);
        return reader.Ok();
    } else {
        return ReadJsonFields(out, *value);
    }
}

template <typename T>
bool ReadJsonValue(std::vector<T>& out, const JsonVariant* value) {
    value = JsonReadDetail::Present(value);
    out.clear();
    if (value == nullptr || value->IsNull()) return true;
    if (!value->IsArray()) return false;
    out.resize(value->Size());
    std::size_t index = 0;
    for (const JsonVariant& element : value->Elements()) {
        if (!ReadJsonValue(out[index++], &element)) return false;
    }
    return true;
}

template <typename T>
bool ReadJsonValue(std::map<std::string, T>& out, const JsonVariant* value) {
    value = JsonReadDetail::Present(value);
    out.clear();
    if (value == nullptr || value->IsNull()) return true;
    if (!value->IsObject()) return false;
    // Members come in key order: each goes in at the end.
    for (const JsonMember& member : value->Members()) {
        const auto slot = out.emplace_hint(out.end(), member.key.ToString(), T{});
        if (!ReadJsonValue(slot->second, &member.value)) return false;
    }
    return true;
}

template <typename T>
bool ReadJsonValue(std::optional<T>& out, const JsonVariant* value) {
    value = JsonReadDetail::Present(value);
    if (value == nullptr || value->IsNull()) {
        out.reset();
        return true;
    }
    out.emplace();
    return ReadJsonValue(*out, value);
}

template <typename T>
bool ReadField(T& out, const JsonVariant& json, std::string_view key, bool required) {
    const JsonVariant* value = key.empty() ? &json : json.Find(key);
    if (required && JsonReadDetail::Present(value) == nullptr) return false;
    return ReadJsonValue(out, value);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary
