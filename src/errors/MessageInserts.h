#pragma once

#include <string>
#include <vector>

namespace Korvane::Veldra::MessageBus {

// Replaces the numbered inserts "{0}", "{1}", ... of a message text. Never
// throws for a bad text: a malformed number or a missing insert is reported
// in the result instead.
std::string ApplyInserts(const std::string& message, const std::vector<std::string>& inserts);

}  // namespace Korvane::Veldra::MessageBus
