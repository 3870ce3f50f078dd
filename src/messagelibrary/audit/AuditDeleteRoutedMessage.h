#pragma once

#include <optional>
#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RoutedMessage.h"

namespace Korvane::Veldra::VeldraMessageLibrary::AuditTrailMessages {

// Deletes one audit entry by its id.
class AuditDeleteRoutedMessage : public MessageBus::RoutedMessage {
public:
    inline static const std::string kMessageName = "AuditDeleteRoutedMessage";

    explicit AuditDeleteRoutedMessage(std::optional<std::string> id);
    // Parses a received body.
    AuditDeleteRoutedMessage(MessageBus::MessageHeaders headers,
                             const MessageBus::MessageBody& body);

    const std::optional<std::string>& Id() const { return id_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("id", self.id_);
    }

    std::optional<std::string> id_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::AuditTrailMessages
