#include "messagelibrary/configuration/ConfigurationGetSectionsRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/configuration/ConfigurationService.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages {

ConfigurationGetSectionsRequest::ConfigurationGetSectionsRequest()
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType,
                                 kConfigurationService) {}

ConfigurationGetSectionsRequest::ConfigurationGetSectionsRequest(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody ConfigurationGetSectionsRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages
