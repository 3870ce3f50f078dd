#include "tagservice/TagServiceClient.h"

#include "messagebus/config/BusConfigurations.h"
#include "messagelibrary/HeaderKeys.h"
#include "messagelibrary/taginfo/TagInfoCreateTagRoutedMessage.h"
#include "messagelibrary/taginfo/TagInfoQueryTagsRequest.h"
#include "messagelibrary/tagcurrentvalue/TagCvQueryCurrentValuesByPathRequest.h"

namespace Korvane::Veldra::Testing {

TagServiceClient::TagServiceClient() {
    UseBrokerDataRoot();
    const auto entry = MessageBus::BusConfigurations::GetNamed("veldra_master", false);
    manager_ = std::make_unique<MessageBus::AmqpConnectionManager>(entry.Configuration);
    manager_->SetConnectTimeout(30000);
    MessageBus::MessageServiceSettings settings;
    settings.Name = UniqueQueueName("tagclient");
    settings.ConnectionManager = manager_.get();
    service_ = std::make_unique<MessageBus::MessageService>(settings);
    service_->SetDefaultResponseCallback(collector);
    service_->SetStateResponseCallback(collector.get());
}

TagServiceClient::~TagServiceClient() {
    service_.reset();
    manager_.reset();
}

MessagePtr TagServiceClient::Routed(MessageBus::MessageBase& message) {
    return service_->SendRequestExpectingResponse(message, kReplyTimeoutMs);
}

MessagePtr TagServiceClient::Request(MessageBus::MessageBase& message) {
    return service_->SendRequest(message, kReplyTimeoutMs);
}

void TagServiceClient::Listen(const std::string& broadcast) {
    service_->RegisterBroadcast(broadcast, collector);
}

void TagServiceClient::Create(const std::string& path, Tags::TagDataType type, bool collect) {
    Tags::TagRecord record;
    record.path = path;
    record.type = type;
    record.collectAggregates = collect;
    Tags::TagInfoMessages::TagInfoCreateTagRoutedMessage create(record);
    const MessagePtr reply = Routed(create);
    ASSERT_NE(reply, nullptr) << "no reply to the create of " << path;
    ASSERT_EQ(ErrorName(*reply), "") << path;
}

std::string TagServiceClient::Write(const std::string& path,
                                    const std::vector<Tags::TagValueSample>& samples) {
    Tags::TagIngestionMessages::TagUpdateValuesRoutedMessage write(
        std::vector<Tags::TagPathUpdates>{{path, samples}});
    const MessagePtr reply = Routed(write);
    return reply == nullptr ? "no reply" : ErrorName(*reply);
}

Tags::TagInfoMessages::TagInfoQueryTagsResponse TagServiceClient::Query(
    std::optional<Tags::JsonStringList> searchPaths, int32_t skip, int32_t take) {
    Tags::TagInfoMessages::TagInfoQueryTagsRequest query(std::move(searchPaths), std::nullopt,
                                                         std::nullopt, skip, take, true);
    const MessagePtr reply = Request(query);
    if (reply == nullptr) throw std::runtime_error("no reply to a query");
    return {reply->Headers(), reply->Body()};
}

std::vector<Tags::TagCurrentValue> TagServiceClient::Read(const Tags::JsonStringList& paths) {
    Tags::TagCurrentValueMessages::TagCvQueryCurrentValuesByPathRequest read(paths, false);
    const MessagePtr reply = Request(read);
    if (reply == nullptr) throw std::runtime_error("no reply to a read");
    Tags::TagCurrentValueMessages::TagCvQueryCurrentValuesByPathResponse response(reply->Headers(),
                                                                                 reply->Body());
    return response.Values().value_or(std::vector<Tags::TagCurrentValue>{});
}

Tags::TagValueSample Sample(Tags::TagDataType type, const std::string& text,
                            Tags::Timestamp time) {
    return Tags::TagValueSample{time, Tags::TagValue{type, text}};
}

std::string ErrorName(const MessageBus::GenericMessage& reply) {
    const std::string* name = reply.GetHeader(MessageBus::HeaderKeys::kErrorCode);
    return name == nullptr ? std::string() : *name;
}

}  // namespace Korvane::Veldra::Testing
