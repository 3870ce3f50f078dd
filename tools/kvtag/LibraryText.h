#pragma once

#include <string>
#include <vector>

namespace kvtag {

// A refusal of the service that came without its inserts reaches the caller
// as the library's notice: Too few inserts passed to format the message:
// "Tag '{0}' has type string ...". Given that notice and the inserts kvtag
// knows ({0} first: the path), this gives the filled sentence. Any other
// text, or a notice with an insert that is not given, comes back unchanged.
std::string FilledLibraryText(const std::string& text, const std::vector<std::string>& inserts);

}  // namespace kvtag
