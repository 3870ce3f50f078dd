#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RequestMessage.h"
#include "messagelibrary/audit/AuditRecords.h"

namespace Korvane::Veldra::VeldraMessageLibrary::AuditTrailMessages {

// Asks for the audit entries that match the parameters; takeCount and skipCount page
// the result.
class AuditQueryRequest : public MessageBus::RequestMessage {
public:
    inline static const std::string kMessageName = "AuditQueryRequest";

    AuditQueryRequest(std::optional<AuditQueryParameters> parameters, int32_t takeCount,
                      int32_t skipCount);
    // Parses a received body.
    AuditQueryRequest(MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body);

    const std::optional<AuditQueryParameters>& Parameters() const { return parameters_; }
    int32_t TakeCount() const { return takeCount_; }
    int32_t SkipCount() const { return skipCount_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("parameters", self.parameters_)
            .Field("takeCount", self.takeCount_)
            .Field("skipCount", self.skipCount_);
    }

    std::optional<AuditQueryParameters> parameters_;
    int32_t takeCount_ = 0;
    int32_t skipCount_ = 0;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::AuditTrailMessages
