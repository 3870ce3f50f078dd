#include "messagelibrary/configuration/ConfigurationSetValueRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/configuration/ConfigurationService.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages {

ConfigurationSetValueRequest::ConfigurationSetValueRequest(std::optional<std::string> user,
                                                           std::optional<std::string> section,
                                                           std::optional<std::string> key,
                                                           std::optional<std::string> value)
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType, kConfigurationService),
      user_(std::move(user)),
      section_(std::move(section)),
      key_(std::move(key)),
      value_(std::move(value)) {}

ConfigurationSetValueRequest::ConfigurationSetValueRequest(MessageBus::MessageHeaders headers,
                                                           const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody ConfigurationSetValueRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages
