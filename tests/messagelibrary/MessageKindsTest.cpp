#include <gtest/gtest.h>

#include <string>

#include "messagelibrary/BroadcastMessage.h"
#include "messagelibrary/GenericMessage.h"
#include "messagelibrary/HeaderKeys.h"
#include "messagelibrary/RequestMessage.h"
#include "messagelibrary/ResponseMessage.h"
#include "messagelibrary/RoutedMessage.h"
#include "messagelibrary/RoutingKey.h"

namespace Korvane::Veldra::MessageBus {
namespace {

// The kinds keep Serialize pure; these give them an empty body.
template <typename Kind>
class Bodiless : public Kind {
public:
    using Kind::Kind;
    MessageBody Serialize() const override { return MessageBody("{}"); }
};

class SampleResponse : public Bodiless<ResponseMessage> {
public:
    SampleResponse(const Interfaces::IRoutingSource& request,
                   const std::optional<MessageError>& error = std::nullopt)
        : Bodiless<ResponseMessage>("SampleResponse", "application/json", request.ReplyTo()) {
        AnswerTo(request, error);
    }
};

TEST(RoutingKey, TargetAndNameOrNameAlone) {
    EXPECT_EQ(MakeRoutingKey("TagInfo", "TagInfoQueryTagsRequest"),
              "Veldra.TagInfo.TagInfoQueryTagsRequest");
    EXPECT_EQ(MakeRoutingKey("", "ServiceStartedBroadcast"), "Veldra.ServiceStartedBroadcast");
}

TEST(MessageKinds, SendingConstructorsSetKeyIdentityAndIgnoreResponse) {
    const Bodiless<RoutedMessage> routed("TagUpdateValuesRoutedMessage", "application/json",
                                         "TagIngestion");
    const Bodiless<RequestMessage> request("TagInfoQueryTagsRequest", "application/json",
                                           "TagInfo");
    const Bodiless<BroadcastMessage> broadcast("ServiceStartedBroadcast", "application/json");
    struct Case {
        const MessageBase* message;
        const char* routingKey;
        bool ignoreResponse;
    };
    const Case cases[] = {
        {&routed, "Veldra.TagIngestion.TagUpdateValuesRoutedMessage", true},
        {&request, "Veldra.TagInfo.TagInfoQueryTagsRequest", false},
        {&broadcast, "Veldra.ServiceStartedBroadcast", false},
    };
    for (const auto& c : cases) {
        const MessageBase& message = *c.message;
        EXPECT_EQ(message.RoutingKey(), c.routingKey);
        EXPECT_EQ(message.IgnoreResponse(), c.ignoreResponse) << c.routingKey;
        EXPECT_EQ(message.ContentType(), "application/json");
        EXPECT_EQ(message.MessageId().size(), 36u);
        EXPECT_EQ(message.CorrelationId(), message.MessageId());
        EXPECT_FALSE(message.GetTimestamp().is_special());
        EXPECT_EQ(message.ReplyTo(), "");
    }
    EXPECT_EQ(*routed.GetHeader(HeaderKeys::kIgnoreResponse), "true");
    EXPECT_EQ(request.GetHeader(HeaderKeys::kIgnoreResponse), nullptr);

    Bodiless<RoutedMessage> answered("SomeRoutedMessage", "application/json", "Service");
    answered.SetIgnoreResponse(false);
    EXPECT_FALSE(answered.IgnoreResponse());
    EXPECT_EQ(answered.GetHeader(HeaderKeys::kIgnoreResponse), nullptr);
}

TEST(MessageKinds, DecodingConstructorCopiesTheHeadersUnchanged) {
    MessageHeaders received;
    received.messageType = "SomeRoutedMessage";
    received.routingKey = "Veldra.q.SomeRoutedMessage";
    received.SetHeader("Custom", "value");
    const Bodiless<RoutedMessage> routed(received);
    EXPECT_EQ(routed.MessageId(), "");
    EXPECT_EQ(routed.CorrelationId(), "");
    EXPECT_FALSE(routed.IgnoreResponse());
    EXPECT_TRUE(routed.GetTimestamp().is_not_a_date_time());
    EXPECT_EQ(routed.Headers().headers, received.headers);
    EXPECT_EQ(routed.RoutingKey(), received.routingKey);
}

TEST(MessageKinds, ResponseGoesToTheReplyQueueWithTheRequestsCorrelation) {
    Bodiless<RequestMessage> request("TagInfoQueryTagsRequest", "application/json", "TagInfo");
    request.SetReplyTo("client_1a2b");

    const SampleResponse ok(request);
    EXPECT_EQ(ok.RoutingKey(), "Veldra.client_1a2b.SampleResponse");
    EXPECT_EQ(ok.CorrelationId(), request.CorrelationId());
    EXPECT_NE(ok.MessageId(), request.MessageId());
    EXPECT_FALSE(ok.HasError());
    EXPECT_FALSE(ok.IgnoreResponse());

    const SampleResponse failed(request, MessageError::Named("Tag.NoSuchTag", {"a.b"}));
    EXPECT_TRUE(failed.HasError());
    EXPECT_EQ(*failed.GetHeader(HeaderKeys::kErrorCode), "Tag.NoSuchTag");

    // A request without a reply queue gets an answer on the broadcast form.
    const GenericMessage anonymous(MessageHeaders{}, MessageBody());
    EXPECT_EQ(SampleResponse(anonymous).RoutingKey(), "Veldra.SampleResponse");
}

}  // namespace
}  // namespace Korvane::Veldra::MessageBus
