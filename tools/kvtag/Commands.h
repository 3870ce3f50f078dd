#pragma once

#include <vector>

#include "CommandLine.h"
#include "ConsoleSession.h"
#include "Report.h"
#include "StdinLines.h"

namespace kvtag {

// Checks what can be checked before anything is sent: the values of a
// write (VALUE, or the lines of --stdin) against the --type given with
// them. Throws UsageError.
void CheckBeforeSending(const Invocation& call, const std::vector<TagBatch>& batches);

// The current values of the tags, one record each in their order. Throws
// LibraryError.
std::vector<TagConsoleValue> ReadValues(const ConsoleInstance& instance,
                                        const std::vector<FoundTag>& tags);

// Runs one subcommand (not help, not serve) on an initialized instance. `batches` are
// the lines of write --stdin, read before. Throws LibraryError, ToolError,
// and UsageError for a value that does not suit the type of its tag.
Rendered RunCommand(const Invocation& call, const ConsoleInstance& instance,
                    const std::vector<TagBatch>& batches);

}  // namespace kvtag
