#pragma once

#include <cstddef>
#include <cstdint>
#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <type_traits>
#include <utility>
#include <vector>

#include "messagelibrary/json/JsonEnum.h"
#include "messagelibrary/json/JsonOutput.h"
#include "messagelibrary/json/Timestamp.h"

// Writing message bodies as text. Bodies are concatenated directly, without
// a tree and without white space:
//
//     std::string TagCvQueryCurrentValuesByPathRequest::BodyText() const {
//         return JsonBodyWriter().Field("paths", paths_).Field("allowStale", allowStale_).Finish();
//     }
//
// How each type is written:
//
//   bool                      true / false
//   int32_t, int64_t          decimal digits, "-" when negative
//   double                    NaN, Infinity, -Infinity bare (not JSON, but the wire form);
//                             otherwise "%.17g" (17 significant digits, "." always);
//                             also right for "elapsedMinutes", whose text of up to 17
//                             significant digits is the same
//   Timestamp                 "2016-03-01T12:00:00.250000Z" (TimestampToText), quoted
//   std::string, string_view,
//   string literal            a JSON string (escaped as JsonEscape.h tells); a const char*
//                             that is null is written null
//   std::optional<X>          null when not set, else as X. Optional strings are the
//                             message strings: unset gives null, a set "" gives ""
//   std::vector<X>            [x,x,...]
//   std::map<std::string, X>  {"key":x,...} in the map's order, keys escaped
//   enumeration (JsonEnum.h)  its text in quotes; a value without a text gives ""
//   record                    an object of its fields (see below)
//   JsonRaw                   the text as it stands: the caller vouches that it is JSON
//
// A record type R takes part by one overload in its own namespace, found by
// argument-dependent lookup:
//
//     void WriteJsonFields(JsonObjectWriter& out, const TagValue& value) {
//         out.Field("type", value.type).Field("value", value.value);
//     }

namespace Korvane::Veldra::VeldraMessageLibrary {

class JsonObjectWriter;

// Text that is written as it stands, for the few fields with a form of their
// own (a bit set written as a list of names, for example).
struct JsonRaw {
    std::string_view text;
};

// A record lists its fields in a static member template JsonFields (see
// messagelibrary/MessageFields.h), or writes them in a WriteJsonFields overload.
template <typename R, typename = void>
struct ListsJsonWritableFields : std::false_type {};
template <typename R>
struct ListsJsonWritableFields<R,
                               std::void_t<decltype(R::JsonFields(
                                   std::declval<const R&>(), std::declval<JsonObjectWriter&>()))>>
    : std::true_type {};

template <typename R, typename = void>
struct IsJsonWritableRecord : ListsJsonWritableFields<R> {};
template <typename R>
struct IsJsonWritableRecord<R, std::void_t<decltype(WriteJsonFields(
                                   std::declval<JsonObjectWriter&>(), std::declval<const R&>()))>>
    : std::true_type {};

// ---- Single values ----------------------------------------------------------

void AppendJsonNull(JsonOutput& out);
void AppendJsonBool(JsonOutput& out, bool value);
void AppendJsonInt32(JsonOutput& out, int32_t value);
void AppendJsonInt64(JsonOutput& out, int64_t value);
void AppendJsonDouble(JsonOutput& out, double value);
void AppendJsonTimestamp(JsonOutput& out, const Timestamp& value);
// A quoted, escaped string; the text ends at its first zero byte, if any.
void AppendJsonString(JsonOutput& out, std::string_view text);
// A quoted base64 text of the bytes (Base64.h).
void AppendJsonBase64(JsonOutput& out, const void* data, std::size_t size);

// Any type of the table above.
template <typename T>
void AppendJson(JsonOutput& out, const T& value);

// ---- Objects ----------------------------------------------------------------

// Writes one object at the end of a text: "{" at construction, then each
// field as "key":value with commas between, then "}" from Close().
class JsonObjectWriter {
public:
    explicit JsonObjectWriter(JsonOutput& out) : out_(out) { out_.Put('{'); }
    JsonObjectWriter(const JsonObjectWriter&) = delete;
    JsonObjectWriter& operator=(const JsonObjectWriter&) = delete;

    template <typename T>
    JsonObjectWriter& Field(std::string_view key, const T& value) {
        AppendKey(key);
        AppendJson(out_, value);
        return *this;
    }
    // Appends "}". Call exactly once, after the last field.
    void Close() { out_.Put('}'); }

private:
    void AppendKey(std::string_view key);

    JsonOutput& out_;
    bool first_ = true;
};

// A JsonObjectWriter that owns its text: the writer of a whole body.
class JsonBodyWriter {
public:
    JsonBodyWriter() : object_(text_) {}
    explicit JsonBodyWriter(std::size_t reserve) : text_(reserve), object_(text_) {}

    template <typename T>
    JsonBodyWriter& Field(std::string_view key, const T& value) {
        object_.Field(key, value);
        return *this;
    }
    // Closes the object and hands out the text; the writer is spent.
    std::string Finish() {
        object_.Close();
        return text_.Take();
    }

private:
    JsonOutput text_;  // declared before object_, which writes into it
    JsonObjectWriter object_;
};

// ---- Template definitions ---------------------------------------------------

namespace JsonWriteDetail {
void AppendEnum(JsonOutput& out, int32_t value, const JsonEnumTexts& texts);
template <typename T>
struct IsOptional : std::false_type {};
template <typename T>
struct IsOptional<std::optional<T>> : std::true_type {};
template <typename T>
struct IsVector : std::false_type {};
template <typename T, typename A>
struct IsVector<std::vector<T, A>> : std::true_type {};
template <typename T>
struct IsStringMap : std::false_type {};
template <typename T, typename C, typename A>
struct IsStringMap<std::map<std::string, T, C, A>> : std::true_type {};
template <typename T>
inline constexpr bool kAlwaysFalse = false;
}  // namespace JsonWriteDetail

template <typename T>
void AppendJson(JsonOutput& out, const T& value) {
    using namespace JsonWriteDetail;
    if constexpr (std::is_same_v<T, bool>) {
        AppendJsonBool(out, value);
    } else if constexpr (std::is_same_v<T, int32_t>) {
        AppendJsonInt32(out, value);
    } else if constexpr (std::is_same_v<T, int64_t>) {
        AppendJsonInt64(out, value);
    } else if constexpr (std::is_same_v<T, double>) {
        AppendJsonDouble(out, value);
    } else if constexpr (std::is_same_v<T, Timestamp>) {
        AppendJsonTimestamp(out, value);
    } else if constexpr (std::is_same_v<T, JsonRaw>) {
        out.Append(value.text.data(), value.text.size());
    } else if constexpr (std::is_same_v<T, const char*> || std::is_same_v<T, char*>) {
        if (value == nullptr) {
            AppendJsonNull(out);
        } else {
            AppendJsonString(out, std::string_view(value));
        }
    } else if constexpr (std::is_convertible_v<const T&, std::string_view>) {
        AppendJsonString(out, std::string_view(value));
    } else if constexpr (IsOptional<T>::value) {
        if (value.has_value()) {
            AppendJson(out, *value);
        } else {
            AppendJsonNull(out);
        }
    } else if constexpr (IsVector<T>::value) {
        out.Put('[');
        bool first = true;
        for (const auto& element : value) {
            if (!first) out.Put(',');
            first = false;
            AppendJson(out, element);
        }
        out.Put(']');
    } else if constexpr (IsStringMap<T>::value) {
        JsonObjectWriter object(out);
        for (const auto& entry : value) object.Field(entry.first, entry.second);
        object.Close();
    } else if constexpr (kIsJsonEnum<T>) {
        AppendEnum(out, static_cast<int32_t>(value), JsonEnumTextsOf(value));
    } else if constexpr (IsJsonWritableRecord<T>::value) {
        JsonObjectWriter object(out);
        if constexpr (ListsJsonWritableFields<T>::value) {
            T::JsonFields(value, object);
        } else {
            WriteJsonFields(object, value);
        }
        object.Close();
    } else {
        static_assert(kAlwaysFalse<T>, "no JSON form for this type");
    }
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary
