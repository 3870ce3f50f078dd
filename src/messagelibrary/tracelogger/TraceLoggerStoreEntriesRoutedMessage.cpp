#include "messagelibrary/tracelogger/TraceLoggerStoreEntriesRoutedMessage.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/tracelogger/TraceLoggerService.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages {

TraceLoggerStoreEntriesRoutedMessage::TraceLoggerStoreEntriesRoutedMessage(
    std::optional<std::vector<TraceEntry>> entries)
    : MessageBus::RoutedMessage(kMessageName, MessageBus::kJsonContentType, kTraceLoggerService),
      entries_(std::move(entries)) {}

TraceLoggerStoreEntriesRoutedMessage::TraceLoggerStoreEntriesRoutedMessage(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RoutedMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TraceLoggerStoreEntriesRoutedMessage::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages
