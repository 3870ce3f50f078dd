#pragma once

#include <chrono>
#include <string>

#include "support/RawAmqpConnection.h"

namespace Korvane::Veldra::Testing {

// Listens to every message on a topic exchange of the private broker, through
// a server-named exclusive queue of its own bound with "#". The constructor
// reports a failure to set up as a test failure and leaves Ready() false.
class BusSniffer {
public:
    explicit BusSniffer(const std::string& exchange = "kvveldra.amqpio.test");

    bool Ready() const { return ready_; }

    // The body of the first message, not read by an earlier call, whose body
    // contains needle; other messages are skipped. "" when none came within
    // the timeout or the sniffer is not ready.
    std::string WaitForBody(const std::string& needle, std::chrono::milliseconds timeout);

private:
    bool Step(const char* what, const ::testing::AssertionResult& result);

    RawAmqpConnection connection_;
    bool ready_ = false;
};

}  // namespace Korvane::Veldra::Testing
