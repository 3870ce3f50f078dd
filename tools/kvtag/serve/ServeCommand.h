#pragma once

#include "CommandLine.h"

namespace kvtag {

// Runs kvtag serve until SIGINT or SIGTERM; 0 then. Prints
// "kvtag serve: listening on http://HOST:PORT/" on standard output once
// the page can be fetched. Throws LibraryError (no broker or service
// setup), UsageError (an address that is not one) and ToolError (an
// address that cannot be bound).
int RunServe(const Invocation& call);

}  // namespace kvtag
