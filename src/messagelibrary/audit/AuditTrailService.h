#pragma once

#include <string>

namespace Korvane::Veldra::VeldraMessageLibrary::AuditTrailMessages {

// The service that keeps the audit trail and its entry types.
inline const std::string kAuditTrailService = "AuditTrail";

}  // namespace Korvane::Veldra::VeldraMessageLibrary::AuditTrailMessages
