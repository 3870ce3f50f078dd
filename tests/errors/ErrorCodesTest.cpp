#include <gtest/gtest.h>

#include <utility>

#include "errors/ErrorCodes.h"
#include "errors/ErrorTable.h"

using namespace Korvane::Veldra;

TEST(ErrorCodes, MatchTheRegistryTable) {
    using namespace ErrorCodes;
    const std::pair<const char*, int32_t> rows[] = {
        {"Veldra.InternalServiceError", kInternalServiceError},
        {"Veldra.Exception", kException},
        {"Veldra.FailedToParse", kFailedToParse},
        {"Veldra.InvalidSemaphoreInitialization", kInvalidSemaphoreInitialization},
        {"Veldra.InsufficientResources", kInsufficientResources},
        {"Veldra.NotSupported", kNotSupported},
        {"Veldra.InsufficientPrivileges", kInsufficientPrivileges},
        {"Veldra.MultipleInitializations", kMultipleInitializations},
        {"Veldra.NoVeldraConfigurations", kNoVeldraConfigurations},
        {"Veldra.ConfigDirectoryNotFound", kConfigDirectoryNotFound},
        {"Veldra.DuplicateConfigurationId", kDuplicateConfigurationId},
        {"Veldra.EndOfStream", kEndOfStream},
        {"Veldra.QueueEmpty", kQueueEmpty},
        {"Veldra.FailedToInitializeKVSSL", kFailedToInitializeKVSSL},
        {"Veldra.AMQPErrorOpeningTCPConnection", kOpeningTCPConnection},
        {"Veldra.AMQPErrorClosingTCPConnection", kClosingTCPConnection},
        {"Veldra.AMQPErrorEndingTCPConnection", kEndingTCPConnection},
        {"Veldra.AMQPErrorCreatingTCPSocket", kCreatingTCPSocket},
        {"Veldra.AMQPErrorCreatingSSLSocket", kCreatingSSLSocket},
        {"Veldra.AMQPErrorOpeningSocket", kOpeningSocket},
        {"Veldra.AMQPErrorSettingCACertificate", kSettingCACertificate},
        {"Veldra.AMQPErrorFailedToLogIn", kFailedToLogIn},
        {"Veldra.AMQPErrorOpeningChannel", kOpeningChannel},
        {"Veldra.AMQPErrorDeclaringQueue", kDeclaringQueue},
        {"Veldra.AMQPErrorObtainingQueueName", kObtainingQueueName},
        {"Veldra.AMQPErrorBindingQueue", kBindingQueue},
        {"Veldra.AMQPErrorUnbindingQueue", kUnbindingQueue},
        {"Veldra.AMQPErrorDeclaringExchange", kDeclaringExchange},
        {"Veldra.AMQPErrorPerformingBasicConsume", kPerformingBasicConsume},
        {"Veldra.AMQPErrorPublishingMessage", kPublishingMessage},
        {"Veldra.AMQPErrorDequeueingMessage", kDequeueingMessage},
        {"Veldra.AMQPErrorCertificateExpired", kCertificateExpired},
        {"Veldra.AMQPErrorPeerVerifyFailed", kPeerVerifyFailed},
        {"Veldra.FailedToLoadCertificate", kFailedToLoadCertificate},
        {"Veldra.UnexpectedException", kUnexpectedException},
        {"Veldra.AMQPErrorSettingQoS", kSettingQoS},
        {"Tag.InvalidTagReference", kInvalidTagReference},
    };
    for (const auto& [name, code] : rows) {
        const MessageBus::ErrorRow* row = MessageBus::FindErrorRow(name);
        ASSERT_NE(row, nullptr) << name;
        EXPECT_EQ(row->code, code) << name;
    }
}
