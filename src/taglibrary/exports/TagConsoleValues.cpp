// Console functions that write and read values. Value texts pass through as
// they stand, in both directions.
#include "kvveldra/TagConsole.h"
#include "taglibrary/exports/ConsoleCall.h"
#include "taglibrary/exports/ConsoleTime.h"

using namespace Korvane::Veldra::TagLibrary;
using Korvane::Veldra::VeldraMessageLibrary::TagCurrentValue;
using Korvane::Veldra::VeldraMessageLibrary::TagValue;
using Korvane::Veldra::VeldraMessageLibrary::TagValueSample;

namespace {

TagConsoleValue ToConsoleValue(const TagCurrentValue& record) {
    TagConsoleValue result;
    result.path = record.path.value_or("");
    if (record.current) {
        result.timestamp = TimestampToConsoleTime(record.current->timestamp);
        if (record.current->value) {
            result.dataType = TypeToExported(record.current->value->type);
            result.value = record.current->value->value.value_or("");
        }
    } else {
        result.timestamp = TagConsoleTime::min();
    }
    if (record.aggregates) {
        result.aggregateCount = record.aggregates->count;
        result.aggregateAverage = record.aggregates->avg;
        result.aggregateMinimum = record.aggregates->min.value_or("");
        result.aggregateMaximum = record.aggregates->max.value_or("");
    }
    return result;
}

}  // namespace

int32_t TagConsoleWriteTag(uint32_t tagReference, int32_t dataType,
                           const TagConsoleSamples* values, bool verbose, std::string* error) {
    return RunOnConsoleTag(
        tagReference, verbose, error,
        [&](Client& client, const std::shared_ptr<TagData>& tag, std::string& text) {
            if (values == nullptr) return 1;
            const auto type = ExportedToType(dataType);
            std::vector<TagValueSample> samples;
            samples.reserve(values->size());
            for (const auto& value : *values) {
                samples.push_back(TagValueSample{ConsoleTimeToTimestamp(value.timestamp),
                                                 TagValue{type, value.value}});
            }
            return RunBlockingToFinish(
                client,
                [&](const std::shared_ptr<ConsoleAsyncRequest>& request, uint32_t& requestId,
                    uint32_t& timeoutMs, std::string& out) {
                    return client.WriteValues(tag, std::move(samples), request, requestId,
                                              timeoutMs, out);
                },
                text);
        });
}

int32_t TagConsoleReadValues(uint64_t instanceId, const std::vector<uint32_t>* tagReferences,
                             bool verbose, int32_t /*unused*/,
                             std::vector<TagConsoleValue>* results, std::string* error) {
    if (results == nullptr) return 1;
    return RunOnConsoleReferences(
        instanceId, tagReferences, verbose, error,
        [&](Client& client, const std::vector<std::shared_ptr<TagData>>& tags,
            std::string& text) {
            std::vector<TagCurrentValue> values;
            const int32_t status = RunBlocking(
                [&](const std::shared_ptr<ConsoleAsyncRequest>& request, uint32_t& requestId,
                    uint32_t& timeoutMs, std::string& out) {
                    // The console read asks for the current value, not a cached one.
                    return client.ReadValues(tags, false, request, requestId, timeoutMs, out);
                },
                [&](uint32_t requestId, std::string& out) {
                    return client.FinishReadValues(requestId, values, out);
                },
                text);
            if (status != 0) return status;
            results->clear();
            results->reserve(values.size());
            for (const auto& value : values) results->push_back(ToConsoleValue(value));
            return 0;
        });
}
