#pragma once

#include <gtest/gtest.h>

#include "kvveldra/TagConsole.h"
#include "taglibrary/exports/Instances.h"
#include "taglibrary/exports/ProcessState.h"

namespace FrameTestSupport {

using namespace Korvane::Veldra::TagLibrary;

// Holds one reservation for the length of a test, so every test starts from
// empty tables and leaves them empty.
class ReservedProcess : public ::testing::Test {
protected:
    void SetUp() override { ASSERT_EQ(TagConsoleReserve(&reserved_), 0); }
    void TearDown() override {
        ASSERT_EQ(TagConsoleUnreserve(&reserved_), 0);
        ASSERT_EQ(ProcessState::Get().ReserveCount.load(), 0);
    }

    // The initialize functions of both families, making Clients without a bus.
    static int32_t InitializeLocal(uint64_t instanceId, const std::string* configurationId,
                                   const uint32_t* timeoutMs, const bool* allowFallback,
                                   std::string* error) {
        return InitializeConsoleInstance(instanceId, configurationId, timeoutMs, allowFallback,
                                         error, LocalClientFactory());
    }
    static int32_t InitializeHostLocal(uint64_t instanceId, WBStrHandle* configurationId,
                                       uint32_t timeoutMs, const bool* allowFallback,
                                       bool* created, WBStrHandle* error) {
        return InitializeHostInstance(instanceId, configurationId, timeoutMs, allowFallback,
                                      created, error, LocalClientFactory());
    }

    static std::shared_ptr<Client> ClientOf(uint64_t instanceId, bool* present = nullptr) {
        auto& state = ProcessState::Get();
        std::lock_guard<std::mutex> lock(state.TableMutex);
        const auto found = state.ClientTable.find(instanceId);
        if (present != nullptr) *present = found != state.ClientTable.end();
        return found == state.ClientTable.end() ? nullptr : found->second;
    }

    static bool HasReference(uint32_t reference) {
        auto& state = ProcessState::Get();
        std::lock_guard<std::mutex> lock(state.TableMutex);
        return state.TagReferenceTable.count(reference) == 1;
    }

    bool reserved_ = false;
};

}  // namespace FrameTestSupport
