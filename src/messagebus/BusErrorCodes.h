#pragma once

#include <cstdint>

namespace Korvane::Veldra::MessageBus::BusErrorCodes {

// Codes of the registry rows that the bus and the message layer throw with.
// They must match the table in errors/ErrorTable.cpp.
constexpr int32_t kException = -251004;
constexpr int32_t kFailedToParse = -251005;
constexpr int32_t kInvalidSemaphoreInitialization = -251006;
constexpr int32_t kInsufficientResources = -251007;
constexpr int32_t kNotSupported = -251008;
constexpr int32_t kInsufficientPrivileges = -251009;
constexpr int32_t kEndOfStream = -251014;
constexpr int32_t kQueueEmpty = -251015;

}  // namespace Korvane::Veldra::MessageBus::BusErrorCodes
