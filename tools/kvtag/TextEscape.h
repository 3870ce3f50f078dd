#pragma once

#include <string>
#include <string_view>

namespace kvtag {

// A text as the plain output shows it: a backslash becomes \\, a tab \t, a
// line feed \n, a carriage return \r, and any other control character (and
// DEL) \xHH, so that one record stays one line and its tab-separated fields
// stay apart. Other bytes, UTF-8 included, pass unchanged.
std::string EscapeText(std::string_view text);

}  // namespace kvtag
