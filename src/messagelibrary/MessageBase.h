#pragma once

#include <optional>
#include <string>
#include <string_view>

#include "messagebus/interfaces/IRoutingSource.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageError.h"
#include "messagelibrary/MessageHeaders.h"

namespace Korvane::Veldra::MessageBus {

// The base of every typed message: its headers and the writer of its body.
// A message is built on one thread and then handed over; it has no lock.
class MessageBase : public Interfaces::IRoutingSource {
public:
    const std::string& CorrelationId() const override { return headers_.correlationId; }
    const std::string& ReplyTo() const override { return headers_.ReplyTo(); }
    ~MessageBase() override = default;

    // The body as the message's own JSON text.
    virtual MessageBody Serialize() const = 0;

    virtual MessageHeaders& Headers() { return headers_; }
    virtual const MessageHeaders& Headers() const { return headers_; }

    void SetHeader(std::string_view key, const std::string& value) {
        headers_.SetHeader(key, value);
    }
    void SetHeader(std::string_view key, const char* value) { headers_.SetHeader(key, value); }
    void SetHeader(std::string_view key, const std::optional<std::string>& value) {
        headers_.SetHeader(key, value);
    }
    void SetHeader(std::string_view key, bool value) { headers_.SetHeader(key, value); }
    const std::string* GetHeader(std::string_view key) const { return headers_.GetHeader(key); }
    bool GetHeaderAsBool(std::string_view key) const { return headers_.GetHeaderAsBool(key); }
    std::optional<std::string> GetOptionalHeader(std::string_view key) const {
        return headers_.GetOptionalHeader(key);
    }

    void SetPersistent(bool persistent) { headers_.SetPersistent(persistent); }
    bool Persistent() const { return headers_.Persistent(); }
    void SetIgnoreResponse(bool ignore) { headers_.SetIgnoreResponse(ignore); }
    bool IgnoreResponse() const { return headers_.IgnoreResponse(); }
    void SetReplyTo(const std::string& queue) { headers_.SetReplyTo(queue); }
    void SetOrigin(const std::string& origin) { headers_.SetOrigin(origin); }
    const std::string& Origin() const { return headers_.Origin(); }
    const std::string& MessageId() const { return headers_.MessageId(); }
    const std::string& MessageType() const { return headers_.messageType; }
    const std::string& ContentType() const { return headers_.contentType; }
    const std::string& RoutingKey() const { return headers_.routingKey; }
    void SetCorrelationId(const std::string& id) { headers_.correlationId = id; }
    const VeldraMessageLibrary::Timestamp& GetTimestamp() const { return headers_.timestamp; }
    void SetTimestamp(const VeldraMessageLibrary::Timestamp& timestamp) {
        headers_.timestamp = timestamp;
    }

    void SetError(const std::optional<MessageError>& error) { headers_.SetError(error); }
    MessageError GetError() const { return headers_.GetError(); }
    bool HasError() const { return headers_.HasError(); }

    void EnsureIdentity() { headers_.EnsureIdentity(); }
    std::string DebugText() const { return headers_.DebugText(); }

protected:
    // The sending form: type, content type and the routing key to the target;
    // the message gets its identity.
    MessageBase(const std::string& messageType, const std::string& contentType,
                const std::string& target);
    // The decoding form: the received headers, unchanged.
    explicit MessageBase(MessageHeaders headers);

    MessageBase(const MessageBase&) = default;
    MessageBase& operator=(const MessageBase&) = default;

private:
    MessageHeaders headers_;
};

}  // namespace Korvane::Veldra::MessageBus
