#pragma once

#include <functional>
#include <string>
#include <utility>
#include <vector>

#include "JsonWriter.h"

namespace kvtag::serve {

// One HTTP request as the routes see it, apart from the wire.
struct HttpRequest {
    std::string method;  // "GET", "POST", ...
    std::string target;  // the path and the query, as sent
    std::string body;
    std::string token;  // the X-Kvtag-Token header; empty when absent
    std::string host;   // the Host header; empty when absent
};

struct HttpResponse {
    int status = 200;
    std::string contentType = "application/json";
    std::string body;
    std::vector<std::pair<std::string, std::string>> headers;  // besides the common ones
};

// The answer to a request; callable once, from any thread.
using Reply = std::function<void(HttpResponse)>;
using RequestHandler = std::function<void(HttpRequest, Reply)>;

inline constexpr const char* kTokenHeader = "X-Kvtag-Token";

inline HttpResponse JsonResponse(int status, std::string json) {
    HttpResponse response;
    response.status = status;
    response.body = std::move(json);
    return response;
}

// {"error": message}
inline HttpResponse ErrorResponse(int status, const std::string& message) {
    return JsonResponse(status,
                        JsonWriter().BeginObject().Key("error").String(message).EndObject().Text());
}

}  // namespace kvtag::serve
