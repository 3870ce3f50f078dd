#pragma once

#include <optional>
#include <string>

#include "messagebus/interfaces/IRoutingSource.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageError.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/ResponseMessage.h"
#include "messagelibrary/json/JsonReaders.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages {

// The lines of a command's answer.
class TraceLoggerCommandResponse : public MessageBus::ResponseMessage {
public:
    inline static const std::string kMessageName = "TraceLoggerCommandResponse";

    TraceLoggerCommandResponse(const MessageBus::Interfaces::IRoutingSource& request,
                               std::optional<JsonStringList> responseText);
    // An error response: the fields stay unset.
    TraceLoggerCommandResponse(const MessageBus::Interfaces::IRoutingSource& request,
                               const MessageBus::MessageError& error);
    // Parses a received body.
    TraceLoggerCommandResponse(MessageBus::MessageHeaders headers,
                               const MessageBus::MessageBody& body);

    const std::optional<JsonStringList>& ResponseText() const { return responseText_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("responseText", self.responseText_);
    }

    std::optional<JsonStringList> responseText_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages
