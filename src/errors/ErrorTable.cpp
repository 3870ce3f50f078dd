#include "errors/ErrorTable.h"

#include <cstring>
#include <iterator>

namespace Korvane::Veldra::MessageBus {
namespace {

constexpr ErrorRow kRows[] = {
    {-251000, "Veldra", "InternalServiceError", "Internal Veldra service error."},
    {-251001, "Veldra", "RequestTimedOut", "Request timed out."},
    {-251002, "Veldra", "IOError", "I/O error."},
    {-251003, "Veldra", "OutOfMemory", "Out of memory."},
    {-251004, "Veldra", "Exception", "Veldra exception."},
    {-251005, "Veldra", "FailedToParse", "Failed to parse."},
    {-251006, "Veldra", "InvalidSemaphoreInitialization", "Invalid semaphore initialization."},
    {-251007, "Veldra", "InsufficientResources", "Insufficient resources."},
    {-251008, "Veldra", "NotSupported", "Not supported."},
    {-251009, "Veldra", "InsufficientPrivileges", "Insufficient privileges."},
    {-251010, "Veldra", "MultipleInitializations",
     "Attempt to reinitialize with multiple configurations."},
    {-251011, "Veldra", "NoVeldraConfigurations", "No Veldra configurations available."},
    {-251012, "Veldra", "ConfigDirectoryNotFound", "Veldra configurations directory not found."},
    {-251013, "Veldra", "DuplicateConfigurationId", "Duplicate configuration id."},
    {-251014, "Veldra", "EndOfStream", "End of stream."},
    {-251015, "Veldra", "QueueEmpty", "Queue empty."},
    {-251016, "Veldra", "FailedToInitializeKVSSL", "Failed to initialize KV SSL."},
    {-251017, "Veldra", "AMQPErrorOpeningTCPConnection",
     "AMQP error: Failed to open TCP connection."},
    {-251018, "Veldra", "AMQPErrorClosingTCPConnection",
     "AMQP error: Failed to close TCP connection."},
    {-251019, "Veldra", "AMQPErrorEndingTCPConnection",
     "AMQP error: Failed to end TCP connection."},
    {-251020, "Veldra", "AMQPErrorCreatingTCPSocket", "AMQP error: Failed to create TCP socket."},
    {-251021, "Veldra", "AMQPErrorCreatingSSLSocket", "AMQP error: Failed to create SSL socket."},
    {-251022, "Veldra", "AMQPErrorOpeningSocket", "AMQP error: Failed to open socket."},
    {-251023, "Veldra", "AMQPErrorSettingCACertificate",
     "AMQP error: Failed to set CA certificate."},
    {-251024, "Veldra", "AMQPErrorFailedToLogIn", "AMQP error: Failed to log in."},
    {-251025, "Veldra", "AMQPErrorOpeningChannel", "AMQP error: Failed to open channel."},
    {-251026, "Veldra", "AMQPErrorDeclaringQueue", "AMQP error: Failed to declare queue."},
    {-251027, "Veldra", "AMQPErrorObtainingQueueName", "AMQP error: Failed to obtain queue name."},
    {-251028, "Veldra", "AMQPErrorBindingQueue", "AMQP error: Failed to bind queue."},
    {-251029, "Veldra", "AMQPErrorUnbindingQueue", "AMQP error: Failed to unbind queue."},
    {-251030, "Veldra", "AMQPErrorDeclaringExchange", "AMQP error: Failed to declare exchange."},
    {-251031, "Veldra", "AMQPErrorPerformingBasicConsume",
     "AMQP error: Failed to perform basic consume."},
    {-251032, "Veldra", "AMQPErrorPublishingMessage", "AMQP error: Failed to publish message."},
    {-251033, "Veldra", "AMQPErrorDequeueingMessage", "AMQP error: Failed to dequeue message."},
    {-251034, "Veldra", "AMQPErrorCertificateExpired", "AMQP error: Cetificate expired."},
    {-251035, "Veldra", "AMQPErrorPeerVerifyFailed", "AMQP error: Peer verify failed."},
    {-251036, "Veldra", "FailedToLoadCertificate", "Failed to load certificate."},
    {-251037, "Veldra", "UnexpectedException", "An unexpected exception occurred: {0}"},
    {-251038, "Veldra", "NotFound", "Not found."},
    {-251039, "Veldra", "UnableToLoadClientLibrary",
     "Unable to load a client library. Ensure the KV Duskpath Client is installed."},
    {-251040, "Veldra", "AMQPErrorSettingQoS", "AMQP error: Failed to set quality of service."},
    {-251041, "Veldra", "OneOrMoreErrorsOccurred",
     "One or more errors occurred. See the contained list for details of each error."},
    {-251900, "Tag", "InvalidTagReference", "Invalid tag reference."},
    {-251901, "Tag", "InvalidTagValue", "Invalid tag value."},
    {-251902, "Tag", "InvalidTagDataType", "Invalid tag data type."},
    {-251903, "Tag", "PropertyDoesNotExist", "Property does not exist."},
    {-251904, "Tag", "InvalidTagPath", "Invalid tag path."},
    {-251905, "Tag", "TagPathCannotBeEmpty", "Tag path cannot be empty."},
    {-251906, "Tag", "TagPathCannotContainAWildcard", "Tag path cannot contain a wildcard."},
    {-251907, "Tag", "ConflictingTagTypes", "Conflicting types for tag '{0}': '{1}' != '{2}'."},
    {-251908, "Tag", "StringTagCannotCollectAggregates",
     "Tag '{0}' has type string and cannot collect aggregates."},
    {-251909, "Tag", "NoSuchTag", "No such tag: '{0}'."},
    {-251910, "Tag", "TagAlreadyExists", "Tag already exists: '{0}'."},
    {-251911, "Tag", "NoSuchSelection", "No such selection: '{0}'."},
    {-251912, "Tag", "DuplicateSelection", "Duplicate selection: '{0}'."},
    {-251913, "Tag", "InvalidConfiguraion", "Invalid tag service configuration."},
    {-251914, "Tag", "InvalidState", "Invalid state."},
    {-251915, "Tag", "TagSubscriptionServiceFailedToRespond",
     "TagSubscription service failed to respond."},
    {-251916, "Tag", "TagInfoServiceFailedToRespond", "Tag Info service failed to respond."},
    {-251917, "Tag", "TagPathCannotContainOnlyWhiteSpaceAndDots",
     "Tag path cannot contain only white space and dots."},
    {-251922, "Tag", "TagCurrentValueServiceFailedToRespond",
     "Tag Current Value service failed to respond."},
    {-251923, "Tag", "TagPathInRequestDoesNotMatchUrl",
     "Tag path in request body does not match tag path in URL."},
    {-251924, "Tag", "UpdateSelectionFailed", "Update selection failed."},
    {-251925, "Tag", "InvalidTagType", "Invalid tag type."},
    {-251926, "Tag", "TagsListCannotBeEmptyOrNull", "Tags list cannot be empty or null."},
};

}  // namespace

const ErrorRow* ErrorRows(std::size_t& count) {
    count = std::size(kRows);
    return kRows;
}

const ErrorRow* FindErrorRow(const char* fullName) {
    if (fullName == nullptr) return nullptr;
    for (const auto& row : kRows) {
        const std::size_t categoryLength = std::strlen(row.category);
        if (std::strncmp(fullName, row.category, categoryLength) == 0 &&
            fullName[categoryLength] == '.' &&
            std::strcmp(fullName + categoryLength + 1, row.name) == 0) {
            return &row;
        }
    }
    return nullptr;
}

}  // namespace Korvane::Veldra::MessageBus
