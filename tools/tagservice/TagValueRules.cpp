#include "TagValueRules.h"

#include <boost/lexical_cast.hpp>
#include <cmath>
#include <cstdint>
#include <limits>

#include "messagelibrary/json/Timestamp.h"
#include "taglibrary/ValueText.h"

namespace Korvane::Veldra::TagService {

namespace {

bool ReadsAsUInt64(const std::string& text) {
    if (text.empty() || text.size() > 20) return false;
    uint64_t value = 0;
    for (const char c : text) {
        if (c < '0' || c > '9') return false;
        const auto digit = static_cast<uint64_t>(c - '0');
        if (value > (std::numeric_limits<uint64_t>::max() - digit) / 10) return false;
        value = value * 10 + digit;
    }
    return true;
}

bool ReadsAsBool(const std::string& text) {
    for (const char* accepted : {"true", "True", "TRUE", "1", "false", "False", "FALSE", "0", ""}) {
        if (text == accepted) return true;
    }
    return false;
}

// The value of a numeric text as a double.
double NumericValue(TagDataType type, const std::string& text) {
    switch (type) {
        case TagDataType::Double: return TagLibrary::ParseDouble(text);
        case TagDataType::Int: return TagLibrary::ParseInt(text);
        default: return static_cast<double>(boost::lexical_cast<uint64_t>(text));
    }
}

// The text of the value as the service writes it: 17 digits for a double,
// plain decimal digits without leading zeros for the integers.
std::string CanonicalText(TagDataType type, const std::string& text) {
    switch (type) {
        case TagDataType::Double: return TagLibrary::FormatDouble(TagLibrary::ParseDouble(text));
        case TagDataType::Int: return std::to_string(TagLibrary::ParseInt(text));
        default: {
            const auto first = text.find_first_not_of('0');
            return first == std::string::npos ? "0" : text.substr(first);
        }
    }
}

// -1, 0 or 1 as a compares with b, both canonical texts; those of UInt64
// compare exactly, as digit strings.
int Compare(TagDataType type, const std::string& a, const std::string& b) {
    if (type == TagDataType::UInt64) {
        if (a.size() != b.size()) return a.size() < b.size() ? -1 : 1;
        return a.compare(b) < 0 ? -1 : (a == b ? 0 : 1);
    }
    const double x = NumericValue(type, a);
    const double y = NumericValue(type, b);
    return x < y ? -1 : (x > y ? 1 : 0);
}

}  // namespace

bool CanReadValue(TagDataType type, const std::string& text) {
    if (text.find('\0') != std::string::npos) return false;
    try {
        switch (type) {
            case TagDataType::Double: TagLibrary::ParseDouble(text); return true;
            case TagDataType::Int: TagLibrary::ParseInt(text); return true;
            case TagDataType::Boolean: return ReadsAsBool(text);
            case TagDataType::UInt64: return ReadsAsUInt64(text);
            case TagDataType::DateTime: {
                VeldraMessageLibrary::Timestamp parsed;
                return VeldraMessageLibrary::ParseTimestampZ(text.c_str(), parsed);
            }
            case TagDataType::String: return true;
            default: return false;
        }
    } catch (const boost::bad_lexical_cast&) {
        return false;
    }
}

bool IsNumericType(TagDataType type) {
    return type == TagDataType::Double || type == TagDataType::Int ||
           type == TagDataType::UInt64;
}

void AddToAggregates(TagAggregates& aggregates, TagDataType type, const std::string& text) {
    if (!IsNumericType(type)) return;
    const double value = NumericValue(type, text);
    if (!std::isfinite(value)) return;
    const std::string canonical = CanonicalText(type, text);
    if (aggregates.count == std::numeric_limits<int32_t>::max()) return;  // saturated
    aggregates.count += 1;
    // Weighted, so that no intermediate sum leaves the range of a double.
    const double weight = 1.0 / aggregates.count;
    aggregates.avg = aggregates.avg * (1.0 - weight) + value * weight;
    if (!aggregates.min || Compare(type, canonical, *aggregates.min) < 0) aggregates.min = canonical;
    if (!aggregates.max || Compare(type, canonical, *aggregates.max) > 0) aggregates.max = canonical;
}

}  // namespace Korvane::Veldra::TagService
