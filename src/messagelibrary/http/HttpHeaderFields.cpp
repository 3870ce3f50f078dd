#include "messagelibrary/http/HttpHeaderFields.h"

#include <charconv>
#include <string>
#include <system_error>

#include "messagelibrary/json/JsonReaders.h"

namespace Korvane::Veldra::VeldraMessageLibrary::HttpMessages {

HttpMethod ReadHttpMethod(const MessageBus::MessageHeaders& headers) {
    const std::string* text = headers.GetHeader(kMethodHeader);
    int32_t value = 0;
    if (text == nullptr || !JsonEnumTextsOf(HttpMethod{}).ValueOf(*text, value)) {
        ThrowFieldRefused(kMethodHeader, kJsonRecordFieldRefusedCode);
    }
    return static_cast<HttpMethod>(value);
}

const char* HttpMethodText(HttpMethod method) {
    const char* text = JsonEnumTextsOf(method).TextOf(static_cast<int32_t>(method));
    return text != nullptr ? text : "";
}

int32_t ReadHttpStatusCode(const MessageBus::MessageHeaders& headers) {
    const std::string& text = headers.HeaderOrEmpty(kStatusCodeHeader);
    if (text.empty()) return 0;
    int32_t status = 0;
    const char* end = text.data() + text.size();
    const auto [stop, error] = std::from_chars(text.data(), end, status);
    if (error != std::errc() || stop != end) {
        ThrowFieldRefused(kStatusCodeHeader, kJsonFieldRefusedCode);
    }
    return status;
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::HttpMessages
