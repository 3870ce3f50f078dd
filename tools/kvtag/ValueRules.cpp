#include "ValueRules.h"

#include <cerrno>
#include <cmath>
#include <cstdint>
#include <cstdlib>

#include "TagTypes.h"
#include "TimeText.h"

namespace kvtag {
namespace {

bool AllDigits(const std::string& text, std::size_t from) {
    if (from >= text.size()) return false;
    for (std::size_t i = from; i < text.size(); ++i) {
        if (text[i] < '0' || text[i] > '9') return false;
    }
    return true;
}

bool IsInt32(const std::string& text) {
    const std::size_t from = !text.empty() && (text[0] == '-' || text[0] == '+') ? 1 : 0;
    if (!AllDigits(text, from)) return false;
    errno = 0;
    const long long value = std::strtoll(text.c_str(), nullptr, 10);
    return errno == 0 && value >= INT32_MIN && value <= INT32_MAX;
}

bool IsUInt64(const std::string& text) {
    if (!AllDigits(text, 0)) return false;
    errno = 0;
    std::strtoull(text.c_str(), nullptr, 10);
    return errno == 0;
}

// A finite text whose value is beyond the largest double: strtod gives an
// infinity and ERANGE. Those the service cannot take either.
bool IsBeyondDouble(int error, double value) {
    return error == ERANGE && std::isinf(value);
}

bool IsDouble(const std::string& text) {
    if (text.empty() || text.front() == ' ' || text.front() == '\t' || text.front() == '\n') {
        return false;
    }
    // Hexadecimal floating texts are not decimal numbers to the service.
    if (text.find_first_of("xX") != std::string::npos) return false;
    char* end = nullptr;
    errno = 0;
    const double value = std::strtod(text.c_str(), &end);
    return end == text.c_str() + text.size() && !IsBeyondDouble(errno, value);
}

// "True" or "False" for a boolean text in any case, or 1 / 0.
std::optional<std::string> BoolText(const std::string& text) {
    std::string lower;
    for (const char c : text) lower += static_cast<char>(c >= 'A' && c <= 'Z' ? c - 'A' + 'a' : c);
    if (lower == "true" || lower == "1") return std::string("True");
    if (lower == "false" || lower == "0") return std::string("False");
    return std::nullopt;
}

}  // namespace

std::string ValueRefusal(int32_t type, const std::string& text) {
    std::string message = "'" + text + "' is not a value of type " + TypeName(type);
    if (type == 0) {
        errno = 0;
        const double value = std::strtod(text.c_str(), nullptr);
        if (IsBeyondDouble(errno, value)) message += ": it is beyond the range of a double";
    } else if (type == 5 && LacksOnlyAZone(text)) {
        message += std::string(": it has no zone; ") + kAddAZone;
    }
    return message;
}

std::optional<std::string> NormalizeValue(int32_t type, const std::string& text) {
    if (text.find('\0') != std::string::npos) return std::nullopt;
    switch (type) {
        case 0:
            return IsDouble(text) ? std::optional<std::string>(text) : std::nullopt;
        case 1:
            return IsInt32(text) ? std::optional<std::string>(text) : std::nullopt;
        case 2:
            return text;
        case 3:
            return BoolText(text);
        case 4:
            return IsUInt64(text) ? std::optional<std::string>(text) : std::nullopt;
        case 5: {
            const auto time = ParseIsoTime(text);
            if (!time) return std::nullopt;
            return FormatIsoTime(*time);
        }
        default:
            return std::nullopt;
    }
}

}  // namespace kvtag
