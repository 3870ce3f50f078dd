#pragma once

#include <optional>
#include <string>

#include "messagelibrary/BroadcastMessage.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages {

// A line for the managers' consoles.
class SvcMgrConsoleWriteLineBroadcast : public MessageBus::BroadcastMessage {
public:
    inline static const std::string kMessageName = "SvcMgrConsoleWriteLineBroadcast";

    explicit SvcMgrConsoleWriteLineBroadcast(std::optional<std::string> consoleWrite);
    // Parses a received body.
    SvcMgrConsoleWriteLineBroadcast(MessageBus::MessageHeaders headers,
                                    const MessageBus::MessageBody& body);

    const std::optional<std::string>& ConsoleWrite() const { return consoleWrite_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("consoleWrite", self.consoleWrite_);
    }

    std::optional<std::string> consoleWrite_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages
