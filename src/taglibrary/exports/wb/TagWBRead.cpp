// Host functions that read current values: one tag as a variant or as text,
// or several tags into a value array.
#include "kvveldra/TagWB.h"
#include "taglibrary/exports/wb/HostArrays.h"
#include "taglibrary/exports/wb/HostCall.h"
#include "taglibrary/exports/wb/HostValues.h"

using namespace Korvane::Veldra::TagLibrary;
using Korvane::Veldra::VeldraMessageLibrary::TagCurrentValue;
using Korvane::Veldra::VeldraMessageLibrary::TagValue;

namespace {

// The one record of a single read, or null with the status: 0 when none
// came (the outputs stay as they were), an error for several or for a record
// of another type than the caller's.
int32_t FinishSingleRead(Client& client, const std::shared_ptr<TagData>& tag, int32_t dataType,
                         uint32_t requestId, std::vector<TagCurrentValue>& values,
                         const TagCurrentValue*& record, std::string& text) {
    record = nullptr;
    if (const int32_t status = client.FinishReadValues(requestId, values, text)) return status;
    if (values.empty()) return 0;
    if (values.size() > 1) return HostError("Veldra.InternalServiceError", text);
    const auto expected = ExportedToType(dataType);
    const auto* value = RecordValue(values.front());
    if (value != nullptr && value->type != expected) {
        return HostError("Tag.ConflictingTagTypes", text,
                         {tag->path, TypeShortName(expected), TypeShortName(value->type)});
    }
    record = &values.front();
    return 0;
}

// A single read's finish: `deliver(record, value)` stores the value of a
// record that has one; then the timestamp and the aggregates go out.
template <typename Aggregates, typename Deliver>
int32_t FinishReadInto(uint32_t tagReference, int32_t dataType, uint32_t requestId,
                       WBTimestamp* timestamp, Aggregates* aggregates, WBStrHandle* error,
                       Deliver&& deliver) {
    return FinishOnHostTag(
        tagReference, "Tag.InvalidTagReference", error,
        [&](Client& client, const std::shared_ptr<TagData>& tag, std::string& text) {
            std::vector<TagCurrentValue> values;
            const TagCurrentValue* record = nullptr;
            if (const int32_t status =
                    FinishSingleRead(client, tag, dataType, requestId, values, record, text))
                return status;
            const auto* value = record == nullptr ? nullptr : RecordValue(*record);
            if (value == nullptr) return 0;
            if (const int32_t status = deliver(*value, text)) return status;
            *timestamp = TimestampToHostTime(record->current->timestamp);
            if (!record->aggregates) return 0;
            return FillHostAggregates(*record->aggregates, *aggregates);
        });
}

}  // namespace

int32_t TagWBRead(uint32_t tagReference, uint32_t* requestId, uint32_t* timeoutMs,
                  uint32_t* signal, WBStrHandle* error) {
    return RequestOnHostTag(
        tagReference, requestId, timeoutMs, signal, error,
        [&](Client& client, const std::shared_ptr<TagData>& tag,
            const HostRequestMaker& makeRequest, uint32_t& id, uint32_t& timeout,
            std::string& text) {
            return client.ReadValues({tag}, true, makeRequest(), id, timeout, text);
        });
}

int32_t TagWBFinishRead(uint32_t tagReference, int32_t dataType, uint32_t requestId,
                        WbVariant** value, WBTimestamp* timestamp, WBAggregates* aggregates,
                        WBStrHandle* error) {
    if (AnyNull(value, timestamp, aggregates, error)) return 1;
    return FinishReadInto(tagReference, dataType, requestId, timestamp, aggregates, error,
                          [&](const TagValue& record, std::string& text) {
                              return ValueTextToVariant(value, record.type,
                                                        record.value.value_or(""),
                                                        IntVariant::Signed, text);
                          });
}

int32_t TagWBFinishRead2(uint32_t tagReference, int32_t dataType, uint32_t requestId,
                         WBStrHandle* value, WBTimestamp* timestamp, WBAggregates2* aggregates,
                         WBStrHandle* error) {
    if (AnyNull(value, timestamp, aggregates, error)) return 1;
    return FinishReadInto(tagReference, dataType, requestId, timestamp, aggregates, error,
                          [&](const TagValue& record, std::string&) {
                              return CopyToHostString(value, record.value.value_or(""));
                          });
}

int32_t TagWBReadMulti(uint64_t instanceId, WBReferenceArrayHandle tagReferences,
                       bool* anyInvalid, uint32_t* requestId, uint32_t* timeoutMs,
                       uint32_t* signal, WBStrHandle* error) {
    if (anyInvalid == nullptr) return 1;
    return RequestOnHostReferences(
        instanceId, tagReferences, anyInvalid, requestId, timeoutMs, signal, error,
        [&](Client& client, const HostTags& tags, const HostRequest& request, uint32_t& id,
            uint32_t& timeout, std::string& text) {
            return client.ReadValues(tags, true, request, id, timeout, text);
        });
}

namespace {

// A multi read's finish: each record's path, type and value (through
// `deliver(element, value)`) and timestamp into the value array. The
// caller's flag of invalid references is reported after the array is filled.
template <typename Array, typename Deliver>
int32_t FinishReadMultiInto(uint64_t instanceId, uint32_t requestId, const bool* anyInvalid,
                            Array*** values, WBStrHandle* error, Deliver&& deliver) {
    if (AnyNull(anyInvalid, values, error)) return 1;
    return FinishOnHostInstance(instanceId, error, [&](Client& client, std::string& text) {
        std::vector<TagCurrentValue> records;
        if (const int32_t status = client.FinishReadValues(requestId, records, text)) return status;
        if (const int32_t status = SizeHostArray(values, records.size())) return status;
        for (std::size_t i = 0; i < records.size(); ++i) {
            auto& element = (**values)->elt[i];
            const TagCurrentValue& record = records[i];
            if (record.path) {
                if (const int32_t status = CopyToHostString(&element.path, *record.path))
                    return status;
            }
            if (const auto* value = RecordValue(record)) {
                element.dataType = TypeToExported(value->type);
                if (const int32_t status = deliver(element, *value, text)) return status;
            }
            if (record.current) element.timestamp = TimestampToHostTime(record.current->timestamp);
        }
        return HostBool(anyInvalid) ? HostError("Tag.InvalidTagReference", text) : 0;
    });
}

}  // namespace

int32_t TagWBFinishReadMulti(uint64_t instanceId, uint32_t requestId, const bool* anyInvalid,
                             WBValueArrayHandle* values, WBStrHandle* error) {
    return FinishReadMultiInto(instanceId, requestId, anyInvalid, values, error,
                               [](WBValue& element, const TagValue& value, std::string& text) {
                                   return ValueTextToVariant(&element.value, value.type,
                                                             value.value.value_or(""),
                                                             IntVariant::Unsigned, text);
                               });
}

int32_t TagWBFinishReadMulti2(uint64_t instanceId, uint32_t requestId, const bool* anyInvalid,
                              WBValueArray2Handle* values, WBStrHandle* error) {
    return FinishReadMultiInto(instanceId, requestId, anyInvalid, values, error,
                               [](WBValue2& element, const TagValue& value, std::string&) {
                                   return CopyToHostString(&element.value,
                                                           value.value.value_or(""));
                               });
}
