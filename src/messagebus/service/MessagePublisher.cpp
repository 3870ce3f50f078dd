#include "messagebus/service/MessagePublisher.h"

#include <utility>

#include "messagebus/amqp/AmqpConnectionManager.h"
#include "messagebus/service/PublishMessageCallback.h"

namespace Korvane::Veldra::MessageBus {
namespace {

constexpr const char* kRawMessagesPoint = "RawMessages";

AmqpConnectionManager* ManagerOr(AmqpConnectionManager* manager) {
    return manager != nullptr ? manager : AmqpConnectionManager::GetInstance();
}

}  // namespace

MessagePublisher::MessagePublisher(std::string origin, std::string replyTo,
                                   AmqpConnectionManager* connectionManager,
                                   Interfaces::ITraceLogger* traceLogger)
    : publishCallback_(std::make_shared<PublishMessageCallback>(this)),
      rawMessagesPoint_(traceLogger != nullptr ? traceLogger->GetTracePoint(kRawMessagesPoint)
                                               : TracePoint(kRawMessagesPoint)),
      traceLogger_(traceLogger),
      origin_(std::move(origin)),
      replyTo_(std::move(replyTo)),
      connectionManager_(ManagerOr(connectionManager)) {
    exchangeName_ = connectionManager_->GetExchangeName();
    channel_ = connectionManager_->CreatePublisherChannel();
}

MessagePublisher::~MessagePublisher() = default;

void MessagePublisher::Stamp(MessageHeaders& headers) const {
    if (headers.ReplyTo().empty()) headers.SetReplyTo(replyTo_);
    headers.EnsureIdentity();
    if (headers.Origin().empty()) headers.SetOrigin(origin_);
}

void MessagePublisher::Send(const MessageHeaders& headers, const MessageBody& body,
                            bool mandatory) {
    connectionManager_->Publish(channel_, headers, body, mandatory);
    if (traceLogger_ != nullptr && rawMessagesPoint_.enabled) {
        traceLogger_->Log(rawMessagesPoint_, "MsgTx | " + headers.DebugText());
    }
}

void MessagePublisher::Publish(MessageBase& message, bool mandatory) {
    Stamp(message.Headers());
    Send(message.Headers(), message.Serialize(), mandatory);
}

void MessagePublisher::Publish(const GenericMessage& message, bool mandatory) {
    MessageHeaders headers = message.Headers();
    Stamp(headers);
    Send(headers, message.Body(), mandatory);
}

std::shared_ptr<Interfaces::IPublishCallback> MessagePublisher::GetPublishCallback() const {
    return publishCallback_;
}

}  // namespace Korvane::Veldra::MessageBus
