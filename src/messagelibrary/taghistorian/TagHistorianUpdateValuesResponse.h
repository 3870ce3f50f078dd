#pragma once

#include <optional>
#include <string>

#include "messagebus/interfaces/IRoutingSource.h"
#include "messagelibrary/ErrorRecord.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageError.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/ResponseMessage.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages {

// The outcome of an update of stored values; the errors of single values are
// nested in one error record.
class TagHistorianUpdateValuesResponse : public MessageBus::ResponseMessage {
public:
    inline static const std::string kMessageName = "TagHistorianUpdateValuesResponse";

    TagHistorianUpdateValuesResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                     std::optional<ErrorRecord> errors);
    // An error response: the fields stay unset.
    TagHistorianUpdateValuesResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                     const MessageBus::MessageError& error);
    // Parses a received body.
    TagHistorianUpdateValuesResponse(MessageBus::MessageHeaders headers,
                                     const MessageBus::MessageBody& body);

    const std::optional<ErrorRecord>& Errors() const { return errors_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("errors", self.errors_);
    }

    std::optional<ErrorRecord> errors_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages
