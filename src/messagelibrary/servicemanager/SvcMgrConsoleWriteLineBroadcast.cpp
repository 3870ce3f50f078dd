#include "messagelibrary/servicemanager/SvcMgrConsoleWriteLineBroadcast.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages {

SvcMgrConsoleWriteLineBroadcast::SvcMgrConsoleWriteLineBroadcast(
    std::optional<std::string> consoleWrite)
    : MessageBus::BroadcastMessage(kMessageName, MessageBus::kJsonContentType),
      consoleWrite_(std::move(consoleWrite)) {}

SvcMgrConsoleWriteLineBroadcast::SvcMgrConsoleWriteLineBroadcast(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::BroadcastMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody SvcMgrConsoleWriteLineBroadcast::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages
