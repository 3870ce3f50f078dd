#pragma once

#include <cstdint>
#include <string>

namespace Korvane::Veldra::TagLibrary {

// Text forms of tag values, as the host family's variant functions convert
// them. Parse failures throw boost::bad_lexical_cast, which the exported frame
// reports as an unexpected exception.

// "NaN", "Infinity", "-Infinity", or 17 significant digits.
std::string FormatDouble(double value);
// "NaN" and "" give a quiet NaN; "Infinity" and "-Infinity" the infinities.
double ParseDouble(const std::string& text);
// "" gives 0.
int32_t ParseInt(const std::string& text);
// True for exactly "true", "True", "TRUE" and "1"; never fails.
bool ParseBool(const std::string& text);

// A path may be opened when it is not empty and holds no '*'.
bool IsValidTagPath(const std::string& path);

}  // namespace Korvane::Veldra::TagLibrary
