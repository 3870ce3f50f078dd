#pragma once

#include <string>

namespace kvtag::serve {

// The page kvtag serve shows, built into the program: the HTML, which
// carries the write token and the write form only when writing is on, and
// the script and style sheet it loads from the same server.
std::string PageHtml(bool allowWrite, const std::string& token);
const char* PageScript();
const char* PageStyle();

}  // namespace kvtag::serve
