#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "messagelibrary/TagChangeFlags.h"
#include "messagelibrary/TagDataType.h"
#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/json/JsonWriters.h"
#include "messagelibrary/json/Timestamp.h"

// The records that the tag messages share. Every field is optional on the
// wire: an unset optional is written null, and a missing key reads back as
// unset or as the field's default.

namespace Korvane::Veldra::VeldraMessageLibrary {

// A tag and its metadata.
struct TagRecord {
    std::optional<std::string> path;
    std::optional<TagDataType> type;
    std::optional<JsonStringMap> properties;
    std::optional<JsonStringList> keywords;
    bool collectAggregates = false;

    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("path", self.path)
            .Field("type", self.type)
            .Field("properties", self.properties)
            .Field("keywords", self.keywords)
            .Field("collectAggregates", self.collectAggregates);
    }
};

// A value in its text form, whatever its type, so that 64-bit and date values
// survive the trip.
struct TagValue {
    std::optional<TagDataType> type;
    std::optional<std::string> value;

    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("type", self.type).Field("value", self.value);
    }
};

// Aggregates of a tag's values; min and max are text forms of the tag's type.
struct TagAggregates {
    int32_t count = 0;
    double avg = 0.0;
    std::optional<std::string> min;
    std::optional<std::string> max;

    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("count", self.count)
            .Field("avg", self.avg)
            .Field("min", self.min)
            .Field("max", self.max);
    }
};

// A value at its time.
struct TagValueSample {
    Timestamp timestamp;
    std::optional<TagValue> value;

    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("timestamp", self.timestamp).Field("value", self.value);
    }
};

// A value at its time with the aggregates after it.
struct TagValueUpdate {
    Timestamp timestamp;
    std::optional<TagValue> value;
    std::optional<TagAggregates> aggregates;

    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("timestamp", self.timestamp)
            .Field("value", self.value)
            .Field("aggregates", self.aggregates);
    }
};

// The samples of one tag, by path.
struct TagPathUpdates {
    std::optional<std::string> path;
    std::optional<std::vector<TagValueSample>> updates;

    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("path", self.path).Field("updates", self.updates);
    }
};

// The updates with aggregates of one tag, by path.
struct TagAggregatedUpdates {
    std::optional<std::string> path;
    std::optional<std::vector<TagValueUpdate>> updates;

    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("path", self.path).Field("updates", self.updates);
    }
};

// The updates of one tag, with the whole tag record.
struct TagUpdateSet {
    std::optional<TagRecord> tag;
    std::optional<std::vector<TagValueUpdate>> updates;

    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("tag", self.tag).Field("updates", self.updates);
    }
};

// The current value and aggregates of one tag.
struct TagCurrentValue {
    std::optional<std::string> path;
    std::optional<TagValueSample> current;
    std::optional<TagAggregates> aggregates;

    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("path", self.path)
            .Field("current", self.current)
            .Field("aggregates", self.aggregates);
    }
};

// A tag and the parts of its metadata that are to change.
struct TagChange {
    std::optional<TagRecord> tag;
    std::optional<TagChangeFlags> changes;
};

void WriteJsonFields(JsonObjectWriter& out, const TagChange& record);

bool ReadJsonFields(TagChange& out, const JsonVariant& object);

}  // namespace Korvane::Veldra::VeldraMessageLibrary
