#include "client/ClientBrokerSupport.h"

#include <unistd.h>

#include <atomic>

#include "support/BrokerEnvironment.h"
#include "taglibrary/requests/AsyncRequestFactories.h"

namespace Korvane::Veldra::Testing {

TagServiceProcess* ClientBrokerTest::service = nullptr;
bool ClientBrokerTest::startAttempted = false;

void ClientBrokerTest::SetUp() {
    // One attempt only: a service that did not start once fails every test
    // at once instead of making each wait for it again.
    if (!startAttempted) {
        startAttempted = true;
        StartSuite();
    }
    ASSERT_NE(service, nullptr) << "the tag service did not start (see the first test)";
}

void ClientBrokerTest::StartSuite() {
    // Both configurations are on disk before anything reads the data root.
    const std::string& root = UseBrokerDataRoot();
    BrokerSettings unreachable = Broker();
    unreachable.AmqpPort = 1;  // privileged and unused: the connect is refused
    WriteBrokerDataRoot(unreachable, root, kUnreachableId);
    try {
        service = new TagServiceProcess();
    } catch (const std::exception& error) {
        ADD_FAILURE() << error.what();
    }
}

void ClientBrokerTest::TearDownTestSuite() {
    delete service;
    service = nullptr;
}

void ClientBrokerTest::TearDown() {
    if (HasFailure() && service != nullptr) std::cerr << "service output:\n" << service->Output();
}

std::shared_ptr<TagIngestion::Errors> ClientBrokerTest::NewErrors() {
    auto errors = std::make_shared<TagIngestion::Errors>();
    errors->initialize();
    return errors;
}

std::unique_ptr<Client> ClientBrokerTest::NewClient(uint32_t connectTimeoutMs) {
    return std::make_unique<Client>("veldra_master", connectTimeoutMs, false, false, NewErrors());
}

std::string ClientBrokerTest::UniquePath(const std::string& stem) {
    static std::atomic<int> next{0};
    return "client." + stem + "." + std::to_string(getpid()) + "." + std::to_string(next++);
}

int32_t ClientBrokerTest::Open(Client& client, const std::string& path,
                               std::optional<TagDataType> type, std::shared_ptr<TagData>& tag,
                               std::string& error, bool* created) {
    auto lookup = std::make_shared<ConsoleAsyncRequest>();
    uint32_t id = 0, timeoutMs = 0;
    int32_t status = client.OpenTag(path, lookup, id, timeoutMs, error);
    if (status != 0) return status;
    lookup->Wait(timeoutMs);
    auto create = std::make_shared<ConsoleAsyncRequest>();
    bool found = false;
    status = client.OpenOrCreateTag(7, path, type, create, found, tag, id, timeoutMs, error);
    if (created != nullptr) *created = !found;
    if (status != 0 || found) return status;
    create->Wait(timeoutMs);
    return client.FinishCreateTag(7, path, type, id, tag, error);
}

}  // namespace Korvane::Veldra::Testing
