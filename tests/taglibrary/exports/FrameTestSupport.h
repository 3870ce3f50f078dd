#pragma once

#include <gtest/gtest.h>

#include "kvveldra/TagConsole.h"
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
