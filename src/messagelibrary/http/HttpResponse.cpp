#include "messagelibrary/http/HttpResponse.h"

#include <string>
#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/http/HttpHeaderFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::HttpMessages {

HttpResponse::HttpResponse(const MessageBus::Interfaces::IRoutingSource& request,
                           int32_t statusCode, std::optional<std::string> httpContentType,
                           std::optional<std::string> httpHeaders, MessageBus::MessageBody body)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kOctetStreamContentType,
                                  request.ReplyTo()),
      statusCode_(statusCode),
      httpContentType_(std::move(httpContentType)),
      httpHeaders_(std::move(httpHeaders)),
      body_(std::move(body)) {
    AnswerTo(request, std::nullopt);
    WriteTo(ResponseMessage::Headers());
}

HttpResponse::HttpResponse(const MessageBus::Interfaces::IRoutingSource& request,
                           const MessageBus::MessageError& error)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kOctetStreamContentType,
                                  request.ReplyTo()) {
    AnswerTo(request, error);
    WriteTo(ResponseMessage::Headers());
}

HttpResponse::HttpResponse(MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::ResponseMessage(std::move(headers)),
      statusCode_(ReadHttpStatusCode(ResponseMessage::Headers())),
      httpContentType_(GetOptionalHeader(kHttpContentTypeHeader)),
      httpHeaders_(GetOptionalHeader(kHttpHeadersHeader)),
      body_(body) {}

MessageBus::MessageHeaders& HttpResponse::Headers() {
    MessageBus::MessageHeaders& headers = ResponseMessage::Headers();
    WriteTo(headers);
    return headers;
}

const MessageBus::MessageHeaders& HttpResponse::Headers() const {
    written_ = ResponseMessage::Headers();
    WriteTo(written_);
    return written_;
}

void HttpResponse::WriteTo(MessageBus::MessageHeaders& headers) const {
    headers.SetHeader(kStatusCodeHeader, std::to_string(statusCode_));
    headers.SetHeader(kHttpContentTypeHeader, httpContentType_);
    headers.SetHeader(kHttpHeadersHeader, httpHeaders_);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::HttpMessages
