#pragma once

#include <cstdint>
#include <functional>
#include <map>
#include <optional>
#include <string>
#include <string_view>

#include "messagelibrary/MessageError.h"
#include "messagelibrary/json/Timestamp.h"

namespace Korvane::Veldra::MessageBus {

// The free header table: ordered by bytes, then by length; one value a key.
using HeaderMap = std::map<std::string, std::string, std::less<>>;

// The metadata of one message, embedded by value in every message object.
// Default: an empty table, empty texts and a not-a-date-time timestamp.
struct MessageHeaders {
    HeaderMap headers;
    std::string messageType;
    std::string contentType;
    std::string correlationId;
    std::string routingKey;
    VeldraMessageLibrary::Timestamp timestamp;

    // Header table access. A header read as a bool is true for exactly "true",
    // "True", "TRUE" or "1". The three writers of bools differ on purpose:
    // SetHeader stores "True"/"False", SetPersistent "1"/"0", and
    // SetIgnoreResponse "true" or no header at all.
    void SetHeader(std::string_view key, const std::string& value);
    void SetHeader(std::string_view key, const char* value);
    void SetHeader(std::string_view key, const std::optional<std::string>& value);
    void SetHeader(std::string_view key, bool value);
    void EraseHeader(std::string_view key);
    const std::string* GetHeader(std::string_view key) const;
    std::optional<std::string> GetOptionalHeader(std::string_view key) const;
    bool GetHeaderAsBool(std::string_view key) const;
    // The header's text, or an empty text when it is absent.
    const std::string& HeaderOrEmpty(std::string_view key) const;

    void SetPersistent(bool persistent);
    bool Persistent() const;
    void SetIgnoreResponse(bool ignore);
    bool IgnoreResponse() const;
    void SetReplyTo(const std::string& queue);
    const std::string& ReplyTo() const;
    void SetOrigin(const std::string& origin);
    const std::string& Origin() const;
    const std::string& MessageId() const;
    const std::string& ConsumerTag() const;
    // The "DeliveryTag" header as an unsigned 32-bit number; 0 when absent,
    // empty or not a number.
    uint32_t DeliveryTag() const;
    // Stores the low 32 bits of an AMQP delivery tag.
    void SetDeliveryTag(uint64_t deliveryTag);

    // Stores the error in "ErrorCode", "ErrorInfo" and "ErrorArgs<i>". An
    // absent error erases only "ErrorCode".
    void SetError(const std::optional<MessageError>& error);
    // Rebuilds the error through the registry: an absent or empty code, or a
    // name the registry does not hold, comes back as "Unknown". Arguments are
    // read up to the first absent or empty one.
    MessageError GetError() const;
    bool HasError() const;

    // Gives the message an id ("MessageId", a random version 4 UUID) unless it
    // has one, makes the id the correlation id when that is empty, and stamps
    // the time in whole seconds.
    void EnsureIdentity();

    // "Id=<8> | Type=<type> | Routing=<key> | Origin=<origin> | Corr=<8> | ".
    std::string DebugText() const;
};

}  // namespace Korvane::Veldra::MessageBus
