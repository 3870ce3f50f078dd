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
};

// A value in its text form, whatever its type, so that 64-bit and date values
// survive the trip.
struct TagValue {
    std::optional<TagDataType> type;
    std::optional<std::string> value;
};

// Aggregates of a tag's values; min and max are text forms of the tag's type.
struct TagAggregates {
    int32_t count = 0;
    double avg = 0.0;
    std::optional<std::string> min;
    std::optional<std::string> max;
};

// A value at its time.
struct TagValueSample {
    Timestamp timestamp;
    std::optional<TagValue> value;
};

// A value at its time with the aggregates after it.
struct TagValueUpdate {
    Timestamp timestamp;
    std::optional<TagValue> value;
    std::optional<TagAggregates> aggregates;
};

// The samples of one tag, by path.
struct TagPathUpdates {
    std::optional<std::string> path;
    std::optional<std::vector<TagValueSample>> updates;
};

// The updates with aggregates of one tag, by path.
struct TagAggregatedUpdates {
    std::optional<std::string> path;
    std::optional<std::vector<TagValueUpdate>> updates;
};

// The updates of one tag, with the whole tag record.
struct TagUpdateSet {
    std::optional<TagRecord> tag;
    std::optional<std::vector<TagValueUpdate>> updates;
};

// The current value and aggregates of one tag.
struct TagCurrentValue {
    std::optional<std::string> path;
    std::optional<TagValueSample> current;
    std::optional<TagAggregates> aggregates;
};

// A tag and the parts of its metadata that are to change.
struct TagChange {
    std::optional<TagRecord> tag;
    std::optional<TagChangeFlags> changes;
};

void WriteJsonFields(JsonObjectWriter& out, const TagRecord& record);
void WriteJsonFields(JsonObjectWriter& out, const TagValue& record);
void WriteJsonFields(JsonObjectWriter& out, const TagAggregates& record);
void WriteJsonFields(JsonObjectWriter& out, const TagValueSample& record);
void WriteJsonFields(JsonObjectWriter& out, const TagValueUpdate& record);
void WriteJsonFields(JsonObjectWriter& out, const TagPathUpdates& record);
void WriteJsonFields(JsonObjectWriter& out, const TagAggregatedUpdates& record);
void WriteJsonFields(JsonObjectWriter& out, const TagUpdateSet& record);
void WriteJsonFields(JsonObjectWriter& out, const TagCurrentValue& record);
void WriteJsonFields(JsonObjectWriter& out, const TagChange& record);

bool ReadJsonFields(TagRecord& out, const JsonVariant& object);
bool ReadJsonFields(TagValue& out, const JsonVariant& object);
bool ReadJsonFields(TagAggregates& out, const JsonVariant& object);
bool ReadJsonFields(TagValueSample& out, const JsonVariant& object);
bool ReadJsonFields(TagValueUpdate& out, const JsonVariant& object);
bool ReadJsonFields(TagPathUpdates& out, const JsonVariant& object);
bool ReadJsonFields(TagAggregatedUpdates& out, const JsonVariant& object);
bool ReadJsonFields(TagUpdateSet& out, const JsonVariant& object);
bool ReadJsonFields(TagCurrentValue& out, const JsonVariant& object);
bool ReadJsonFields(TagChange& out, const JsonVariant& object);

}  // namespace Korvane::Veldra::VeldraMessageLibrary
