#pragma once

#include <cstdint>

namespace Korvane::Veldra::ErrorCodes {

// Named codes of the registry rows that the library raises by itself. Each
// equals the code of its row in errors/ErrorTable.cpp (a test checks them).
constexpr int32_t kInternalServiceError = -251000;
constexpr int32_t kException = -251004;
constexpr int32_t kFailedToParse = -251005;
constexpr int32_t kInvalidSemaphoreInitialization = -251006;
constexpr int32_t kInsufficientResources = -251007;
constexpr int32_t kNotSupported = -251008;
constexpr int32_t kInsufficientPrivileges = -251009;
constexpr int32_t kMultipleInitializations = -251010;
constexpr int32_t kNoVeldraConfigurations = -251011;
constexpr int32_t kConfigDirectoryNotFound = -251012;
constexpr int32_t kDuplicateConfigurationId = -251013;
constexpr int32_t kEndOfStream = -251014;
constexpr int32_t kQueueEmpty = -251015;
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
constexpr int32_t kUnexpectedException = -251037;
constexpr int32_t kSettingQoS = -251040;
constexpr int32_t kInvalidTagReference = -251900;

}  // namespace Korvane::Veldra::ErrorCodes
