#pragma once

#include <gtest/gtest.h>

#include <cstdint>
#include <memory>
#include <string>
#include <vector>

#include "kvveldra/TagConsole.h"
#include "support/ExportedNumbers.h"
#include "support/SuiteTagService.h"

namespace Korvane::Veldra::Testing {


// The console family on the default instance, against one reference tag
// service for the suite whose tags live in a store file, so that the service
// can be stopped and started again. Each test works under paths of its own.
class ConsoleBrokerTest : public ::testing::Test {
protected:
    // The service and the instance are started by the first test, not in
    // SetUpTestSuite: a failure there would show every test as skipped, and
    // ctest would pass the run. Here each test fails while they are not up.
    void SetUp() override;
    static void TearDownTestSuite();

    // Restarts the service on the same store.
    static void StartService();
    static void StopService();

    // A path no other test or run uses.
    static std::string UniquePath(const std::string& stem);
    // Opens (creating) the path and returns its reference; fails the test
    // on any other status.
    static uint32_t Open(const std::string& path, int32_t type);
    // Writes one sample and checks the status.
    static void Write(uint32_t reference, int32_t type, const std::string& value,
                      TagConsoleTime timestamp);
    // Reads one tag; fails the test unless exactly one record came.
    static TagConsoleValue ReadOne(uint32_t reference);
    // Closes `count` times, each with status 0.
    static void Close(uint32_t reference, int count = 1);

private:
    static SuiteTagService& Suite();
    static void StartSuite();
};

}  // namespace Korvane::Veldra::Testing
