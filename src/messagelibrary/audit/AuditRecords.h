#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/json/JsonWriters.h"
#include "messagelibrary/json/Timestamp.h"

// The records of the audit trail messages.

namespace Korvane::Veldra::VeldraMessageLibrary::AuditTrailMessages {

// A type of audit entry: its short name and what it stands for.
struct AuditTypeEntry {
    std::optional<std::string> shortName;
    std::optional<std::string> description;

    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("shortName", self.shortName).Field("description", self.description);
    }
};

// One entry of the audit trail, with four general integers and four general
// strings for what its type needs.
struct AuditEntry {
    Timestamp timestamp;
    std::optional<std::string> subtype;
    std::optional<std::string> originator;
    std::optional<std::string> userName;
    std::optional<std::string> recordType;
    std::optional<std::string> device;
    std::optional<std::string> detail;
    int32_t int1 = 0;
    int32_t int2 = 0;
    int32_t int3 = 0;
    int32_t int4 = 0;
    std::optional<std::string> str1;
    std::optional<std::string> str2;
    std::optional<std::string> str3;
    std::optional<std::string> str4;

    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("timestamp", self.timestamp)
            .Field("subtype", self.subtype)
            .Field("originator", self.originator)
            .Field("userName", self.userName)
            .Field("recordType", self.recordType)
            .Field("device", self.device)
            .Field("detail", self.detail)
            .Field("int1", self.int1)
            .Field("int2", self.int2)
            .Field("int3", self.int3)
            .Field("int4", self.int4)
            .Field("str1", self.str1)
            .Field("str2", self.str2)
            .Field("str3", self.str3)
            .Field("str4", self.str4);
    }
};

// What an audit query matches, and how the result is paged and ordered.
// "orderByDescending" is a text, as the peers send it.
struct AuditQueryParameters {
    Timestamp timestampFrom;
    Timestamp timestampTo;
    std::optional<std::string> originator;
    std::optional<std::string> recordType;
    std::optional<std::string> subtype;
    std::optional<std::string> device;
    std::optional<std::string> detail;
    int32_t int1 = 0;
    int32_t int2 = 0;
    int32_t int3 = 0;
    int32_t int4 = 0;
    std::optional<std::string> str1;
    std::optional<std::string> str2;
    std::optional<std::string> str3;
    std::optional<std::string> str4;
    bool queryUsingTimestamps = false;
    std::optional<std::vector<int32_t>> queryUsingInts;
    int32_t skipCount = 0;
    int32_t maxRecords = 0;
    std::optional<std::string> orderBy;
    std::optional<std::string> orderByDescending;

    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("timestampFrom", self.timestampFrom)
            .Field("timestampTo", self.timestampTo)
            .Field("originator", self.originator)
            .Field("recordType", self.recordType)
            .Field("subtype", self.subtype)
            .Field("device", self.device)
            .Field("detail", self.detail)
            .Field("int1", self.int1)
            .Field("int2", self.int2)
            .Field("int3", self.int3)
            .Field("int4", self.int4)
            .Field("str1", self.str1)
            .Field("str2", self.str2)
            .Field("str3", self.str3)
            .Field("str4", self.str4)
            .Field("queryUsingTimestamps", self.queryUsingTimestamps)
            .Field("queryUsingInts", self.queryUsingInts)
            .Field("skipCount", self.skipCount)
            .Field("maxRecords", self.maxRecords)
            .Field("orderBy", self.orderBy)
            .Field("orderByDescending", self.orderByDescending);
    }
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::AuditTrailMessages
