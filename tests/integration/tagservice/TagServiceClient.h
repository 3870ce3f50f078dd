#pragma once

#include <gtest/gtest.h>

#include <chrono>
#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "messagebus/BusTestSupport.h"
#include "messagebus/amqp/AmqpConnectionManager.h"
#include "messagebus/service/MessageService.h"
#include "messagelibrary/TagRecords.h"
#include "messagelibrary/tagcurrentvalue/TagCvQueryCurrentValuesByPathResponse.h"
#include "messagelibrary/taginfo/TagInfoQueryTagsResponse.h"
#include "messagelibrary/tagingestion/TagUpdateValuesRoutedMessage.h"
#include "support/TagServiceProcess.h"

namespace Korvane::Veldra::Testing {

namespace Tags = VeldraMessageLibrary;
using MessagePtr = std::shared_ptr<MessageBus::GenericMessage>;

constexpr uint32_t kReplyTimeoutMs = 10000;

// Keeps every message handed to it: broadcasts, and responses by state.
class Collector : public MessageBus::Interfaces::IBroadcastCallback,
                  public MessageBus::Interfaces::IResponseCallback {
public:
    void OnMessage(MessagePtr message) override { messages.Add(std::move(message)); }
    void OnResponse(MessagePtr message, uint32_t) override { messages.Add(std::move(message)); }
    // The first message of the type for which match holds, if it comes in time.
    template <typename Match>
    MessagePtr WaitFor(const std::string& type, Match match,
                       std::chrono::milliseconds timeout = std::chrono::seconds(10)) {
        return messages
            .WaitFor([&](const MessagePtr& m) { return m->MessageType() == type && match(*m); },
                     timeout)
            .value_or(nullptr);
    }
    Inbox<MessagePtr> messages;
};

// A client of the tag service on the bus of the data root that
// UseBrokerDataRoot writes: the library's message classes over MessageService.
class TagServiceClient {
public:
    TagServiceClient();
    ~TagServiceClient();

    // A routed message answered with a GenericResponse: null when none came.
    MessagePtr Routed(MessageBus::MessageBase& message);
    // A request; the reply, or null when none came.
    MessagePtr Request(MessageBus::MessageBase& message);
    // Subscribes the collector to a broadcast.
    void Listen(const std::string& broadcast);

    // ---- Shorthands that check the reply ----
    // Creates the tag and expects success.
    void Create(const std::string& path, Tags::TagDataType type, bool collect = false);
    // Writes the samples to the path; the reply's error name, "" when none.
    std::string Write(const std::string& path, const std::vector<Tags::TagValueSample>& samples);
    // The tags a query finds, and its total count.
    Tags::TagInfoMessages::TagInfoQueryTagsResponse Query(
        std::optional<Tags::JsonStringList> searchPaths, int32_t skip = 0, int32_t take = 0);
    std::vector<Tags::TagCurrentValue> Read(const Tags::JsonStringList& paths);

    MessageBus::MessageService& Service() { return *service_; }
    std::shared_ptr<Collector> collector = std::make_shared<Collector>();

private:
    std::unique_ptr<MessageBus::AmqpConnectionManager> manager_;
    std::unique_ptr<MessageBus::MessageService> service_;
};

// A sample of a value text with a time (not-a-date-time when omitted).
Tags::TagValueSample Sample(Tags::TagDataType type, const std::string& text,
                            Tags::Timestamp time = Tags::Timestamp());

// The error name of a reply's headers; "" when it carries none.
std::string ErrorName(const MessageBus::GenericMessage& reply);

}  // namespace Korvane::Veldra::Testing
