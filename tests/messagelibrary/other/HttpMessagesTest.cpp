#include <gtest/gtest.h>

#include <optional>
#include <string>

#include "messagelibrary/MessageError.h"
#include "messagelibrary/http/HttpRequest.h"
#include "messagelibrary/http/HttpResponse.h"
#include "support/CatchVeldra.h"

namespace Korvane::Veldra::VeldraMessageLibrary::HttpMessages {
namespace {

using MessageBus::MessageBody;
using MessageBus::MessageHeaders;

// Bytes that are no JSON, with a zero inside.
constexpr char kPayloadBytes[] = "{\0\xff not json";
const std::string kPayload(kPayloadBytes, sizeof(kPayloadBytes) - 1);

HttpRequest SampleRequest(std::optional<std::string> uri = std::string("/api/v1?x=1")) {
    HttpRequest request(HttpMethod::Post, std::move(uri), MessageBody(kPayload));
    request.SetReplyTo("client_q");
    return request;
}

MessageHeaders HeadersWith(const std::string& key, std::optional<std::string> value) {
    MessageHeaders headers;
    if (value) headers.SetHeader(key, *value);
    return headers;
}

TEST(HttpMessages, RequestCarriesMethodAndUriInItsHeaders) {
    HttpRequest request = SampleRequest();
    EXPECT_EQ(request.ContentType(), "application/octet-stream");
    EXPECT_EQ(request.RoutingKey(), "Veldra.Http.HttpRequest");
    EXPECT_EQ(request.Serialize().ToString(), kPayload);

    const MessageHeaders& headers = request.Headers();
    EXPECT_EQ(headers.HeaderOrEmpty("Method"), "POST");
    EXPECT_EQ(headers.HeaderOrEmpty("Uri"), "/api/v1?x=1");
    const HttpRequest parsed(headers, request.Serialize());
    EXPECT_EQ(parsed.Method(), HttpMethod::Post);
    EXPECT_EQ(parsed.Uri(), "/api/v1?x=1");
    EXPECT_EQ(parsed.Serialize().ToString(), kPayload);
    EXPECT_EQ(parsed.MessageId(), request.MessageId());
}

TEST(HttpMessages, HeadersAreWrittenAgainOnEveryCall) {
    HttpRequest request = SampleRequest(std::nullopt);
    request.SetHeader("Method", std::optional<std::string>());
    request.SetHeader("Uri", std::string("/stale"));
    EXPECT_EQ(request.Headers().HeaderOrEmpty("Method"), "POST");
    EXPECT_EQ(request.Headers().GetHeader("Uri"), nullptr);

    request.SetHeader("Method", std::string("GET"));
    const HttpRequest& constant = request;
    EXPECT_EQ(constant.Headers().HeaderOrEmpty("Method"), "POST");
    EXPECT_EQ(constant.Headers().HeaderOrEmpty("ReplyTo"), "client_q");
}

TEST(HttpMessages, RequestReadsEveryMethodAndRefusesAnyOtherText) {
    const char* methods[] = {"GET", "PUT", "POST", "DELETE", "PATCH", "OPTIONS", "HEAD"};
    for (int32_t value = 0; value < 7; ++value) {
        HttpRequest parsed(HeadersWith("Method", methods[value]), MessageBody());
        EXPECT_EQ(parsed.Method(), static_cast<HttpMethod>(value));
        EXPECT_FALSE(parsed.Uri().has_value());
        EXPECT_EQ(parsed.Headers().HeaderOrEmpty("Method"), methods[value]);
    }
    for (const std::optional<std::string>& method :
         {std::optional<std::string>(), std::optional<std::string>(""),
          std::optional<std::string>("get"), std::optional<std::string>("CONNECT"),
          std::optional<std::string>("0"), std::optional<std::string>(" GET")}) {
        SCOPED_TRACE(method.value_or("<absent>"));
        EXPECT_THROWS_VELDRA(HttpRequest(HeadersWith("Method", method), MessageBody()), -251004,
                             "Failed to parse: Method");
    }
}

TEST(HttpMessages, ResponseCarriesStatusAndPayloadHeaders) {
    const HttpRequest request = SampleRequest();
    HttpResponse response(request, 404, std::string("text/plain"), std::nullopt,
                          MessageBody(kPayload));
    EXPECT_EQ(response.ContentType(), "application/octet-stream");
    EXPECT_EQ(response.RoutingKey(), "Veldra.client_q.HttpResponse");
    EXPECT_EQ(response.CorrelationId(), request.CorrelationId());
    EXPECT_EQ(response.Serialize().ToString(), kPayload);

    const MessageHeaders& headers = response.Headers();
    EXPECT_EQ(headers.HeaderOrEmpty("StatusCode"), "404");
    EXPECT_EQ(headers.HeaderOrEmpty("HttpContentType"), "text/plain");
    EXPECT_EQ(headers.GetHeader("HttpHeaders"), nullptr);
    const HttpResponse parsed(headers, response.Serialize());
    EXPECT_EQ(parsed.StatusCode(), 404);
    EXPECT_EQ(parsed.HttpContentType(), "text/plain");
    EXPECT_FALSE(parsed.HttpHeaders().has_value());
    EXPECT_EQ(parsed.Serialize().ToString(), kPayload);

    const HttpResponse failed(request, MessageBus::MessageError::Named("Tag.NoSuchTag"));
    EXPECT_TRUE(failed.HasError());
    EXPECT_EQ(failed.StatusCode(), 0);
    EXPECT_EQ(failed.Serialize().ToString(), "");
}

TEST(HttpMessages, ResponseStatusIsADecimalNumberAndZeroWhenMissing) {
    const auto status = [](std::optional<std::string> text) {
        return HttpResponse(HeadersWith("StatusCode", std::move(text)), MessageBody()).StatusCode();
    };
    EXPECT_EQ(status(std::nullopt), 0);
    EXPECT_EQ(status(""), 0);
    EXPECT_EQ(status("200"), 200);
    EXPECT_EQ(status("-1"), -1);
    EXPECT_EQ(status("2147483647"), 2147483647);
    for (const char* text : {"abc", "20x", "2147483648", " 200", "+200", "2.5"}) {
        SCOPED_TRACE(text);
        EXPECT_THROWS_VELDRA(status(std::string(text)), -251005, "Failed to parse: StatusCode");
    }
    const HttpResponse headers(HeadersWith("HttpHeaders", "A: 1\r\nB: 2"), MessageBody());
    EXPECT_EQ(headers.HttpHeaders(), "A: 1\r\nB: 2");
    EXPECT_FALSE(headers.HttpContentType().has_value());
}

}  // namespace
}  // namespace Korvane::Veldra::VeldraMessageLibrary::HttpMessages
