#pragma once

#include <gtest/gtest.h>

#include <chrono>
#include <cstdint>
#include <functional>
#include <optional>
#include <string>

#include "kvveldra/TagConsole.h"
#include "support/ExportedNumbers.h"
#include "support/FaultProxy.h"

namespace Korvane::Veldra::Testing {

using Millis = std::chrono::milliseconds;

// The service's request time-out, and what a call may take beyond it.
inline constexpr Millis kRequestTimeout{10000};
inline constexpr Millis kCallMargin{2000};

// One console call: its status, its error text and how long it took.
struct CallResult {
    int32_t status = 0;
    std::string error;
    Millis took{0};
};

// True for the statuses a console call may give when the broker or the way to
// it fails: the time-out, or one of the bus's AMQP errors.
bool IsBusFailure(int32_t status);

// What MeasureFault saw: from the fault to the first failed call (none when
// every call in the window succeeded), and from lifting the fault to the first
// successful call.
struct FaultFigures {
    std::optional<Millis> firstError;
    int32_t errorStatus = 0;
    std::optional<Millis> firstSuccess;
};

// The console family on the default instance, which reaches the broker only
// through a FaultProxy, against a reference tag service that talks to the
// broker directly and keeps its tags in a store file.
class FaultBrokerTest : public ::testing::Test {
protected:
    // Started by the first test, so that a failure fails it rather than
    // showing every test as skipped.
    void SetUp() override;
    static void TearDownTestSuite();

    static FaultProxy& Proxy();
    // Starts the service again on its store, for a node that lost its queues.
    static void RestartService();

    static std::string UniquePath(const std::string& stem);
    static uint32_t Open(const std::string& path);
    static CallResult Write(uint32_t reference, const std::string& value);
    static CallResult Read(uint32_t reference, TagConsoleValue& value);

    // Applies nothing itself: the fault is on when it is called. Calls
    // `call` until one fails or `window` ends, then `lift`s the fault and
    // calls until one succeeds, within `recoveryLimit`. Checks that every call
    // returns within the time-out and its margin with a bus failure, and
    // prints one line of figures named `name`.
    // A fault of the node that lasts a whole call window: `inject` starts
    // it on a fresh tag, then MeasureFault with writes of `value`.
    static FaultFigures MeasureNodeFault(const std::string& name, const std::string& value,
                                         const std::function<::testing::AssertionResult()>& inject,
                                         const std::function<void()>& lift);
    static FaultFigures MeasureFault(const std::string& name, const std::function<CallResult()>& call,
                                     Millis window, const std::function<void()>& lift,
                                     Millis recoveryLimit = Millis(60000));

private:
    static void StartSuite();
};

}  // namespace Korvane::Veldra::Testing
