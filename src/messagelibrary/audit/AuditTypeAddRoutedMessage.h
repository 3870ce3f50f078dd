#pragma once

#include <optional>
#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RoutedMessage.h"
#include "messagelibrary/audit/AuditRecords.h"

namespace Korvane::Veldra::VeldraMessageLibrary::AuditTrailMessages {

// Adds a type of audit entry.
class AuditTypeAddRoutedMessage : public MessageBus::RoutedMessage {
public:
    inline static const std::string kMessageName = "AuditTypeAddRoutedMessage";

    explicit AuditTypeAddRoutedMessage(std::optional<AuditTypeEntry> entry);
    // Parses a received body.
    AuditTypeAddRoutedMessage(MessageBus::MessageHeaders headers,
                              const MessageBus::MessageBody& body);

    const std::optional<AuditTypeEntry>& Entry() const { return entry_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("entry", self.entry_);
    }

    std::optional<AuditTypeEntry> entry_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::AuditTrailMessages
