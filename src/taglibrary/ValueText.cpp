#include "taglibrary/ValueText.h"

#include <boost/lexical_cast.hpp>
#include <cmath>
#include <cstdio>
#include <cstring>
#include <limits>

namespace Korvane::Veldra::TagLibrary {

std::string FormatDouble(double value) {
    if (std::isnan(value)) return "NaN";
    if (std::isinf(value)) return value < 0 ? "-Infinity" : "Infinity";
    char buffer[32];
    const int length = std::snprintf(buffer, sizeof buffer, "%.*g", 17, value);
    return std::string(buffer, static_cast<std::size_t>(length));
}

double ParseDouble(const std::string& text) {
    if (text.empty() || text == "NaN") {
        constexpr uint64_t kQuietNaN = 0x7FF8000000000000ULL;
        double nan;
        std::memcpy(&nan, &kQuietNaN, sizeof nan);
        return nan;
    }
    if (text == "Infinity") return std::numeric_limits<double>::infinity();
    if (text == "-Infinity") return -std::numeric_limits<double>::infinity();
    return boost::lexical_cast<double>(text);
}

int32_t ParseInt(const std::string& text) {
    if (text.empty()) return 0;
    return boost::lexical_cast<int32_t>(text);
}

bool ParseBool(const std::string& text) {
    return text == "true" || text == "True" || text == "TRUE" || text == "1";
}

bool IsValidTagPath(const std::string& path) {
    return !path.empty() && path.find('*') == std::string::npos;
}

}  // namespace Korvane::Veldra::TagLibrary
