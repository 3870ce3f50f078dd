#pragma once

#include <gtest/gtest.h>

#include <csignal>
#include <memory>
#include <string>

#include "errors/Errors.h"
#include "support/TagServiceProcess.h"
#include "taglibrary/Client.h"
#include "taglibrary/requests/ConsoleAsyncRequest.h"

namespace Korvane::Veldra::Testing {

using TagLibrary::Client;
using TagLibrary::ConsoleAsyncRequest;
using TagLibrary::TagData;
using TagLibrary::TagDataType;

// The broker's configuration under the id "veldra_unreachable" points at a
// port where nothing listens.
inline const char* const kUnreachableId = "veldra_unreachable";

// One reference tag service for the suite, on the data root of this process.
// Each test works under paths of its own.
class ClientBrokerTest : public ::testing::Test {
protected:
    // The data root and the service are made by the first test, not in
    // SetUpTestSuite: a failure there would show every test as skipped, and
    // ctest would pass the run. Here each test fails while they are not up.
    void SetUp() override;
    static void TearDownTestSuite();
    void TearDown() override;

    static std::shared_ptr<TagIngestion::Errors> NewErrors();
    // A connected Client on the private broker.
    std::unique_ptr<Client> NewClient(uint32_t connectTimeoutMs = 5000);
    // A path no other test or run uses.
    static std::string UniquePath(const std::string& stem);

    // The whole open as a console caller does it: lookup, wait, and when the
    // lookup found nothing, create, wait, finish. `created` tells which.
    int32_t Open(Client& client, const std::string& path, std::optional<TagDataType> type,
                 std::shared_ptr<TagData>& tag, std::string& error, bool* created = nullptr);

    static TagServiceProcess* service;

private:
    static void StartSuite();
    static bool startAttempted;
};

// Holds the tag service still (SIGSTOP) until Resume or the end of its life.
// A pid of -1 pauses nothing until Pause.
class PausedService {
public:
    explicit PausedService(pid_t pid) { Pause(pid); }
    ~PausedService() { Resume(); }
    void Pause(pid_t pid) {
        pid_ = pid;
        if (pid_ > 0) kill(pid_, SIGSTOP);
    }
    void Resume() {
        if (pid_ > 0) kill(pid_, SIGCONT);
        pid_ = -1;
    }

private:
    pid_t pid_ = -1;
};

}  // namespace Korvane::Veldra::Testing
