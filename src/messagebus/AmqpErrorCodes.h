#pragma once

#include <cstdint>

namespace Korvane::Veldra::MessageBus::AmqpErrorCodes {

// Codes of the registry rows that the AMQP layer throws with. They must match
// the table in errors/ErrorTable.cpp.
constexpr int32_t kException = -251004;
constexpr int32_t kFailedToInitializeKVSSL = -251016;
constexpr int32_t kOpeningTCPConnection = -251017;
constexpr int32_t kClosingTCPConnection = -251018;
constexpr int32_t kEndingTCPConnection = -251019;
constexpr int32_t kCreatingTCPSocket = -251020;
constexpr int32_t kCreatingSSLSocket = -251021;
constexpr int32_t kOpeningSocket = -251022;
constexpr int32_t kSettingCACertificate = -251023;
constexpr int32_t kFailedToLogIn = -251024;
constexpr int32_t kOpeningChannel = -251025;
constexpr int32_t kDeclaringQueue = -251026;
constexpr int32_t kObtainingQueueName = -251027;
constexpr int32_t kBindingQueue = -251028;
constexpr int32_t kUnbindingQueue = -251029;
constexpr int32_t kDeclaringExchange = -251030;
constexpr int32_t kPerformingBasicConsume = -251031;
constexpr int32_t kPublishingMessage = -251032;
constexpr int32_t kDequeueingMessage = -251033;
constexpr int32_t kCertificateExpired = -251034;
constexpr int32_t kPeerVerifyFailed = -251035;
constexpr int32_t kFailedToLoadCertificate = -251036;
constexpr int32_t kSettingQoS = -251040;

}  // namespace Korvane::Veldra::MessageBus::AmqpErrorCodes
