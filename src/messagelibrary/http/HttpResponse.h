#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "messagebus/interfaces/IRoutingSource.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageError.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/ResponseMessage.h"

namespace Korvane::Veldra::VeldraMessageLibrary::HttpMessages {

// The answer to an HttpRequest. The body is the HTTP payload as it stands;
// status, the payload's content type and its HTTP headers (in one text)
// travel in the headers "StatusCode", "HttpContentType" and "HttpHeaders".
class HttpResponse : public MessageBus::ResponseMessage {
public:
    inline static const std::string kMessageName = "HttpResponse";

    HttpResponse(const MessageBus::Interfaces::IRoutingSource& request, int32_t statusCode,
                 std::optional<std::string> httpContentType,
                 std::optional<std::string> httpHeaders, MessageBus::MessageBody body);
    // An error response: status 0, no optional headers, an empty body.
    HttpResponse(const MessageBus::Interfaces::IRoutingSource& request,
                 const MessageBus::MessageError& error);
    // Reads the fields from the headers and keeps the body unread. A missing
    // "StatusCode" reads as 0; one that is no 32-bit decimal number throws
    // VeldraException(-251005, "Failed to parse: StatusCode").
    HttpResponse(MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body);

    int32_t StatusCode() const { return statusCode_; }
    const std::optional<std::string>& HttpContentType() const { return httpContentType_; }
    const std::optional<std::string>& HttpHeaders() const { return httpHeaders_; }
    const MessageBus::MessageBody& Body() const { return body_; }

    // The body as it was given or received.
    MessageBus::MessageBody Serialize() const override { return body_; }

    // The headers with the fields written in again on every call; an unset
    // optional erases its key.
    MessageBus::MessageHeaders& Headers() override;
    const MessageBus::MessageHeaders& Headers() const override;

private:
    void WriteTo(MessageBus::MessageHeaders& headers) const;

    int32_t statusCode_ = 0;
    std::optional<std::string> httpContentType_;
    std::optional<std::string> httpHeaders_;
    MessageBus::MessageBody body_;
    // What the const Headers() hands out: the base's headers with the fields.
    mutable MessageBus::MessageHeaders written_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::HttpMessages
