#include "messagelibrary/configuration/ConfigurationSetKeysRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/configuration/ConfigurationService.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages {

ConfigurationSetKeysRequest::ConfigurationSetKeysRequest(std::optional<std::string> user,
                                                         std::optional<std::string> section,
                                                         std::optional<JsonStringMap> keys)
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType, kConfigurationService),
      user_(std::move(user)),
      section_(std::move(section)),
      keys_(std::move(keys)) {}

ConfigurationSetKeysRequest::ConfigurationSetKeysRequest(MessageBus::MessageHeaders headers,
                                                         const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody ConfigurationSetKeysRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages
