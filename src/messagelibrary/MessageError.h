#pragma once

#include <string>
#include <vector>

#include "errors/ErrorCode.h"

namespace Korvane::Veldra::MessageBus {

// The error a response carries in its headers: the registry record of the
// error, a descriptive text and the inserts of the record's message.
struct MessageError {
    ErrorCode code;
    std::string info;
    std::vector<std::string> args;

    // An error to send, by its full name ("Tag.NoSuchTag"); no registry look-up.
    static MessageError Named(const std::string& fullName, std::vector<std::string> args = {},
                              std::string info = {});

    std::string FullName() const { return code.FullName(); }
    // The text form for logs: full name, ": ", info.
    std::string Text() const { return FullName() + ": " + info; }
};

}  // namespace Korvane::Veldra::MessageBus
