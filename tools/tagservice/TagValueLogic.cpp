// The TagIngestion and TagCurrentValue halves of the service's rules: values
// and aggregates.
#include "PendingTags.h"
#include "TagServiceLogic.h"
#include "TagValueRules.h"
#include "messagelibrary/tagcurrentvalue/TagCvAggregatesResetBroadcast.h"
#include "messagelibrary/tagingestion/TagNewTagsIngestedBroadcast.h"

namespace Korvane::Veldra::TagService {

namespace {

using VeldraMessageLibrary::JsonStringList;
using VeldraMessageLibrary::TagAggregatedUpdates;
using VeldraMessageLibrary::TagPathUpdates;
using VeldraMessageLibrary::TagUpdateSet;
using VeldraMessageLibrary::TagValue;
using VeldraMessageLibrary::TagValueUpdate;

bool KeepsAggregates(const StoredTag& tag) {
    return tag.record.collectAggregates && IsNumericType(*tag.record.type);
}

}  // namespace

TagCurrentValue CurrentValueOf(const StoredTag& tag) {
    TagCurrentValue value;
    value.path = tag.Path();
    value.current = tag.current;
    if (KeepsAggregates(tag)) value.aggregates = tag.aggregates;
    return value;
}

Outcome TagServiceLogic::UpdateValues(const TagIngest::TagUpdateValuesRoutedMessage& message) {
    const Timestamp received = clock_();
    PendingTags pending(store_);
    std::vector<TagUpdateSet> ingested;
    for (const TagPathUpdates& entry : message.Updates().value_or(std::vector<TagPathUpdates>{})) {
        const std::string path = entry.path.value_or(std::string());
        StoredTag* tag = pending.Change(path);
        if (tag == nullptr) return {ServiceError("Tag.NoSuchTag", {path}), {}};
        const TagDataType type = *tag->record.type;
        TagUpdateSet set;
        set.updates.emplace();
        for (const auto& sample : entry.updates.value_or(std::vector<TagValueSample>{})) {
            const bool hasText = sample.value && sample.value->value;
            const std::string text = hasText ? *sample.value->value : std::string();
            if (!hasText || !CanReadValue(type, text)) {
                return {ServiceError("Tag.InvalidTagValue", {path, text}), {}};
            }
            TagValueSample stored;
            stored.timestamp = sample.timestamp.is_not_a_date_time() ? received : sample.timestamp;
            stored.value = TagValue{type, text};
            tag->current = stored;
            if (tag->record.collectAggregates) AddToAggregates(tag->aggregates, type, text);
            TagValueUpdate update{stored.timestamp, stored.value, std::nullopt};
            if (KeepsAggregates(*tag)) update.aggregates = tag->aggregates;
            set.updates->push_back(std::move(update));
        }
        set.tag = tag->record;
        ingested.push_back(std::move(set));
    }
    store_.Apply(pending.Batch());
    if (ingested.empty()) return {};
    return {std::nullopt,
            {std::make_shared<TagIngest::TagNewTagsIngestedBroadcast>(std::move(ingested))}};
}

std::vector<TagCurrentValue> TagServiceLogic::QueryCurrentValues(
    const TagCv::TagCvQueryCurrentValuesByPathRequest& request) const {
    std::vector<TagCurrentValue> values;
    for (const std::string& path : request.Paths().value_or(JsonStringList{})) {
        if (const StoredTag* tag = store_.Find(path)) values.push_back(CurrentValueOf(*tag));
    }
    return values;
}

Outcome TagServiceLogic::ResetAggregates(const TagCv::TagCvResetAggregatesRoutedMessage& message) {
    PendingTags pending(store_);
    std::vector<TagAggregatedUpdates> reset;
    for (const std::string& path : message.Paths().value_or(JsonStringList{})) {
        StoredTag* tag = pending.Change(path);
        if (tag == nullptr) return {ServiceError("Tag.NoSuchTag", {path}), {}};
        tag->aggregates = TagAggregates{};
        TagValueUpdate update{tag->current ? tag->current->timestamp : clock_(),
                              tag->current ? tag->current->value : std::nullopt, tag->aggregates};
        reset.push_back(TagAggregatedUpdates{path, std::vector<TagValueUpdate>{update}});
    }
    store_.Apply(pending.Batch());
    if (reset.empty()) return {};
    return {std::nullopt,
            {std::make_shared<TagCv::TagCvAggregatesResetBroadcast>(std::move(reset))}};
}

}  // namespace Korvane::Veldra::TagService
