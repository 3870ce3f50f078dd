// The parsing constructors of the HTTP messages, which read their fields from
// the headers. The first byte picks the class (even: request, odd: response);
// the rest is split at line feeds into the values of the class's headers in
// order ("Method", "Uri" or "StatusCode", "HttpContentType", "HttpHeaders"),
// and what follows the last of them is the body. A header without a line is
// absent. A message either parses or is refused with VeldraException; what
// parses must give its fields, its body and its headers back unchanged when
// parsed again from the headers it hands out.

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "errors/VeldraException.h"
#include "messagelibrary/http/HttpHeaderFields.h"
#include "messagelibrary/http/HttpRequest.h"
#include "messagelibrary/http/HttpResponse.h"

namespace {

using namespace Korvane::Veldra::VeldraMessageLibrary::HttpMessages;
using Korvane::Veldra::MessageBus::MessageBody;
using Korvane::Veldra::MessageBus::MessageHeaders;
using Korvane::Veldra::MessageBus::VeldraException;

// Fills the headers named by keys from the lines of input and returns the rest.
std::string_view TakeHeaders(std::string_view input, const std::vector<std::string_view>& keys,
                             MessageHeaders& headers) {
    for (const std::string_view key : keys) {
        const std::size_t end = input.find('\n');
        if (end == std::string_view::npos) break;
        headers.SetHeader(key, std::string(input.substr(0, end)));
        input.remove_prefix(end + 1);
    }
    return input;
}

template <typename M, typename Same>
void CheckRoundTrip(const MessageHeaders& headers, std::string_view bodyText, Same same) {
    const MessageBody body(bodyText.data(), bodyText.size());
    try {
        M first(headers, body);
        const M second(first.Headers(), first.Serialize());
        if (!same(first, second) || second.Serialize().ToString() != bodyText ||
            second.Headers().headers != first.Headers().headers) {
            __builtin_trap();
        }
    } catch (const VeldraException&) {
    }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, std::size_t size) {
    if (size == 0) return 0;
    const std::string_view input(reinterpret_cast<const char*>(data + 1), size - 1);
    MessageHeaders headers;
    if (data[0] % 2 == 0) {
        const std::string_view body = TakeHeaders(input, {kMethodHeader, kUriHeader}, headers);
        CheckRoundTrip<HttpRequest>(headers, body, [](const HttpRequest& a, const HttpRequest& b) {
            return a.Method() == b.Method() && a.Uri() == b.Uri();
        });
    } else {
        const std::string_view body = TakeHeaders(
            input, {kStatusCodeHeader, kHttpContentTypeHeader, kHttpHeadersHeader}, headers);
        CheckRoundTrip<HttpResponse>(headers, body,
                                     [](const HttpResponse& a, const HttpResponse& b) {
                                         return a.StatusCode() == b.StatusCode() &&
                                                a.HttpContentType() == b.HttpContentType() &&
                                                a.HttpHeaders() == b.HttpHeaders();
                                     });
    }
    return 0;
}
