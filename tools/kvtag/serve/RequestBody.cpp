#include "RequestBody.h"

#include <algorithm>
#include <utility>

#include "CommandLine.h"
#include "JsonCheck.h"

namespace kvtag::serve {
namespace {

using Members = std::vector<std::pair<std::string, JsonScalar>>;

// The members of the body's object, each name known and given once.
Members ReadObject(std::string_view body, const std::vector<std::string>& known) {
    if (body.find('\0') != std::string_view::npos) {
        throw BodyError("the request body holds a zero byte");
    }
    JsonDocument document = ReadJsonDocument(body);
    if (document.error) throw BodyError("the request body is not JSON: " + *document.error);
    if (document.rootKind != JsonKind::Object) {
        throw BodyError(std::string("the request body must be a JSON object, not ") +
                        JsonKindName(document.rootKind));
    }
    for (std::size_t i = 0; i < document.members.size(); ++i) {
        const std::string& name = document.members[i].first;
        if (std::find(known.begin(), known.end(), name) == known.end()) {
            throw BodyError("unknown member \"" + name + "\" in the request body");
        }
        for (std::size_t j = 0; j < i; ++j) {
            if (document.members[j].first == name) {
                throw BodyError("the member \"" + name + "\" is given twice");
            }
        }
    }
    return std::move(document.members);
}

const JsonScalar& Member(const Members& members, const std::string& name) {
    for (const auto& [key, value] : members) {
        if (key == name) return value;
    }
    throw BodyError("the request body lacks the member \"" + name + "\"");
}

}  // namespace

void CheckReadPaths(const std::vector<std::string>& paths) {
    if (paths.empty()) throw BodyError("no path to read");
    if (paths.size() > kMaxReadPaths) {
        throw BodyError("at most " + std::to_string(kMaxReadPaths) + " paths in one read, not " +
                        std::to_string(paths.size()));
    }
    for (const auto& path : paths) {
        if (const auto problem = TagPathProblem(path)) throw BodyError(*problem);
    }
}

std::vector<std::string> ParseReadBody(std::string_view body) {
    const Members members = ReadObject(body, {"paths"});
    const JsonScalar& paths = Member(members, "paths");
    if (paths.kind != JsonKind::Array) throw BodyError("\"paths\" must be an array of texts");
    std::vector<std::string> out;
    for (const auto& item : paths.items) {
        if (item.kind != JsonKind::String) {
            throw BodyError(std::string("\"paths\" must hold texts only, not ") +
                            JsonKindName(item.kind));
        }
        out.push_back(item.text);
    }
    CheckReadPaths(out);
    return out;
}

WriteBody ParseWriteBody(std::string_view body) {
    const Members members = ReadObject(body, {"path", "value"});
    const JsonScalar& path = Member(members, "path");
    const JsonScalar& value = Member(members, "value");
    if (path.kind != JsonKind::String) throw BodyError("\"path\" must be a text");
    if (const auto problem = TagPathProblem(path.text)) throw BodyError(*problem);
    WriteBody out{path.text, value.text};
    if (value.kind == JsonKind::Bool) {
        out.value = value.truth ? "true" : "false";
    } else if (value.kind != JsonKind::String && value.kind != JsonKind::Number) {
        throw BodyError(std::string("\"value\" must be a text, a number or a boolean, not ") +
                        JsonKindName(value.kind));
    }
    return out;
}

}  // namespace kvtag::serve
