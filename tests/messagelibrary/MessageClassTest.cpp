#include <gtest/gtest.h>

#include <string>

#include "support/CatchVeldra.h"
#include "messagelibrary/MessageClassCases.h"
#include "messagelibrary/RequestMessage.h"
#include "messagelibrary/RoutedMessage.h"

namespace Korvane::Veldra::MessageBus::Testing {
namespace {

// The request that the responses of the tables answer.
class AnyRequest : public RequestMessage {
public:
    AnyRequest() : RequestMessage("AnyRequest", "application/json", "Somewhere") {
        SetReplyTo("client_q");
    }
    MessageBody Serialize() const override { return MessageBody("{}"); }
};

// Parses the body with the headers of the case's own class.
MessagePtr Parse(const MessageCase& c, const std::string& body) {
    MessageHeaders headers;
    headers.messageType = c.name;
    return c.parse(headers, MessageBody(body));
}

TEST_P(MessageClassTest, WritesEveryFieldAndReadsItBack) {
    const MessageCase& c = GetParam();
    const AnyRequest request;
    const MessagePtr sent = c.make(request);
    EXPECT_EQ(sent->MessageType(), c.name);
    EXPECT_EQ(sent->ContentType(), "application/json");
    EXPECT_EQ(sent->RoutingKey(), c.routingKey);
    EXPECT_EQ(sent->IgnoreResponse(), dynamic_cast<const RoutedMessage*>(sent.get()) != nullptr);
    if (c.makeError) {
        EXPECT_EQ(sent->CorrelationId(), request.CorrelationId());
    }

    const std::string body = sent->Serialize().ToString();
    EXPECT_EQ(body, c.body);
    const MessagePtr parsed = c.parse(sent->Headers(), sent->Serialize());
    EXPECT_EQ(parsed->MessageId(), sent->MessageId());
    EXPECT_EQ(parsed->Serialize().ToString(), body);
}

TEST_P(MessageClassTest, ReadsMissingFieldsAsUnsetAndWritesThemAgain) {
    const std::string unset = Parse(GetParam(), "{}")->Serialize().ToString();
    EXPECT_EQ(Parse(GetParam(), unset)->Serialize().ToString(), unset);
}

TEST_P(MessageClassTest, MalformedBodyNamesTheMessage) {
    const std::string text = "Failed to parse: " + GetParam().name;
    for (const char* body : {"", "{", "{\"a\":NaN}", "[1,]", "{\"a\":1}}"}) {
        SCOPED_TRACE(body);
        EXPECT_THROWS_VELDRA(Parse(GetParam(), body), -251005, text);
    }
}

TEST_P(MessageResponseTest, ErrorResponseHasTheErrorAndNoFields) {
    const MessageCase& c = GetParam();
    const AnyRequest request;
    const MessagePtr response = c.makeError(request);
    EXPECT_EQ(response->RoutingKey(), "Veldra.client_q." + c.name);
    EXPECT_EQ(response->CorrelationId(), request.CorrelationId());
    ASSERT_TRUE(response->HasError());
    EXPECT_EQ(*response->GetHeader("ErrorCode"), "Tag.NoSuchTag");
    EXPECT_EQ(response->Serialize().ToString(), Parse(c, "{}")->Serialize().ToString());
}

}  // namespace
}  // namespace Korvane::Veldra::MessageBus::Testing
