#include "messagelibrary/TagRecords.h"

namespace Korvane::Veldra::VeldraMessageLibrary {

void WriteJsonFields(JsonObjectWriter& out, const TagRecord& record) {
    out.Field("path", record.path)
        .Field("type", record.type)
        .Field("properties", record.properties)
        .Field("keywords", record.keywords)
        .Field("collectAggregates", record.collectAggregates);
}

bool ReadJsonFields(TagRecord& out, const JsonVariant& object) {
    return ReadField(out.path, object, "path") && ReadField(out.type, object, "type") &&
           ReadField(out.properties, object, "properties") &&
           ReadField(out.keywords, object, "keywords") &&
           ReadField(out.collectAggregates, object, "collectAggregates");
}

void WriteJsonFields(JsonObjectWriter& out, const TagValue& record) {
    out.Field("type", record.type).Field("value", record.value);
}

bool ReadJsonFields(TagValue& out, const JsonVariant& object) {
    return ReadField(out.type, object, "type") && ReadField(out.value, object, "value");
}

void WriteJsonFields(JsonObjectWriter& out, const TagAggregates& record) {
    out.Field("count", record.count)
        .Field("avg", record.avg)
        .Field("min", record.min)
        .Field("max", record.max);
}

bool ReadJsonFields(TagAggregates& out, const JsonVariant& object) {
    return ReadField(out.count, object, "count") && ReadField(out.avg, object, "avg") &&
           ReadField(out.min, object, "min") && ReadField(out.max, object, "max");
}

void WriteJsonFields(JsonObjectWriter& out, const TagValueSample& record) {
    out.Field("timestamp", record.timestamp).Field("value", record.value);
}

bool ReadJsonFields(TagValueSample& out, const JsonVariant& object) {
    return ReadField(out.timestamp, object, "timestamp") && ReadField(out.value, object, "value");
}

void WriteJsonFields(JsonObjectWriter& out, const TagValueUpdate& record) {
    out.Field("timestamp", record.timestamp)
        .Field("value", record.value)
        .Field("aggregates", record.aggregates);
}

bool ReadJsonFields(TagValueUpdate& out, const JsonVariant& object) {
    return ReadField(out.timestamp, object, "timestamp") && ReadField(out.value, object, "value") &&
           ReadField(out.aggregates, object, "aggregates");
}

void WriteJsonFields(JsonObjectWriter& out, const TagPathUpdates& record) {
    out.Field("path", record.path).Field("updates", record.updates);
}

bool ReadJsonFields(TagPathUpdates& out, const JsonVariant& object) {
    return ReadField(out.path, object, "path") && ReadField(out.updates, object, "updates");
}

void WriteJsonFields(JsonObjectWriter& out, const TagAggregatedUpdates& record) {
    out.Field("path", record.path).Field("updates", record.updates);
}

bool ReadJsonFields(TagAggregatedUpdates& out, const JsonVariant& object) {
    return ReadField(out.path, object, "path") && ReadField(out.updates, object, "updates");
}

void WriteJsonFields(JsonObjectWriter& out, const TagUpdateSet& record) {
    out.Field("tag", record.tag).Field("updates", record.updates);
}

bool ReadJsonFields(TagUpdateSet& out, const JsonVariant& object) {
    return ReadField(out.tag, object, "tag") && ReadField(out.updates, object, "updates");
}

void WriteJsonFields(JsonObjectWriter& out, const TagCurrentValue& record) {
    out.Field("path", record.path)
        .Field("current", record.current)
        .Field("aggregates", record.aggregates);
}

bool ReadJsonFields(TagCurrentValue& out, const JsonVariant& object) {
    return ReadField(out.path, object, "path") && ReadField(out.current, object, "current") &&
           ReadField(out.aggregates, object, "aggregates");
}

void WriteJsonFields(JsonObjectWriter& out, const TagChange& record) {
    const std::string changes = TagChangeFlagsJson(record.changes);
    out.Field("tag", record.tag).Field("changes", JsonRaw{changes});
}

bool ReadJsonFields(TagChange& out, const JsonVariant& object) {
    return ReadField(out.tag, object, "tag") && ReadTagChangeFlags(out.changes, object, "changes");
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary
