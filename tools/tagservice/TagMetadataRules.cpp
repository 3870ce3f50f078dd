#include "TagMetadataRules.h"

#include <algorithm>

#include "TagPathRules.h"
#include "messagelibrary/TagDataType.h"

namespace Korvane::Veldra::TagService {

using VeldraMessageLibrary::TagDataType;

void ChangeKeywords(TagRecord& tag, const std::optional<JsonStringList>& keywords, bool merge) {
    JsonStringList result = merge && tag.keywords ? *tag.keywords : JsonStringList{};
    for (const std::string& keyword : keywords.value_or(JsonStringList{})) {
        if (std::find(result.begin(), result.end(), keyword) == result.end()) {
            result.push_back(keyword);
        }
    }
    tag.keywords = std::move(result);
}

void ChangeProperties(TagRecord& tag, const std::optional<JsonStringMap>& properties, bool merge) {
    JsonStringMap result = merge && tag.properties ? *tag.properties : JsonStringMap{};
    for (const auto& [key, value] : properties.value_or(JsonStringMap{})) result[key] = value;
    tag.properties = std::move(result);
}

std::optional<std::string> ChangeCollectAggregates(StoredTag& tag, bool collect) {
    if (collect && tag.record.type == TagDataType::String) {
        return std::string("Tag.StringTagCannotCollectAggregates");
    }
    if (tag.record.collectAggregates != collect) tag.aggregates = TagAggregates{};
    tag.record.collectAggregates = collect;
    return std::nullopt;
}

std::optional<std::string> NewTag(const TagRecord& record, StoredTag& tag) {
    if (auto error = NewTagPathError(record.path.value_or(std::string()))) return error;
    const int type = record.type ? static_cast<int>(*record.type) : 0;
    if (type < static_cast<int>(TagDataType::Double) || type > static_cast<int>(TagDataType::DateTime)) {
        return std::string("Tag.InvalidTagType");
    }
    tag = StoredTag{};
    tag.record.path = record.path;
    tag.record.type = record.type;
    tag.record.keywords = JsonStringList{};
    tag.record.properties = JsonStringMap{};
    ChangeKeywords(tag.record, record.keywords, false);
    ChangeProperties(tag.record, record.properties, false);
    return ChangeCollectAggregates(tag, record.collectAggregates);
}

}  // namespace Korvane::Veldra::TagService
