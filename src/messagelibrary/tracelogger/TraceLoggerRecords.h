#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "messagelibrary/json/JsonEnum.h"
#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/json/JsonWriters.h"
#include "messagelibrary/json/Timestamp.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages {

enum class TraceEntryType : int32_t {
    Log = 0,
    Error = 1,
    Info = 2,
};

inline constexpr JsonEnumText kTraceEntryTypeTexts[] = {{0, "LOG"}, {1, "ERROR"}, {2, "INFO"}};
inline JsonEnumTexts JsonEnumTextsOf(TraceEntryType) {
    return kTraceEntryTypeTexts;
}

// The state of one trace point as the service holds it.
struct TracePointSetting {
    std::optional<std::string> name;
    bool enabled = false;
    std::optional<JsonStringList> exceptions;
    std::optional<std::string> times;

    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("name", self.name)
            .Field("enabled", self.enabled)
            .Field("exceptions", self.exceptions)
            .Field("times", self.times);
    }
};

// One line of trace from a module.
struct TraceEntry {
    std::optional<std::string> moduleName;
    Timestamp timestamp;
    std::optional<std::string> tracePointName;
    std::optional<std::string> text;
    std::optional<TraceEntryType> type;

    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("moduleName", self.moduleName)
            .Field("timestamp", self.timestamp)
            .Field("tracePointName", self.tracePointName)
            .Field("text", self.text)
            .Field("type", self.type);
    }
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages
