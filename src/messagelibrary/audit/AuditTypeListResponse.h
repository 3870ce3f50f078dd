#pragma once

#include <optional>
#include <string>
#include <vector>

#include "messagebus/interfaces/IRoutingSource.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageError.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/ResponseMessage.h"
#include "messagelibrary/audit/AuditRecords.h"

namespace Korvane::Veldra::VeldraMessageLibrary::AuditTrailMessages {

// The types of audit entry.
class AuditTypeListResponse : public MessageBus::ResponseMessage {
public:
    inline static const std::string kMessageName = "AuditTypeListResponse";

    AuditTypeListResponse(const MessageBus::Interfaces::IRoutingSource& request,
                          std::optional<std::vector<AuditTypeEntry>> entries);
    // An error response: the fields stay unset.
    AuditTypeListResponse(const MessageBus::Interfaces::IRoutingSource& request,
                          const MessageBus::MessageError& error);
    // Parses a received body.
    AuditTypeListResponse(MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body);

    const std::optional<std::vector<AuditTypeEntry>>& Entries() const { return entries_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("entries", self.entries_);
    }

    std::optional<std::vector<AuditTypeEntry>> entries_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::AuditTrailMessages
