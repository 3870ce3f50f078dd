#include "messagelibrary/configuration/ConfigurationGetSectionKeyValuesRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/configuration/ConfigurationService.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages {

ConfigurationGetSectionKeyValuesRequest::ConfigurationGetSectionKeyValuesRequest()
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType,
                                 kConfigurationService) {}

ConfigurationGetSectionKeyValuesRequest::ConfigurationGetSectionKeyValuesRequest(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody ConfigurationGetSectionKeyValuesRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages
