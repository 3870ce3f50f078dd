#include "messagelibrary/configuration/ConfigurationGetValueRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/configuration/ConfigurationService.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages {

ConfigurationGetValueRequest::ConfigurationGetValueRequest(std::optional<std::string> section,
                                                           std::optional<std::string> key)
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType, kConfigurationService),
      section_(std::move(section)),
      key_(std::move(key)) {}

ConfigurationGetValueRequest::ConfigurationGetValueRequest(MessageBus::MessageHeaders headers,
                                                           const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody ConfigurationGetValueRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages
