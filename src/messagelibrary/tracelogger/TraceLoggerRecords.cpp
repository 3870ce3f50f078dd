#include "messagelibrary/tracelogger/TraceLoggerRecords.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages {

void WriteJsonFields(JsonObjectWriter& out, const TracePointSetting& record) {
    out.Field("name", record.name)
        .Field("enabled", record.enabled)
        .Field("exceptions", record.exceptions)
        .Field("times", record.times);
}

bool ReadJsonFields(TracePointSetting& out, const JsonVariant& object) {
    return ReadField(out.name, object, "name") && ReadField(out.enabled, object, "enabled") &&
           ReadField(out.exceptions, object, "exceptions") && ReadField(out.times, object, "times");
}

void WriteJsonFields(JsonObjectWriter& out, const TraceEntry& record) {
    out.Field("moduleName", record.moduleName)
        .Field("timestamp", record.timestamp)
        .Field("tracePointName", record.tracePointName)
        .Field("text", record.text)
        .Field("type", record.type);
}

bool ReadJsonFields(TraceEntry& out, const JsonVariant& object) {
    return ReadField(out.moduleName, object, "moduleName") &&
           ReadField(out.timestamp, object, "timestamp") &&
           ReadField(out.tracePointName, object, "tracePointName") &&
           ReadField(out.text, object, "text") && ReadField(out.type, object, "type");
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages
