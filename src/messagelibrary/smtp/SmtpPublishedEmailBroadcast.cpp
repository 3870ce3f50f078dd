#include "messagelibrary/smtp/SmtpPublishedEmailBroadcast.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages {

SmtpPublishedEmailBroadcast::SmtpPublishedEmailBroadcast(
    std::optional<SmtpAddressGroup> addressGroup, std::optional<std::string> subject,
    std::optional<std::string> contents)
    : MessageBus::BroadcastMessage(kMessageName, MessageBus::kJsonContentType),
      addressGroup_(std::move(addressGroup)),
      subject_(std::move(subject)),
      contents_(std::move(contents)) {}

SmtpPublishedEmailBroadcast::SmtpPublishedEmailBroadcast(MessageBus::MessageHeaders headers,
                                                         const MessageBus::MessageBody& body)
    : MessageBus::BroadcastMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody SmtpPublishedEmailBroadcast::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages
