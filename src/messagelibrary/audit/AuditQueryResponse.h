#pragma once

#include <cstdint>
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

// One page of audit entries, and the count of all that matched.
class AuditQueryResponse : public MessageBus::ResponseMessage {
public:
    inline static const std::string kMessageName = "AuditQueryResponse";

    AuditQueryResponse(const MessageBus::Interfaces::IRoutingSource& request,
                       std::optional<std::vector<AuditEntry>> entries, int32_t fullCount);
    // An error response: the fields stay unset.
    AuditQueryResponse(const MessageBus::Interfaces::IRoutingSource& request,
                       const MessageBus::MessageError& error);
    // Parses a received body.
    AuditQueryResponse(MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body);

    const std::optional<std::vector<AuditEntry>>& Entries() const { return entries_; }
    int32_t FullCount() const { return fullCount_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("entries", self.entries_).Field("fullCount", self.fullCount_);
    }

    std::optional<std::vector<AuditEntry>> entries_;
    int32_t fullCount_ = 0;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::AuditTrailMessages
