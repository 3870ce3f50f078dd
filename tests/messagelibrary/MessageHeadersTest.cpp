#include <gtest/gtest.h>

#include <regex>
#include <set>
#include <string>

#include "errors/ErrorCodeRegistry.h"
#include "messagelibrary/HeaderKeys.h"
#include "messagelibrary/MessageHeaders.h"

namespace Korvane::Veldra::MessageBus {
namespace {

TEST(MessageHeaders, BoolReadAcceptsExactlyFourSpellings) {
    const std::pair<const char*, bool> cases[] = {
        {"true", true},   {"True", true},   {"TRUE", true}, {"1", true},
        {"tRuE", false},  {"yes", false},   {"", false},    {"0", false},
        {"false", false}, {" true", false}, {"11", false},
    };
    for (const auto& [text, expected] : cases) {
        MessageHeaders headers;
        headers.SetHeader("Flag", text);
        EXPECT_EQ(headers.GetHeaderAsBool("Flag"), expected) << '"' << text << '"';
    }
    EXPECT_FALSE(MessageHeaders().GetHeaderAsBool("Flag"));
}

TEST(MessageHeaders, ThreeBoolWritersStoreDifferentTextsThatAllReadBack) {
    MessageHeaders headers;
    headers.SetHeader("Plain", true);
    headers.SetPersistent(true);
    headers.SetIgnoreResponse(true);
    EXPECT_EQ(*headers.GetHeader("Plain"), "True");
    EXPECT_EQ(*headers.GetHeader(HeaderKeys::kPersistent), "1");
    EXPECT_EQ(*headers.GetHeader(HeaderKeys::kIgnoreResponse), "true");
    EXPECT_TRUE(headers.GetHeaderAsBool("Plain"));
    EXPECT_TRUE(headers.Persistent());
    EXPECT_TRUE(headers.IgnoreResponse());

    headers.SetHeader("Plain", false);
    headers.SetPersistent(false);
    headers.SetIgnoreResponse(false);
    EXPECT_EQ(*headers.GetHeader("Plain"), "False");
    EXPECT_EQ(*headers.GetHeader(HeaderKeys::kPersistent), "0");
    EXPECT_EQ(headers.GetHeader(HeaderKeys::kIgnoreResponse), nullptr);
    EXPECT_FALSE(headers.GetHeaderAsBool("Plain"));
    EXPECT_FALSE(headers.Persistent());
    EXPECT_FALSE(headers.IgnoreResponse());
}

TEST(MessageHeaders, TextSettersReplaceAndAbsentOptionalErases) {
    MessageHeaders headers;
    headers.SetHeader("Key", "one");
    headers.SetHeader("Key", std::string("two"));
    EXPECT_EQ(*headers.GetHeader("Key"), "two");
    headers.SetHeader("Key", std::optional<std::string>(""));
    EXPECT_EQ(headers.GetOptionalHeader("Key"), std::optional<std::string>(""));
    headers.SetHeader("Key", std::optional<std::string>());
    EXPECT_EQ(headers.GetHeader("Key"), nullptr);
    EXPECT_TRUE(headers.headers.empty());
}

TEST(MessageHeaders, DeliveryTagParsesDecimalOrGivesZero) {
    const std::pair<const char*, uint32_t> cases[] = {
        {"42", 42}, {"4294967295", 4294967295u}, {"", 0}, {"4294967296", 0}, {"-1", 0}, {"12x", 0},
        {"x", 0},
    };
    for (const auto& [text, expected] : cases) {
        MessageHeaders headers;
        headers.SetHeader(HeaderKeys::kDeliveryTag, text);
        EXPECT_EQ(headers.DeliveryTag(), expected) << '"' << text << '"';
    }
    EXPECT_EQ(MessageHeaders().DeliveryTag(), 0u);

    MessageHeaders headers;
    headers.SetDeliveryTag(0x100000007ULL);
    EXPECT_EQ(*headers.GetHeader(HeaderKeys::kDeliveryTag), "7");
}

class MessageHeadersError : public ::testing::Test {
protected:
    void SetUp() override {
        ErrorCodeRegistry::Instance().registerCode(
            "Tag", "ConflictingTagTypes", "Conflicting types for tag '{0}': '{1}' != '{2}'.");
    }
};

TEST_F(MessageHeadersError, RoundTripsThroughTheHeaders) {
    MessageHeaders headers;
    headers.SetError(
        MessageError::Named("Tag.ConflictingTagTypes", {"a.b", "DOUBLE", "INT"}, "types differ"));
    EXPECT_EQ(*headers.GetHeader(HeaderKeys::kErrorCode), "Tag.ConflictingTagTypes");
    EXPECT_EQ(*headers.GetHeader(HeaderKeys::kErrorInfo), "types differ");
    EXPECT_EQ(*headers.GetHeader("ErrorArgs0"), "a.b");
    EXPECT_EQ(*headers.GetHeader("ErrorArgs2"), "INT");
    ASSERT_TRUE(headers.HasError());

    const MessageError error = headers.GetError();
    EXPECT_EQ(error.FullName(), "Tag.ConflictingTagTypes");
    EXPECT_EQ(error.code.message, "Conflicting types for tag '{0}': '{1}' != '{2}'.");
    EXPECT_EQ(error.info, "types differ");
    EXPECT_EQ(error.args, (std::vector<std::string>{"a.b", "DOUBLE", "INT"}));
    EXPECT_EQ(error.Text(), "Tag.ConflictingTagTypes: types differ");
}

TEST_F(MessageHeadersError, ArgumentsStopAtTheFirstGap) {
    MessageHeaders headers;
    headers.SetHeader(HeaderKeys::kErrorCode, "Tag.ConflictingTagTypes");
    headers.SetHeader("ErrorArgs0", "first");
    headers.SetHeader("ErrorArgs2", "third");
    EXPECT_EQ(headers.GetError().args, std::vector<std::string>{"first"});
    headers.SetHeader("ErrorArgs1", "");
    EXPECT_EQ(headers.GetError().args, std::vector<std::string>{"first"});
}

TEST_F(MessageHeadersError, EmptyInfoIsNotWrittenAndClearingErasesOnlyTheCode) {
    MessageHeaders headers;
    headers.SetError(MessageError::Named("Tag.ConflictingTagTypes"));
    EXPECT_EQ(headers.GetHeader(HeaderKeys::kErrorInfo), nullptr);
    headers.SetError(MessageError::Named("Tag.ConflictingTagTypes", {"x"}, "info"));
    headers.SetError(std::nullopt);
    EXPECT_FALSE(headers.HasError());
    EXPECT_EQ(headers.GetHeader(HeaderKeys::kErrorCode), nullptr);
    EXPECT_EQ(*headers.GetHeader(HeaderKeys::kErrorInfo), "info");
    EXPECT_EQ(*headers.GetHeader("ErrorArgs0"), "x");
}

TEST(MessageHeaders, UnknownOrMissingCodesComeBackAsUnknown) {
    MessageHeaders headers;
    EXPECT_FALSE(headers.HasError());
    // No code at all: the stored record, with its text.
    MessageError error = headers.GetError();
    EXPECT_EQ(error.FullName(), "Unknown");
    EXPECT_EQ(error.code.message, "An unknown error occurred.");

    headers.SetHeader(HeaderKeys::kErrorCode, "");
    EXPECT_FALSE(headers.HasError());

    // A name the registry does not hold: "Unknown" without a text.
    headers.SetHeader(HeaderKeys::kErrorCode, "Remote.SomethingNew");
    headers.SetHeader(HeaderKeys::kErrorInfo, "remote detail");
    EXPECT_TRUE(headers.HasError());
    error = headers.GetError();
    EXPECT_EQ(error.FullName(), "Unknown");
    EXPECT_EQ(error.code.category, "");
    EXPECT_EQ(error.code.message, "");
    EXPECT_EQ(error.info, "remote detail");
}

TEST(MessageHeaders, EnsureIdentityGivesRandomVersion4IdsAndKeepsExistingOnes) {
    const std::regex uuidV4("[0-9a-f]{8}-[0-9a-f]{4}-4[0-9a-f]{3}-[89ab][0-9a-f]{3}-[0-9a-f]{12}");
    std::set<std::string> ids;
    for (int i = 0; i < 200; ++i) {
        MessageHeaders headers;
        headers.EnsureIdentity();
        const std::string& id = headers.MessageId();
        ASSERT_TRUE(std::regex_match(id, uuidV4)) << id;
        EXPECT_EQ(headers.correlationId, id);
        EXPECT_FALSE(headers.timestamp.is_special());
        EXPECT_EQ(headers.timestamp.time_of_day().fractional_seconds(), 0);
        ids.insert(id);
    }
    EXPECT_EQ(ids.size(), 200u);

    MessageHeaders headers;
    headers.correlationId = "request-corr";
    headers.EnsureIdentity();
    const std::string first = headers.MessageId();
    headers.EnsureIdentity();
    EXPECT_EQ(headers.MessageId(), first);
    EXPECT_EQ(headers.correlationId, "request-corr");

    headers.SetHeader(HeaderKeys::kMessageId, "");
    headers.EnsureIdentity();
    EXPECT_NE(headers.MessageId(), "");
    EXPECT_NE(headers.MessageId(), first);
}

TEST(MessageHeaders, DebugTextHasFiveFieldsEachEndingWithTheSeparator) {
    MessageHeaders headers;
    headers.SetHeader(HeaderKeys::kMessageId, "0123456789abcdef");
    headers.messageType = "TagInfoQueryTagsRequest";
    headers.routingKey = "Veldra.TagInfo.TagInfoQueryTagsRequest";
    headers.SetOrigin("Client_1");
    headers.correlationId = "fedcba9876543210";
    EXPECT_EQ(headers.DebugText(),
              "Id=01234567 | Type=TagInfoQueryTagsRequest | "
              "Routing=Veldra.TagInfo.TagInfoQueryTagsRequest | Origin=Client_1 | "
              "Corr=fedcba98 | ");
    EXPECT_EQ(MessageHeaders().DebugText(), "Id= | Type= | Routing= | Origin= | Corr= | ");
}

}  // namespace
}  // namespace Korvane::Veldra::MessageBus
