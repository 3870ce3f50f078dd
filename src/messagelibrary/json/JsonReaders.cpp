#include "messagelibrary/json/JsonReaders.h"

#include <boost/lexical_cast.hpp>
#include <cmath>
#include <limits>

#include "errors/VeldraException.h"
#include "messagelibrary/json/JsonParser.h"

namespace Korvane::Veldra::VeldraMessageLibrary {

using JsonReadDetail::Present;

bool ReadJsonValue(bool& out, const JsonVariant* value) {
    value = Present(value);
    out = false;
    if (value == nullptr) return true;
    if (!value->IsBool()) return false;
    out = value->AsBool();
    return true;
}

bool ReadJsonValue(int32_t& out, const JsonVariant* value) {
    value = Present(value);
    out = 0;
    if (value == nullptr) return true;
    if (value->IsString()) {
        const std::string_view text = value->AsText();
        out = boost::lexical_cast<int32_t>(text.data(), text.size());
        return true;
    }
    if (!value->IsNumber()) return false;
    const double truncated = std::trunc(value->AsNumber());
    // NaN fails both comparisons.
    if (!(truncated >= std::numeric_limits<int32_t>::min() &&
          truncated <= std::numeric_limits<int32_t>::max())) {
        return false;
    }
    out = static_cast<int32_t>(truncated);
    return true;
}

bool ReadJsonValue(double& out, const JsonVariant* value) {
    value = Present(value);
    out = 0.0;
    if (value == nullptr) return true;
    if (value->IsNumber()) {
        out = value->AsNumber();
        return true;
    }
    if (!value->IsString()) return false;
    const std::string_view text = value->AsText();
    if (text == "NaN") {
        out = std::numeric_limits<double>::quiet_NaN();
    } else if (text == "Infinity") {
        out = std::numeric_limits<double>::infinity();
    } else if (text == "-Infinity") {
        out = -std::numeric_limits<double>::infinity();
    } else {
        out = boost::lexical_cast<double>(text.data(), text.size());
    }
    return true;
}

bool ReadJsonValue(Timestamp& out, const JsonVariant* value) {
    value = Present(value);
    out = Timestamp(boost::posix_time::not_a_date_time);
    if (value == nullptr) return true;
    if (!value->IsString()) return false;
    return ParseTimestamp(value->AsText(), out);
}

bool ReadJsonValue(std::string& out, const JsonVariant* value) {
    value = Present(value);
    out.clear();
    if (value == nullptr || value->IsNull()) return true;
    if (!value->IsString()) return false;
    out.assign(value->AsText());
    return true;
}

bool ReadJsonValue(JsonStringMap& out, const JsonVariant* value) {
    value = Present(value);
    out.clear();
    if (value == nullptr || value->IsNull()) return true;
    if (!value->IsObject()) return false;
    for (const JsonMember& member : value->Members()) {
        if (!ReadJsonValue(out[member.key.ToString()], &member.value)) return false;
    }
    return true;
}

bool ReadJsonValue(int64_t& out, const JsonVariant* value) {
    out = 0;
    if (Present(value) == nullptr) return true;
    throw MessageBus::VeldraException(kJsonRecordFieldRefusedCode,
                                      "Int64 not supported by JsonVariant");
}

namespace JsonReadDetail {

bool ReadEnumValue(int32_t& out, const JsonVariant* value, const JsonEnumTexts& texts) {
    value = Present(value);
    out = 0;
    if (value == nullptr || value->IsNull()) return true;
    if (value->IsString()) return texts.ValueOf(value->AsText(), out);
    if (!value->IsNumber()) return false;
    // Any number is taken, cut to its low 32 bits; only one without an
    // integer part in range of 64 bits (NaN, infinities) is refused.
    const double truncated = std::trunc(value->AsNumber());
    if (!(truncated > -9223372036854775808.0 - 1.0 && truncated < 9223372036854775808.0)) {
        return false;
    }
    out = static_cast<int32_t>(static_cast<uint32_t>(static_cast<int64_t>(truncated)));
    return true;
}

}  // namespace JsonReadDetail

bool ReadBool(bool& out, const JsonVariant& json, std::string_view key, bool required) {
    return ReadField(out, json, key, required);
}

bool ReadInt32(int32_t& out, const JsonVariant& json, std::string_view key, bool required) {
    return ReadField(out, json, key, required);
}

bool ReadDouble(double& out, const JsonVariant& json, std::string_view key, bool required) {
    return ReadField(out, json, key, required);
}

bool ReadTimestamp(Timestamp& out, const JsonVariant& json, std::string_view key, bool required) {
    return ReadField(out, json, key, required);
}

bool ReadOptionalTimestamp(std::optional<Timestamp>& out, const JsonVariant& json,
                           std::string_view key, bool required) {
    return ReadField(out, json, key, required);
}

bool ReadOptionalString(std::optional<std::string>& out, const JsonVariant& json,
                        std::string_view key, bool required) {
    return ReadField(out, json, key, required);
}

bool ReadOptionalStringList(std::optional<JsonStringList>& out, const JsonVariant& json,
                            std::string_view key, bool required) {
    return ReadField(out, json, key, required);
}

bool ReadOptionalStringMap(std::optional<JsonStringMap>& out, const JsonVariant& json,
                           std::string_view key, bool required) {
    return ReadField(out, json, key, required);
}

void ThrowFieldRefused(std::string_view key, int32_t code) {
    throw MessageBus::VeldraException(code, "Failed to parse: " + std::string(key));
}

JsonVariant ParseJsonBody(const std::string& body, const std::string& messageType) {
    JsonVariant json;
    if (!Parse(json, body)) ThrowFieldRefused(messageType, kJsonFieldRefusedCode);
    return json;
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary
