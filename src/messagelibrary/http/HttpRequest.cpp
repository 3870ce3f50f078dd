#include "messagelibrary/http/HttpRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/http/HttpHeaderFields.h"
#include "messagelibrary/http/HttpService.h"

namespace Korvane::Veldra::VeldraMessageLibrary::HttpMessages {

HttpRequest::HttpRequest(HttpMethod method, std::optional<std::string> uri,
                         MessageBus::MessageBody body)
    : MessageBus::RequestMessage(kMessageName, MessageBus::kOctetStreamContentType, kHttpService),
      method_(method),
      uri_(std::move(uri)),
      body_(std::move(body)) {
    WriteTo(RequestMessage::Headers());
}

HttpRequest::HttpRequest(MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)),
      method_(ReadHttpMethod(RequestMessage::Headers())),
      uri_(GetOptionalHeader(kUriHeader)),
      body_(body) {}

MessageBus::MessageHeaders& HttpRequest::Headers() {
    MessageBus::MessageHeaders& headers = RequestMessage::Headers();
    WriteTo(headers);
    return headers;
}

const MessageBus::MessageHeaders& HttpRequest::Headers() const {
    written_ = RequestMessage::Headers();
    WriteTo(written_);
    return written_;
}

void HttpRequest::WriteTo(MessageBus::MessageHeaders& headers) const {
    headers.SetHeader(kMethodHeader, HttpMethodText(method_));
    headers.SetHeader(kUriHeader, uri_);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::HttpMessages
