#pragma once

#include <gtest/gtest.h>

#include <cstdint>
#include <functional>
#include <string>
#include <vector>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageHeaders.h"
#include "support/CatchVeldra.h"

// What the message family tests share beside the class table: a message
// parsed from a body, the body a message writes, and the check that a
// malformed field is refused with its key and the code of its type.

namespace Korvane::Veldra::VeldraMessageLibrary::Testing {

// The message parsed from a body, with the headers of its own class.
template <typename M>
M Parse(const std::string& body) {
    MessageBus::MessageHeaders headers;
    headers.messageType = M::kMessageName;
    return M(headers, MessageBus::MessageBody(body));
}

template <typename M>
std::string Written(const M& message) {
    return message.Serialize().ToString();
}

// A body that parse must refuse with code and "Failed to parse: <key>".
struct RefusedField {
    std::function<void(const std::string&)> parse;
    const char* body;
    int32_t code;
    const char* key;
};

inline void ExpectRefusals(const std::vector<RefusedField>& cases) {
    for (const RefusedField& c : cases) {
        SCOPED_TRACE(c.body);
        EXPECT_THROWS_VELDRA(c.parse(c.body), c.code, std::string("Failed to parse: ") + c.key);
    }
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::Testing
