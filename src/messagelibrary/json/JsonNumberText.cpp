#include "messagelibrary/json/JsonNumberText.h"

#include <locale.h>

#include <charconv>
#include <clocale>
#include <cmath>
#include <cstdlib>
#include <limits>
#include <string>
#include <system_error>

namespace Korvane::Veldra::VeldraMessageLibrary::Jsonz {
namespace {

bool IsDigit(char c) noexcept {
    return c >= '0' && c <= '9';
}

// Checks the whole token against "-"? d* ("." d*)? ([eE] [+-]? d+)? with at
// least one digit before the exponent.
bool IsNumberText(const char* p, const char* end) noexcept {
    if (p != end && *p == '-') ++p;
    std::size_t mantissaDigits = 0;
    while (p != end && IsDigit(*p)) ++p, ++mantissaDigits;
    if (p != end && *p == '.') {
        ++p;
        while (p != end && IsDigit(*p)) ++p, ++mantissaDigits;
    }
    if (mantissaDigits == 0) return false;
    if (p != end && (*p == 'e' || *p == 'E')) {
        ++p;
        if (p != end && (*p == '+' || *p == '-')) ++p;
        if (p == end || !IsDigit(*p)) return false;
        while (p != end && IsDigit(*p)) ++p;
    }
    return p == end;
}

// The C locale, made once: strtod_l with it reads "." whatever the process's
// locale is.
locale_t CLocale() noexcept {
    static const locale_t locale = newlocale(LC_ALL_MASK, "C", static_cast<locale_t>(nullptr));
    return locale;
}

}  // namespace

bool ConvertJsonDouble(const char* start, std::size_t length, double& out) noexcept {
    if (start == nullptr) return false;
    const char* end = start + length;
    if (!IsNumberText(start, end)) return false;
    double value = 0.0;
    const auto result = std::from_chars(start, end, value, std::chars_format::general);
    if (result.ec == std::errc() && result.ptr == end) {
        out = value;
        return true;
    }
    if (result.ec != std::errc::result_out_of_range) return false;
    // Beyond the double's range: strtod gives the infinity or the zero that
    // the C library would.
    const locale_t locale = CLocale();
    if (locale == static_cast<locale_t>(nullptr)) return false;
    try {
        const std::string copy(start, length);
        out = strtod_l(copy.c_str(), nullptr, locale);
    } catch (...) {
        return false;
    }
    return true;
}

bool ConvertJsonUInt64(const char* start, std::size_t length, bool isFloat,
                       uint64_t& out) noexcept {
    if (start == nullptr) return false;
    if (isFloat) {
        double value = 0.0;
        if (!ConvertJsonDouble(start, length, value)) return false;
        // 2^64 is the first double beyond the range.
        if (!(value >= 0.0 && value < 18446744073709551616.0) || std::trunc(value) != value) {
            return false;
        }
        out = static_cast<uint64_t>(value);
        return true;
    }
    const char* end = start + length;
    if (start == end || !IsDigit(*start)) return false;
    uint64_t value = 0;
    const auto result = std::from_chars(start, end, value, 10);
    if (result.ec != std::errc() || result.ptr != end) return false;
    out = value;
    return true;
}

bool ConvertJsonUInt32(const char* start, std::size_t length, bool isFloat,
                       uint32_t& out) noexcept {
    uint64_t value = 0;
    if (!ConvertJsonUInt64(start, length, isFloat, value)) return false;
    if (value > std::numeric_limits<uint32_t>::max()) return false;
    out = static_cast<uint32_t>(value);
    return true;
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::Jsonz
