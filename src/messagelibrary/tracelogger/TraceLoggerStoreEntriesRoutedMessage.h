#pragma once

#include <optional>
#include <string>
#include <vector>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RoutedMessage.h"
#include "messagelibrary/tracelogger/TraceLoggerRecords.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages {

// A batch of trace entries to store, in their order.
class TraceLoggerStoreEntriesRoutedMessage : public MessageBus::RoutedMessage {
public:
    inline static const std::string kMessageName = "TraceLoggerStoreEntriesRoutedMessage";

    explicit TraceLoggerStoreEntriesRoutedMessage(std::optional<std::vector<TraceEntry>> entries);
    // Parses a received body.
    TraceLoggerStoreEntriesRoutedMessage(MessageBus::MessageHeaders headers,
                                         const MessageBus::MessageBody& body);

    const std::optional<std::vector<TraceEntry>>& Entries() const { return entries_; }

    MessageBus::MessageBody Serialize() const override;

private:
    std::optional<std::vector<TraceEntry>> entries_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages
