#include <gtest/gtest.h>

#include <memory>
#include <string>

#include "errors/ErrorCodes.h"
#include "support/CatchVeldra.h"
#include "messagelibrary/AmqpPropertyMapping.h"
#include "messagelibrary/GenericMessage.h"
#include "messagelibrary/GenericResponse.h"
#include "messagelibrary/HeaderKeys.h"
#include "messagelibrary/NotImplemented.h"
#include "messagelibrary/RequestMessage.h"

namespace Korvane::Veldra::MessageBus {
namespace {

class QueryRequest : public RequestMessage {
public:
    QueryRequest() : RequestMessage("TagInfoQueryTagsRequest", "application/json", "TagInfo") {
        SetReplyTo("client_q");
    }
    MessageBody Serialize() const override { return MessageBody("{}"); }
};

// What the consumer hands on: the message as it arrives from the broker.
std::shared_ptr<GenericMessage> Arrive(const MessageBase& sent) {
    const MessageHeaders headers =
        HeadersFromAmqp(ToAmqpProperties(sent.Headers(), 1), sent.RoutingKey(), "ctag", 9);
    return std::make_shared<GenericMessage>(headers, sent.Serialize());
}

TEST(MessageBody, CopiesTextWithoutATerminator) {
    std::string text("a\0b", 3);
    const MessageBody body(text);
    text[0] = 'z';
    EXPECT_EQ(body.Length(), 3u);
    EXPECT_EQ(body.ToString(), std::string("a\0b", 3));
    const MessageBody copy = body;
    EXPECT_EQ(copy.Data(), body.Data());
    EXPECT_TRUE(MessageBody().Empty());
    EXPECT_EQ(MessageBody("").Data(), nullptr);
    EXPECT_EQ(MessageBody(nullptr, 4).ToString(), "");
}

TEST(GenericResponse, AnswersARequestWithItsNameInTheBody) {
    const QueryRequest request;
    const GenericResponse response(request);
    EXPECT_EQ(response.MessageType(), "GenericResponse");
    EXPECT_EQ(response.RoutingKey(), "Veldra.client_q.GenericResponse");
    EXPECT_EQ(response.CorrelationId(), request.CorrelationId());
    EXPECT_EQ(response.Serialize().ToString(), R"({"RequestName":"TagInfoQueryTagsRequest"})");
    EXPECT_FALSE(response.HasError());
}

TEST(GenericResponse, DecodesFromAReceivedMessageWithItsError) {
    const QueryRequest request;
    const auto received = Arrive(request);
    const GenericResponse sent(*received, MessageError::Named("Tag.NoSuchTag", {"a.b"}, "gone"));
    const auto arrived = Arrive(sent);

    ASSERT_EQ(arrived->MessageType(), GenericResponse::kMessageName);
    EXPECT_EQ(arrived->CorrelationId(), request.CorrelationId());
    EXPECT_EQ(arrived->DeliveryTag(), 9u);
    EXPECT_EQ(arrived->ConsumerTag(), "ctag");
    EXPECT_TRUE(arrived->HasError());

    const GenericResponse decoded(arrived->Headers(), arrived->Body());
    EXPECT_EQ(decoded.RequestName(), "TagInfoQueryTagsRequest");
    EXPECT_EQ(decoded.MessageId(), sent.MessageId());
    EXPECT_EQ(decoded.GetError().args, std::vector<std::string>{"a.b"});
    EXPECT_EQ(decoded.GetError().info, "gone");
    EXPECT_EQ(arrived->DebugText().substr(0, 3), "Id=");
}

TEST(GenericResponse, ParseFailuresNameTheMessageOrTheField) {
    MessageHeaders headers;
    headers.messageType = "GenericResponse";
    struct Case {
        const char* body;
        int32_t code;
        const char* text;
    };
    const Case cases[] = {
        {"", ErrorCodes::kFailedToParse, "Failed to parse: GenericResponse"},
        {R"({"RequestName":"x")", ErrorCodes::kFailedToParse,
         "Failed to parse: GenericResponse"},
        {R"({"RequestName":"x"} x)", ErrorCodes::kFailedToParse,
         "Failed to parse: GenericResponse"},
        {R"({"RequestName":12})", ErrorCodes::kFailedToParse, "Failed to parse: RequestName"},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.body);
        EXPECT_THROWS_VELDRA(GenericResponse(headers, MessageBody(std::string(c.body))), c.code,
                             c.text);
    }
    // A body without the key decodes with an empty name.
    EXPECT_EQ(GenericResponse(headers, MessageBody(std::string("{}"))).RequestName(), "");
}

TEST(GenericResponse, UnsupportedBodyOperationThrowsNotImplemented) {
    EXPECT_THROWS_VELDRA(ThrowNotImplemented(), ErrorCodes::kException, "Not implemented");
}

}  // namespace
}  // namespace Korvane::Veldra::MessageBus
