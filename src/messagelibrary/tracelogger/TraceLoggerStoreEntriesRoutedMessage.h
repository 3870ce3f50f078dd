#pragma once

#include <optional>
#include <string>
#include <vector>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
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
    // Moves the entries out, for a sender that reuses their storage.
    std::vector<TraceEntry> TakeEntries() {
        std::vector<TraceEntry> entries =
            entries_ ? std::move(*entries_) : std::vector<TraceEntry>();
        entries_.reset();
        return entries;
    }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("entries", self.entries_);
    }

    std::optional<std::vector<TraceEntry>> entries_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages
