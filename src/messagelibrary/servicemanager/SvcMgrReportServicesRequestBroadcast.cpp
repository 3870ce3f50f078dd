#include "messagelibrary/servicemanager/SvcMgrReportServicesRequestBroadcast.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages {

SvcMgrReportServicesRequestBroadcast::SvcMgrReportServicesRequestBroadcast(
    std::optional<std::string> requestingNodeName)
    : MessageBus::BroadcastMessage(kMessageName, MessageBus::kJsonContentType),
      requestingNodeName_(std::move(requestingNodeName)) {}

SvcMgrReportServicesRequestBroadcast::SvcMgrReportServicesRequestBroadcast(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::BroadcastMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody SvcMgrReportServicesRequestBroadcast::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages
