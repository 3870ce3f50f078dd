#pragma once

#include <optional>
#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RequestMessage.h"
#include "messagelibrary/http/HttpMethod.h"

namespace Korvane::Veldra::VeldraMessageLibrary::HttpMessages {

// An HTTP request carried to the HTTP service. The body is the payload as it
// stands; method and URI travel in the headers "Method" and "Uri".
class HttpRequest : public MessageBus::RequestMessage {
public:
    inline static const std::string kMessageName = "HttpRequest";

    HttpRequest(HttpMethod method, std::optional<std::string> uri, MessageBus::MessageBody body);
    // Reads method and URI from the headers and keeps the body unread. A
    // missing or unknown "Method" throws VeldraException(-251004,
    // "Failed to parse: Method").
    HttpRequest(MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body);

    HttpMethod Method() const { return method_; }
    const std::optional<std::string>& Uri() const { return uri_; }
    const MessageBus::MessageBody& Body() const { return body_; }

    // The body as it was given or received.
    MessageBus::MessageBody Serialize() const override { return body_; }

    // The headers with method and URI written in again on every call; an
    // unset URI erases "Uri".
    MessageBus::MessageHeaders& Headers() override;
    const MessageBus::MessageHeaders& Headers() const override;

private:
    void WriteTo(MessageBus::MessageHeaders& headers) const;

    HttpMethod method_ = HttpMethod::Get;
    std::optional<std::string> uri_;
    MessageBus::MessageBody body_;
    // What the const Headers() hands out: the base's headers with the fields.
    mutable MessageBus::MessageHeaders written_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::HttpMessages
