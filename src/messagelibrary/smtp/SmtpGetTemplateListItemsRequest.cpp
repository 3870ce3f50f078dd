#include "messagelibrary/smtp/SmtpGetTemplateListItemsRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/smtp/SmtpService.h"

namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages {

SmtpGetTemplateListItemsRequest::SmtpGetTemplateListItemsRequest()
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType, kSmtpService) {}

SmtpGetTemplateListItemsRequest::SmtpGetTemplateListItemsRequest(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody SmtpGetTemplateListItemsRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages
