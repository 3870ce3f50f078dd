#pragma once

#include <string>
#include <vector>

namespace Korvane::Veldra::Bench {

// Writes the SQLite store that kvveldra-tagservice --store reads, with a
// Double tag of each path, in one transaction: a service started on the file
// knows them all at once, without a create request each. Throws
// std::exception when a path cannot be a tag or the file cannot be written.
void WriteTagStore(const std::string& file, const std::vector<std::string>& paths);

}  // namespace Korvane::Veldra::Bench
