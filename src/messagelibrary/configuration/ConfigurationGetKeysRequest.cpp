#include "messagelibrary/configuration/ConfigurationGetKeysRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/configuration/ConfigurationService.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages {

ConfigurationGetKeysRequest::ConfigurationGetKeysRequest(std::optional<std::string> section)
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType, kConfigurationService),
      section_(std::move(section)) {}

ConfigurationGetKeysRequest::ConfigurationGetKeysRequest(MessageBus::MessageHeaders headers,
                                                         const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody ConfigurationGetKeysRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages
