#include <gtest/gtest.h>

#include <utility>

#include "errors/ErrorTable.h"
#include "messagebus/BusErrorCodes.h"

namespace Korvane::Veldra::MessageBus {
namespace {

TEST(BusErrorCodes, MatchTheRegistryTable) {
    using namespace BusErrorCodes;
    const std::pair<const char*, int32_t> rows[] = {
        {"Veldra.Exception", kException},
        {"Veldra.FailedToParse", kFailedToParse},
        {"Veldra.InvalidSemaphoreInitialization", kInvalidSemaphoreInitialization},
        {"Veldra.InsufficientResources", kInsufficientResources},
        {"Veldra.NotSupported", kNotSupported},
        {"Veldra.InsufficientPrivileges", kInsufficientPrivileges},
        {"Veldra.EndOfStream", kEndOfStream},
        {"Veldra.QueueEmpty", kQueueEmpty},
    };
    for (const auto& [name, code] : rows) {
        const ErrorRow* row = FindErrorRow(name);
        ASSERT_NE(row, nullptr) << name;
        EXPECT_EQ(row->code, code) << name;
    }
}

}  // namespace
}  // namespace Korvane::Veldra::MessageBus
