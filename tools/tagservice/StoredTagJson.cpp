#include "StoredTagJson.h"

#include <optional>

#include "errors/ErrorCodes.h"
#include "errors/VeldraException.h"
#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/json/JsonWriters.h"

namespace Korvane::Veldra::TagService {

namespace {
const std::string kName = "StoredTag";
}

std::string StoredTagToJson(const StoredTag& tag) {
    return VeldraMessageLibrary::JsonBodyWriter()
        .Field("tag", tag.record)
        .Field("current", tag.current)
        .Field("aggregates", tag.aggregates)
        .Finish();
}

StoredTag StoredTagFromJson(const std::string& text) {
    const auto json = VeldraMessageLibrary::ParseJsonBody(text, kName);
    std::optional<TagRecord> record;
    std::optional<TagAggregates> aggregates;
    StoredTag tag;
    VeldraMessageLibrary::JsonBodyReader(json)
        .Field("tag", record)
        .Field("current", tag.current)
        .Field("aggregates", aggregates);
    if (!record || !record->path || !record->type) {
        throw MessageBus::VeldraException(ErrorCodes::kFailedToParse, "Failed to parse: " + kName);
    }
    tag.record = std::move(*record);
    if (!tag.record.keywords) tag.record.keywords.emplace();
    if (!tag.record.properties) tag.record.properties.emplace();
    if (aggregates) tag.aggregates = std::move(*aggregates);
    return tag;
}

}  // namespace Korvane::Veldra::TagService
