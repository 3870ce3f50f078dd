#pragma once

#include <cstdint>
#include <map>
#include <optional>
#include <string>
#include <vector>

#include "messagelibrary/ErrorRecord.h"
#include "messagelibrary/TagDataType.h"
#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/json/JsonWriters.h"
#include "messagelibrary/json/Timestamp.h"
#include "messagelibrary/taghistorian/HistorianSortOrder.h"

// The records of the historian messages. An unset timestamp is
// not-a-date-time and is written "0001-01-01T00:00:00".

namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages {

// Stored values of some tags between two times, paged and thinned out.
struct HistorianQuery {
    std::optional<JsonStringList> paths;
    Timestamp startTime;
    Timestamp endTime;
    int32_t skip = 0;
    int32_t take = 0;
    int32_t decimation = 0;
    std::optional<HistorianSortOrder> sortOrder;

    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("paths", self.paths)
            .Field("startTime", self.startTime)
            .Field("endTime", self.endTime)
            .Field("skip", self.skip)
            .Field("take", self.take)
            .Field("decimation", self.decimation)
            .Field("sortOrder", self.sortOrder);
    }
};

// A query the historian runs in the background, by the id of its request.
struct HistorianQueryJob {
    std::optional<HistorianQuery> query;
    std::optional<std::string> requestId;
    bool hasError = false;

    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("query", self.query)
            .Field("requestId", self.requestId)
            .Field("hasError", self.hasError);
    }
};

// One stored value; value is the text form of a value of type.
struct HistorianValue {
    std::optional<std::string> id;
    std::optional<std::string> path;
    std::optional<TagDataType> type;
    std::optional<std::string> value;
    Timestamp timestamp;
    std::optional<JsonStringMap> properties;
    Timestamp expirationDate;

    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("id", self.id)
            .Field("path", self.path)
            .Field("type", self.type)
            .Field("value", self.value)
            .Field("timestamp", self.timestamp)
            .Field("properties", self.properties)
            .Field("expirationDate", self.expirationDate);
    }
};

// New properties and expiration date of the stored value named by id.
struct HistorianValueUpdate {
    std::optional<std::string> id;
    std::optional<JsonStringMap> properties;
    Timestamp expirationDate;

    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("id", self.id)
            .Field("properties", self.properties)
            .Field("expirationDate", self.expirationDate);
    }
};

// Stored values by tag path, written as an object with the paths as keys.
using HistorianValueMap = std::map<std::string, std::vector<HistorianValue>>;

// A part of the result of a background query. errors is one record despite
// its name; failed lists the paths that failed.
struct HistorianAsyncValues {
    std::optional<std::string> requestId;
    std::optional<HistorianValueMap> values;
    int32_t totalCount = 0;
    std::optional<ErrorRecord> errors;
    std::optional<JsonStringList> failed;

    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("requestId", self.requestId)
            .Field("values", self.values)
            .Field("totalCount", self.totalCount)
            .Field("errors", self.errors)
            .Field("failed", self.failed);
    }
};

// The result of a query, as HistorianAsyncValues without the request id.
struct HistorianValues {
    std::optional<HistorianValueMap> values;
    int32_t totalCount = 0;
    std::optional<ErrorRecord> errors;
    std::optional<JsonStringList> failed;

    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("values", self.values)
            .Field("totalCount", self.totalCount)
            .Field("errors", self.errors)
            .Field("failed", self.failed);
    }
};

// The stored values of one tag between two times.
struct HistorianDeleteRange {
    std::optional<std::string> path;
    Timestamp startTime;
    Timestamp endTime;

    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("path", self.path)
            .Field("startTime", self.startTime)
            .Field("endTime", self.endTime);
    }
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages
