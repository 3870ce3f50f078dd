#pragma once

#include <string>
#include <vector>

#include "messagelibrary/ErrorRecord.h"
#include "messagelibrary/MessageError.h"

namespace Korvane::Veldra::TagService {

using VeldraMessageLibrary::ErrorRecord;

// The registered text of an error with its inserts filled in; the name itself
// when it is not registered.
std::string ErrorText(const std::string& fullName, const std::vector<std::string>& args);

// The error of a reply's headers, with the registered text as its info.
MessageBus::MessageError ServiceError(const std::string& fullName,
                                      std::vector<std::string> args = {});

// One failure inside a body, about the tag at path.
ErrorRecord TagErrorRecord(const std::string& fullName, const std::string& path);

// "Veldra.OneOrMoreErrorsOccurred" holding the failures.
ErrorRecord AggregateErrorRecord(std::vector<ErrorRecord> failures);

}  // namespace Korvane::Veldra::TagService
