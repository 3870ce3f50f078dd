#pragma once

#include <cstdint>
#include <string_view>

#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/http/HttpMethod.h"

// The header keys that carry the metadata of the HTTP messages, and their
// readers. These messages have opaque bodies: method, URI, status and the
// HTTP payload's own headers travel in the message headers.

namespace Korvane::Veldra::VeldraMessageLibrary::HttpMessages {

inline constexpr std::string_view kMethodHeader = "Method";
inline constexpr std::string_view kUriHeader = "Uri";
inline constexpr std::string_view kStatusCodeHeader = "StatusCode";
inline constexpr std::string_view kHttpContentTypeHeader = "HttpContentType";
inline constexpr std::string_view kHttpHeadersHeader = "HttpHeaders";

// The method named by "Method". An absent header or a text that names no
// method throws VeldraException(-251004, "Failed to parse: Method").
HttpMethod ReadHttpMethod(const MessageBus::MessageHeaders& headers);

// The text form of a method; "" for a value that has none.
const char* HttpMethodText(HttpMethod method);

// The status in "StatusCode": 0 when the header is absent or empty. Anything
// but the decimal digits of a 32-bit number (a leading "-" allowed) throws
// VeldraException(-251005, "Failed to parse: StatusCode").
int32_t ReadHttpStatusCode(const MessageBus::MessageHeaders& headers);

}  // namespace Korvane::Veldra::VeldraMessageLibrary::HttpMessages
