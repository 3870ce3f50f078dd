#pragma once

#include <string>

#include "HttpMessages.h"

namespace kvtag::serve {

class TagGateway;
class TrendHistory;

struct PageSettings {
    bool allowWrite = false;
    std::string token;  // what a write must carry in X-Kvtag-Token
    // Listening on a loopback address: requests must name a loopback host,
    // so that a page of another site that rebinds its name to this machine
    // cannot read tags through the visitor's browser.
    bool loopbackOnly = true;
};

// The page and the JSON API under /api/:
//   GET /                    the page (with /kvtag.js and /kvtag.css)
//   GET /api/list            ?pattern=P&skip=N&take=N: paths, types, total
//   GET, POST /api/read      ?path=A&path=B, or {"paths":[...]}: values
//   GET /api/trend           ?path=A: the polls of the last 10 minutes
//   POST /api/write          {"path":A,"value":V}, only with --allow-write
// Failures answer {"error": "..."}: 400 for a bad request, 403 for a write
// that is off or lacks the token or for a foreign Host on loopback, 404 for an unknown path or tag, 405 for
// a wrong method, 502/504 when the tag service fails or does not answer,
// 503 when too many requests wait for it.
class ApiRoutes {
public:
    ApiRoutes(TagGateway& gateway, TrendHistory& history, PageSettings settings);
    void Handle(HttpRequest request, const Reply& reply) const;

private:
    TagGateway& gateway_;
    TrendHistory& history_;
    PageSettings settings_;
};

}  // namespace kvtag::serve
