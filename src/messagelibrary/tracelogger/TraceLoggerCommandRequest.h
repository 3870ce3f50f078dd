#pragma once

#include <optional>
#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RequestMessage.h"
#include "messagelibrary/json/JsonReaders.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages {

// A command for the service, as its words.
class TraceLoggerCommandRequest : public MessageBus::RequestMessage {
public:
    inline static const std::string kMessageName = "TraceLoggerCommandRequest";

    explicit TraceLoggerCommandRequest(std::optional<JsonStringList> arguments);
    // Parses a received body.
    TraceLoggerCommandRequest(MessageBus::MessageHeaders headers,
                              const MessageBus::MessageBody& body);

    const std::optional<JsonStringList>& Arguments() const { return arguments_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("arguments", self.arguments_);
    }

    std::optional<JsonStringList> arguments_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages
