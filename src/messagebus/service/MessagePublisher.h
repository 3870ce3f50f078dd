#pragma once

#include <memory>
#include <string>

#include "messagebus/interfaces/IPublishCallback.h"
#include "messagelibrary/GenericMessage.h"
#include "messagelibrary/MessageBase.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageHeaders.h"
#include "utilities/tracelogging/ITraceLogger.h"
#include "utilities/tracelogging/TracePoint.h"

namespace Korvane::Veldra::MessageBus {

class AmqpChannel;
class AmqpConnectionManager;
class PublishMessageCallback;

// The send half of a message service: stamps each message with the sender's
// reply queue and name and publishes it on one channel of the publisher
// connection, on the calling thread.
class MessagePublisher {
public:
    // Opens the publisher channel, connecting on first use. A null manager
    // means the process singleton. With a logger, sent messages are traced at
    // its "RawMessages" point.
    MessagePublisher(std::string origin, std::string replyTo,
                     AmqpConnectionManager* connectionManager,
                     Interfaces::ITraceLogger* traceLogger = nullptr);
    ~MessagePublisher();
    MessagePublisher(const MessagePublisher&) = delete;
    MessagePublisher& operator=(const MessagePublisher&) = delete;

    // Stamps the message in place, then publishes it. Throws AmqpException
    // (Veldra.AMQPErrorPublishingMessage) when the publish fails.
    void Publish(MessageBase& message, bool mandatory);
    // Publishes a stamped copy of the received message's headers.
    void Publish(const GenericMessage& message, bool mandatory);

    // Sets "ReplyTo" when empty, gives the message its identity (id,
    // correlation id, time) and sets "Origin" when empty.
    void Stamp(MessageHeaders& headers) const;
    // Publishes headers that are stamped already.
    void Send(const MessageHeaders& headers, const MessageBody& body, bool mandatory);

    // The adapter by which other components publish through this publisher.
    std::shared_ptr<Interfaces::IPublishCallback> GetPublishCallback() const;

    const std::string& Origin() const { return origin_; }
    const std::string& ReplyTo() const { return replyTo_; }
    const std::string& ExchangeName() const { return exchangeName_; }

private:
    // ---- State ----
    std::shared_ptr<PublishMessageCallback> publishCallback_;
    TracePoint rawMessagesPoint_;
    Interfaces::ITraceLogger* traceLogger_;
    std::string origin_;
    std::string replyTo_;
    std::string exchangeName_;
    std::shared_ptr<AmqpChannel> channel_;
    AmqpConnectionManager* connectionManager_;
};

}  // namespace Korvane::Veldra::MessageBus
