#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

#include "messagebus/interfaces/IRoutingSource.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageError.h"
#include "messagelibrary/MessageHeaders.h"

namespace Korvane::Veldra::MessageBus {

// A received message before decoding: its headers and its body bytes. The
// receiver compares MessageType() and then calls the parsing constructor of
// the class it expects. Read-only once handed on.
class GenericMessage : public Interfaces::IRoutingSource {
public:
    GenericMessage(MessageHeaders headers, MessageBody body);

    const std::string& CorrelationId() const override { return headers_.correlationId; }
    const std::string& ReplyTo() const override { return headers_.ReplyTo(); }
    ~GenericMessage() override = default;

    const MessageHeaders& Headers() const { return headers_; }
    const MessageBody& Body() const { return body_; }

    const std::string* GetHeader(std::string_view key) const { return headers_.GetHeader(key); }
    bool GetHeaderAsBool(std::string_view key) const { return headers_.GetHeaderAsBool(key); }
    std::optional<std::string> GetOptionalHeader(std::string_view key) const {
        return headers_.GetOptionalHeader(key);
    }
    bool Persistent() const { return headers_.Persistent(); }
    bool IgnoreResponse() const { return headers_.IgnoreResponse(); }
    const std::string& Origin() const { return headers_.Origin(); }
    const std::string& MessageId() const { return headers_.MessageId(); }
    const std::string& MessageType() const { return headers_.messageType; }
    const std::string& ContentType() const { return headers_.contentType; }
    const std::string& RoutingKey() const { return headers_.routingKey; }
    const std::string& ConsumerTag() const { return headers_.ConsumerTag(); }
    uint32_t DeliveryTag() const { return headers_.DeliveryTag(); }
    const VeldraMessageLibrary::Timestamp& GetTimestamp() const { return headers_.timestamp; }
    MessageError GetError() const { return headers_.GetError(); }
    bool HasError() const { return headers_.HasError(); }
    std::string DebugText() const { return headers_.DebugText(); }

private:
    MessageHeaders headers_;
    MessageBody body_;
};

}  // namespace Korvane::Veldra::MessageBus
