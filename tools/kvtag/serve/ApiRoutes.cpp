#include "ApiRoutes.h"

#include <array>
#include <cctype>
#include <chrono>
#include <exception>
#include <utility>

#include "CommandLine.h"
#include "Failures.h"
#include "JsonWriter.h"
#include "PageAssets.h"
#include "QueryString.h"
#include "Report.h"
#include "RequestBody.h"
#include "StatusCodes.h"
#include "TagGateway.h"
#include "TimeText.h"
#include "TrendHistory.h"

namespace kvtag::serve {
namespace {

constexpr uint32_t kDefaultTake = 100;
constexpr uint32_t kMaxTake = 1000;

struct Route {
    const char* path;
    const char* methods;  // as the Allow header lists them
};

constexpr std::array<Route, 8> kRoutes = {{{"/", "GET"},
                                           {"/kvtag.js", "GET"},
                                           {"/kvtag.css", "GET"},
                                           {"/api/list", "GET"},
                                           {"/api/read", "GET, POST"},
                                           {"/api/trend", "GET"},
                                           {"/api/write", "POST"},
                                           {"/favicon.ico", "GET"}}};

const Route* FindRoute(const std::string& path) {
    for (const auto& route : kRoutes) {
        if (path == route.path) return &route;
    }
    return nullptr;
}

bool Allows(const Route& route, const std::string& method) {
    const std::string methods = std::string(route.methods) + ", ";
    return methods.find(method + ", ") == 0 ||
           methods.find(", " + method + ", ") != std::string::npos;
}

HttpResponse Asset(std::string contentType, std::string body) {
    HttpResponse response;
    response.contentType = std::move(contentType);
    response.body = std::move(body);
    return response;
}

// A JSON object with one more member at its end.
std::string WithMember(const std::string& object, const std::string& key,
                       const std::string& valueJson) {
    const bool empty = object == "{}";
    return object.substr(0, object.size() - 1) + (empty ? "" : ",") + JsonQuote(key) + ":" +
           valueJson + "}";
}

uint32_t CountParameter(const Target& target, const std::string& name, uint32_t fallback) {
    const std::string text = target.First(name, std::to_string(fallback));
    const auto value = ParseUint32(text);
    if (!value) throw QueryError(name + " needs a whole number, not '" + text + "'");
    return *value;
}

// localhost, 127.x.x.x or [::1], with or without a port; no Host at all
// (an HTTP/1.0 client, never a browser) passes too.
bool IsLoopbackHost(const std::string& host) {
    if (host.empty()) return true;
    std::string name = host;
    if (name.front() == '[') {
        name = name.substr(0, name.find(']') + 1);
    } else if (const auto colon = name.rfind(':'); colon != std::string::npos) {
        name.resize(colon);
    }
    for (char& c : name) c = static_cast<char>(std::tolower(static_cast<unsigned char>(c)));
    return name == "localhost" || name == "[::1]" || name.rfind("127.", 0) == 0;
}

HttpResponse Answer(const std::function<std::string()>& work) {
    try {
        return JsonResponse(200, work());
    } catch (const LibraryError& failure) {
        return ErrorResponse(failure.Status() == status::kRequestTimedOut ? 504 : 502,
                             failure.what());
    } catch (const ToolError& failure) {
        return ErrorResponse(404, failure.what());
    } catch (const UsageError& failure) {
        return ErrorResponse(400, failure.what());
    } catch (const std::exception& failure) {
        return ErrorResponse(500, std::string("unexpected failure: ") + failure.what());
    }
}

// Answers with what `work` gives on the library's thread.
void OnLibrary(TagGateway& gateway, const Reply& reply, std::function<std::string()> work) {
    if (!gateway.Submit([reply, work = std::move(work)] { reply(Answer(work)); })) {
        reply(ErrorResponse(503, "too many requests wait for the tag service; try again"));
    }
}

std::string ReadingJson(const Reading& reading) {
    JsonWriter missing;
    missing.BeginArray();
    for (const auto& path : reading.missing) missing.String(path);
    missing.EndArray();
    return WithMember(RenderValues(reading.values).json, "missing", missing.Text());
}

std::string TrendJson(const std::string& path, const std::vector<TrendPoint>& points) {
    JsonWriter json;
    json.BeginObject()
        .Key("path")
        .String(path)
        .Key("spanSeconds")
        .Integer(std::chrono::seconds(TrendHistory::kSpan).count())
        .Key("points")
        .BeginArray();
    for (const auto& point : points) {
        json.BeginObject()
            .Key("at")
            .String(FormatIsoTime(point.polled))
            .Key("value")
            .String(point.value)
            .Key("time")
            .String(FormatIsoTime(point.time))
            .EndObject();
    }
    json.EndArray().EndObject();
    return json.Text();
}

}  // namespace

ApiRoutes::ApiRoutes(TagGateway& gateway, TrendHistory& history, PageSettings settings)
    : gateway_(gateway), history_(history), settings_(std::move(settings)) {}

void ApiRoutes::Handle(HttpRequest request, const Reply& reply) const {
    try {
        if (settings_.loopbackOnly && !IsLoopbackHost(request.host)) {
            reply(ErrorResponse(403, "the Host header names '" + request.host +
                                         "'; kvtag serve on a loopback address answers only "
                                         "requests for localhost, 127.0.0.1 or [::1]"));
            return;
        }
        const Target target = ParseTarget(request.target);
        const Route* route = FindRoute(target.path);
        if (route == nullptr || target.path == "/favicon.ico") {
            reply(ErrorResponse(404, "nothing at " + target.path));
            return;
        }
        if (!Allows(*route, request.method)) {
            HttpResponse response = ErrorResponse(405, request.method + " is not allowed on " +
                                                           target.path + "; use " + route->methods);
            response.headers.emplace_back("Allow", route->methods);
            reply(std::move(response));
            return;
        }
        const std::string& path = target.path;
        if (path == "/") {
            reply(
                Asset("text/html; charset=utf-8", PageHtml(settings_.allowWrite, settings_.token)));
        } else if (path == "/kvtag.js") {
            reply(Asset("text/javascript; charset=utf-8", PageScript()));
        } else if (path == "/kvtag.css") {
            reply(Asset("text/css; charset=utf-8", PageStyle()));
        } else if (path == "/api/list") {
            const std::string pattern = target.First("pattern");
            if (pattern.empty()) throw QueryError("give a pattern, such as pattern=line1.*");
            const uint32_t skip = CountParameter(target, "skip", 0);
            const uint32_t take = CountParameter(target, "take", kDefaultTake);
            if (take == 0 || take > kMaxTake) {
                throw QueryError("take needs 1 to " + std::to_string(kMaxTake));
            }
            OnLibrary(gateway_, reply, [this, pattern, skip, take] {
                return gateway_.ListJson(pattern, skip, take);
            });
        } else if (path == "/api/read") {
            std::vector<std::string> paths;
            if (request.method == "POST") {
                paths = ParseReadBody(request.body);
            } else {
                const auto found = target.parameters.find("path");
                if (found != target.parameters.end()) paths = found->second;
                CheckReadPaths(paths);
            }
            OnLibrary(gateway_, reply, [this, paths] { return ReadingJson(gateway_.Read(paths)); });
        } else if (path == "/api/trend") {
            const std::string tag = target.First("path");
            if (const auto problem = TagPathProblem(tag)) throw QueryError(*problem);
            if (!history_.Watch(tag, TrendHistory::Clock::now())) {
                reply(ErrorResponse(429, "at most " + std::to_string(TrendHistory::kMaxTags) +
                                             " tags are plotted at a time"));
                return;
            }
            reply(JsonResponse(200, TrendJson(tag, history_.Points(tag, NowTime()))));
        } else if (path == "/api/write") {
            if (!settings_.allowWrite) {
                reply(ErrorResponse(403, "writing is off; start kvtag serve with --allow-write"));
                return;
            }
            if (request.token != settings_.token) {
                reply(ErrorResponse(403, std::string("a write needs the page's token in the ") +
                                             kTokenHeader + " header"));
                return;
            }
            const WriteBody body = ParseWriteBody(request.body);
            OnLibrary(gateway_, reply,
                      [this, body] { return gateway_.WriteJson(body.path, body.value); });
        }
    } catch (const QueryError& failure) {
        reply(ErrorResponse(400, failure.what()));
    } catch (const BodyError& failure) {
        reply(ErrorResponse(400, failure.what()));
    }
}

}  // namespace kvtag::serve
