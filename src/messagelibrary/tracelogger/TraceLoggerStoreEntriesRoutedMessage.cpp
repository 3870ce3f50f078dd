#include "messagelibrary/tracelogger/TraceLoggerStoreEntriesRoutedMessage.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/json/JsonWriters.h"
#include "messagelibrary/tracelogger/TraceLoggerService.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages {

TraceLoggerStoreEntriesRoutedMessage::TraceLoggerStoreEntriesRoutedMessage(
    std::optional<std::vector<TraceEntry>> entries)
    : MessageBus::RoutedMessage(kMessageName, MessageBus::kJsonContentType, kTraceLoggerService),
      entries_(std::move(entries)) {}

TraceLoggerStoreEntriesRoutedMessage::TraceLoggerStoreEntriesRoutedMessage(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RoutedMessage(std::move(headers)) {
    const JsonVariant json = ParseJsonBody(body.ToString(), MessageType());
    JsonBodyReader(json).Field("entries", entries_);
}

MessageBus::MessageBody TraceLoggerStoreEntriesRoutedMessage::Serialize() const {
    return MessageBus::MessageBody(JsonBodyWriter().Field("entries", entries_).Finish());
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages
