#include "messagelibrary/servicemanager/SvcMgrReportServicesResponseBroadcast.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages {

SvcMgrReportServicesResponseBroadcast::SvcMgrReportServicesResponseBroadcast(
    std::optional<std::string> nodeName, std::optional<std::vector<ServiceInfo>> services)
    : MessageBus::BroadcastMessage(kMessageName, MessageBus::kJsonContentType),
      nodeName_(std::move(nodeName)),
      services_(std::move(services)) {}

SvcMgrReportServicesResponseBroadcast::SvcMgrReportServicesResponseBroadcast(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::BroadcastMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody SvcMgrReportServicesResponseBroadcast::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages
