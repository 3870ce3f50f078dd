// The TagInfo half of the service's rules: tags and their metadata.
#include <algorithm>
#include <limits>
#include <set>

#include "PendingTags.h"
#include "TagMetadataRules.h"
#include "TagPathRules.h"
#include "TagServiceLogic.h"
#include "messagelibrary/taginfo/TagInfoDeletedTagsBroadcast.h"
#include "messagelibrary/taginfo/TagInfoTagMetadataUpdatedBroadcast.h"

namespace Korvane::Veldra::TagService {

namespace {

using VeldraMessageLibrary::TagChangeFlags;

bool Has(const std::optional<TagChangeFlags>& flags, TagChangeFlags flag) {
    return flags && (*flags & flag) == flag;
}

bool MatchesFilters(const StoredTag& tag, const TagInfo::TagInfoQueryTagsRequest& request) {
    if (!MatchesAnySearchPath(request.SearchPaths(), tag.Path())) return false;
    for (const auto& [key, value] : request.Properties().value_or(JsonStringMap{})) {
        const auto found = tag.record.properties->find(key);
        if (found == tag.record.properties->end() || found->second != value) return false;
    }
    const JsonStringList& keywords = *tag.record.keywords;
    for (const std::string& keyword : request.Keywords().value_or(JsonStringList{})) {
        if (std::find(keywords.begin(), keywords.end(), keyword) == keywords.end()) return false;
    }
    return true;
}

bool AllLiteral(const JsonStringList& patterns) {
    return !patterns.empty() && std::all_of(patterns.begin(), patterns.end(), IsLiteralSearchPath);
}

// Visits the tags that the patterns can match, in path order: looked up one
// by one when no pattern holds a '*', else every tag of the store. An empty
// list visits every tag.
template <typename Visit>
void ForCandidates(const TagStore& store, const JsonStringList& patterns, Visit visit) {
    if (!AllLiteral(patterns)) {
        store.ForEach(visit);
        return;
    }
    for (const std::string& path : std::set<std::string>(patterns.begin(), patterns.end())) {
        if (const StoredTag* tag = store.Find(path)) visit(*tag);
    }
}

std::shared_ptr<MessageBus::MessageBase> MetadataUpdated(const StoredTag& tag) {
    return std::make_shared<TagInfo::TagInfoTagMetadataUpdatedBroadcast>(tag.record);
}

}  // namespace

TagServiceLogic::TagServiceLogic(TagStore& store, Clock clock)
    : store_(store), clock_(std::move(clock)) {}

Timestamp TagServiceLogic::UtcNow() {
    return boost::posix_time::microsec_clock::universal_time();
}

TagPage TagServiceLogic::QueryTags(const TagInfo::TagInfoQueryTagsRequest& request) const {
    const int64_t skip = std::max<int32_t>(request.Skip(), 0);
    const int64_t take =
        request.Take() <= 0 ? std::numeric_limits<int64_t>::max() : request.Take();
    TagPage page;
    int64_t matches = 0;
    ForCandidates(store_, request.SearchPaths().value_or(JsonStringList{}),
                  [&](const StoredTag& tag) {
                      if (!MatchesFilters(tag, request)) return;
                      ++matches;
                      if (matches > skip && static_cast<int64_t>(page.tags.size()) < take) {
                          page.tags.push_back(tag.record);
                      }
                  });
    page.totalCount = static_cast<int32_t>(
        std::min<int64_t>(matches, std::numeric_limits<int32_t>::max()));
    return page;
}

Outcome TagServiceLogic::CreateTag(const TagInfo::TagInfoCreateTagRoutedMessage& message) {
    const TagRecord record = message.NewTag().value_or(TagRecord{});
    const std::string path = record.path.value_or(std::string());
    if (auto error = NewTagPathError(path)) return {ServiceError(*error, {path}), {}};
    if (const StoredTag* existing = store_.Find(path)) {
        if (existing->record.type == record.type) return {};
        return {ServiceError("Tag.TagAlreadyExists", {path}), {}};
    }
    StoredTag tag;
    if (auto error = NewTag(record, tag)) return {ServiceError(*error, {path}), {}};
    StoreBatch batch;
    batch.put.push_back(tag);
    store_.Apply(batch);
    return {std::nullopt, {MetadataUpdated(tag)}};
}

ChangeOutcome TagServiceLogic::CreateOrUpdateTags(
    const TagInfo::TagInfoCreateOrUpdateTagsRequest& request) {
    PendingTags pending(store_);
    std::vector<ErrorRecord> failures;
    std::vector<std::string> changed;
    for (const auto& change : request.Tags().value_or(std::vector<VeldraMessageLibrary::TagChange>{})) {
        const TagRecord record = change.tag.value_or(TagRecord{});
        const std::string path = record.path.value_or(std::string());
        const StoredTag* current = pending.Find(path);
        if (current == nullptr) {
            failures.push_back(TagErrorRecord("Tag.NoSuchTag", path));
            continue;
        }
        StoredTag updated = *current;
        if (Has(change.changes, TagChangeFlags::Keywords)) {
            ChangeKeywords(updated.record, record.keywords, request.Merge());
        }
        if (Has(change.changes, TagChangeFlags::Properties)) {
            ChangeProperties(updated.record, record.properties, request.Merge());
        }
        if (Has(change.changes, TagChangeFlags::CollectAggregates)) {
            if (auto error = ChangeCollectAggregates(updated, record.collectAggregates)) {
                failures.push_back(TagErrorRecord(*error, path));
                continue;
            }
        }
        pending.Put(std::move(updated));
        if (std::find(changed.begin(), changed.end(), path) == changed.end()) changed.push_back(path);
    }
    store_.Apply(pending.Batch());
    ChangeOutcome outcome;
    for (const std::string& path : changed) {
        outcome.broadcasts.push_back(MetadataUpdated(*store_.Find(path)));
    }
    if (!failures.empty()) outcome.errors = AggregateErrorRecord(std::move(failures));
    return outcome;
}

Outcome TagServiceLogic::UpdateTag(const TagInfo::TagInfoUpdateTagRoutedMessage& message) {
    const std::string path = message.Path().value_or(std::string());
    const StoredTag* current = store_.Find(path);
    if (current == nullptr) return {ServiceError("Tag.NoSuchTag", {path}), {}};
    StoredTag updated = *current;
    const bool merge = !message.Replace();
    if (message.Keywords()) ChangeKeywords(updated.record, message.Keywords(), merge);
    if (message.Properties()) ChangeProperties(updated.record, message.Properties(), merge);
    const auto collect = message.CollectAggregates();
    if (collect && *collect != VeldraMessageLibrary::CollectAggregatesChange::None) {
        const bool enable = *collect == VeldraMessageLibrary::CollectAggregatesChange::Enable;
        if (auto error = ChangeCollectAggregates(updated, enable)) {
            return {ServiceError(*error, {path}), {}};
        }
    }
    StoreBatch batch;
    batch.put.push_back(updated);
    store_.Apply(batch);
    return {std::nullopt, {MetadataUpdated(updated)}};
}

Outcome TagServiceLogic::DeleteTags(const TagInfo::TagInfoDeleteTagsRoutedMessage& message) {
    const JsonStringList patterns = message.Paths().value_or(JsonStringList{});
    if (patterns.empty()) return {};
    StoreBatch batch;
    ForCandidates(store_, patterns, [&](const StoredTag& tag) {
        if (MatchesAnySearchPath(patterns, tag.Path())) batch.erase.push_back(tag.Path());
    });
    if (batch.erase.empty()) return {};
    store_.Apply(batch);
    return {std::nullopt, {std::make_shared<TagInfo::TagInfoDeletedTagsBroadcast>(batch.erase)}};
}

}  // namespace Korvane::Veldra::TagService
