#pragma once

#include <kvveldra/TagConsole.h>

#include <cstdint>
#include <string>
#include <utility>
#include <vector>

namespace kvtag {

// What a subcommand found, in two forms: lines for a reader, and the JSON
// value of "result" in the document that --json prints.
struct Rendered {
    std::string text;
    std::string json;
};

struct TagEntry {
    std::string path;
    int32_t type = -1;
};

struct ListReport {
    std::vector<TagEntry> tags;
    uint32_t total = 0;
    uint32_t skip = 0;
    uint32_t take = 0;
};

struct WriteEntry {
    std::string path;
    int32_t type = -1;
    std::size_t samples = 0;
};

struct AggregatesReport {
    std::string path;
    int32_t type = -1;
    bool collect = false;
    TagConsoleValue value;
};

// One line per tag: PATH, TAB, TYPE.
Rendered RenderList(const ListReport& report);
// One line per tag: PATH, TYPE, VALUE, TIME (TAB between), and the
// aggregates when the tag has counted any.
Rendered RenderValues(const std::vector<TagConsoleValue>& values);
Rendered RenderWrites(const std::vector<WriteEntry>& writes);
Rendered RenderCreated(const TagEntry& tag);
Rendered RenderKeywords(const std::string& path, const std::vector<std::string>& keywords);
// Properties sorted by key.
Rendered RenderProperties(const std::string& path,
                          std::vector<std::pair<std::string, std::string>> properties);
Rendered RenderAggregates(const AggregatesReport& report);
Rendered RenderDeleted(const std::vector<std::string>& paths);

// The one document of --json: {"ok":true,"command":C,"result":R}.
std::string JsonSuccess(const std::string& command, const std::string& resultJson);
// {"ok":false,"command":C,"error":{"kind":K,"status":S|null,"message":M}}
// with kind "usage", "library" or "tool"; the status is the library's.
std::string JsonFailure(const std::string& command, const std::string& kind, const int32_t* status,
                        const std::string& message);

}  // namespace kvtag
