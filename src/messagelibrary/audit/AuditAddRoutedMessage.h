#pragma once

#include <optional>
#include <string>
#include <vector>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RoutedMessage.h"
#include "messagelibrary/audit/AuditRecords.h"

namespace Korvane::Veldra::VeldraMessageLibrary::AuditTrailMessages {

// Adds entries to the audit trail.
class AuditAddRoutedMessage : public MessageBus::RoutedMessage {
public:
    inline static const std::string kMessageName = "AuditAddRoutedMessage";

    explicit AuditAddRoutedMessage(std::optional<std::vector<AuditEntry>> entries);
    // Parses a received body.
    AuditAddRoutedMessage(MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body);

    const std::optional<std::vector<AuditEntry>>& Entries() const { return entries_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("entries", self.entries_);
    }

    std::optional<std::vector<AuditEntry>> entries_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::AuditTrailMessages
