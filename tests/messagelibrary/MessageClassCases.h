#pragma once

#include <gtest/gtest.h>

#include <algorithm>
#include <functional>
#include <memory>
#include <ostream>
#include <string>
#include <type_traits>
#include <utility>
#include <vector>

#include "messagebus/interfaces/IRoutingSource.h"
#include "messagelibrary/MessageBase.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageError.h"
#include "messagelibrary/MessageHeaders.h"

// A table of message classes for the tests every class must pass: the written
// body, the round trip through the parsing constructor, the parse failures and,
// for responses, the error form. A family lists its classes with MessageCaseOf
// and instantiates MessageClassTest over them.

namespace Korvane::Veldra::MessageBus::Testing {

using MessagePtr = std::unique_ptr<MessageBase>;

struct MessageCase {
    std::string name;
    std::string routingKey;  // of the message made by make; responses answer kRequest
    std::string body;        // of the message made by make
    std::function<MessagePtr(const Interfaces::IRoutingSource& request)> make;
    std::function<MessagePtr(MessageHeaders, const MessageBody&)> parse;
    // Responses only: the answer that carries an error.
    std::function<MessagePtr(const Interfaces::IRoutingSource& request)> makeError;
};

inline void PrintTo(const MessageCase& c, std::ostream* os) {
    *os << c.name;
}

// A class whose sending constructor make calls with every field set.
template <typename Message, typename Make>
MessageCase MessageCaseOf(std::string routingKey, std::string body, Make make) {
    MessageCase c{Message::kMessageName,
                  std::move(routingKey),
                  std::move(body),
                  [make](const Interfaces::IRoutingSource& request) -> MessagePtr {
                      if constexpr (std::is_invocable_v<Make, const Interfaces::IRoutingSource&>) {
                          return std::make_unique<Message>(make(request));
                      } else {
                          (void)request;
                          return std::make_unique<Message>(make());
                      }
                  },
                  [](MessageHeaders headers, const MessageBody& body) -> MessagePtr {
                      return std::make_unique<Message>(std::move(headers), body);
                  },
                  nullptr};
    if constexpr (std::is_constructible_v<Message, const Interfaces::IRoutingSource&,
                                          const MessageError&>) {
        c.makeError = [](const Interfaces::IRoutingSource& request) -> MessagePtr {
            return std::make_unique<Message>(request, MessageError::Named("Tag.NoSuchTag"));
        };
    }
    return c;
}

class MessageClassTest : public ::testing::TestWithParam<MessageCase> {};
// Over the responses of a table only.
class MessageResponseTest : public ::testing::TestWithParam<MessageCase> {};

inline std::vector<MessageCase> ResponsesOf(std::vector<MessageCase> cases) {
    cases.erase(std::remove_if(cases.begin(), cases.end(),
                               [](const MessageCase& c) { return !c.makeError; }),
                cases.end());
    return cases;
}

}  // namespace Korvane::Veldra::MessageBus::Testing
