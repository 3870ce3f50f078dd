// Host functions that write values: one tag's samples, or samples of many
// paths by instance. Values and timestamps are checked and converted before
// anything goes out.
#include "kvveldra/TagWB.h"
#include "taglibrary/exports/wb/HostArrays.h"
#include "taglibrary/exports/wb/HostCall.h"
#include "taglibrary/exports/wb/HostValues.h"

using namespace Korvane::Veldra::TagLibrary;
using Korvane::Veldra::VeldraMessageLibrary::TagValue;
using Korvane::Veldra::VeldraMessageLibrary::TagValueSample;

namespace {

// A write of `count` samples to one tag: `valueAt(index, type, value, text)`
// gives each value text; the timestamps come from the timestamp array.
template <typename ValueAt>
int32_t WriteOnHostTag(uint32_t tagReference, int32_t dataType, std::size_t count,
                       WBTimestampArrayHandle timestamps, uint32_t* requestId,
                       uint32_t* timeoutMs, uint32_t* signal, WBStrHandle* error,
                       ValueAt&& valueAt) {
    return RequestOnHostTag(
        tagReference, requestId, timeoutMs, signal, error,
        [&](Client& client, const std::shared_ptr<TagData>& tag,
            const HostRequestMaker& makeRequest, uint32_t& id, uint32_t& timeout,
            std::string& text) {
            // The client's types are compared: unset, None and a number out
            // of range are three different things there.
            const auto type = ExportedToType(dataType);
            if (type != client.DataTypeOf(*tag)) return HostError("Tag.InvalidTagDataType", text);
            std::vector<TagValueSample> samples;
            samples.reserve(count);
            for (std::size_t i = 0; i < count; ++i) {
                std::string value;
                if (const int32_t status = valueAt(i, type, value, text)) return status;
                samples.push_back(
                    TagValueSample{HostTimestampAt(timestamps, i), TagValue{type, std::move(value)}});
            }
            return client.WriteValues(tag, std::move(samples), makeRequest(), id, timeout, text);
        });
}

// A write by instance from a value array: `valueOf(element, type, value,
// text)` gives each element's value text.
template <typename Array, typename ValueOf>
int32_t WriteOnHostInstance(uint64_t instanceId, Array** values, uint32_t* requestId,
                            uint32_t* timeoutMs, uint32_t* signal, WBStrHandle* error,
                            ValueOf&& valueOf) {
    return RequestOnHostInstance(
        instanceId, requestId, timeoutMs, signal, error,
        [&](Client& client, const HostRequestMaker& makeRequest, uint32_t& id, uint32_t& timeout,
            std::string& text) {
            const std::size_t count = HostArrayCount(values);
            std::vector<std::string> paths;
            std::vector<TagValueSample> samples;
            paths.reserve(count);
            samples.reserve(count);
            for (std::size_t i = 0; i < count; ++i) {
                const auto& element = (*values)->elt[i];
                const auto type = ExportedToType(element.dataType);
                std::string value;
                if (const int32_t status = valueOf(element, type, value, text)) return status;
                paths.push_back(ReadHostString(element.path));
                samples.push_back(TagValueSample{HostTimestampOrNone(element.timestamp),
                                                 TagValue{type, std::move(value)}});
            }
            return client.WriteMulti(paths, std::move(samples), makeRequest(), id, timeout, text);
        });
}

}  // namespace

int32_t TagWBWrite(uint32_t tagReference, int32_t dataType, WBVariantArrayHandle values,
                   WBTimestampArrayHandle timestamps, uint32_t* requestId, uint32_t* timeoutMs,
                   uint32_t* signal, WBStrHandle* error) {
    return WriteOnHostTag(tagReference, dataType, HostArrayCount(values), timestamps, requestId,
                          timeoutMs, signal, error,
                          [&](std::size_t i, auto type, std::string& value, std::string& text) {
                              return VariantToValueText((*values)->elt[i], type, value, text);
                          });
}

int32_t TagWBWrite2(uint32_t tagReference, int32_t dataType, WBStrArrayHandle values,
                    WBTimestampArrayHandle timestamps, uint32_t* requestId, uint32_t* timeoutMs,
                    uint32_t* signal, WBStrHandle* error) {
    return WriteOnHostTag(tagReference, dataType, HostArrayCount(values), timestamps, requestId,
                          timeoutMs, signal, error,
                          [&](std::size_t i, auto, std::string& value, std::string&) {
                              value = ReadHostString((*values)->elt[i]);
                              return 0;
                          });
}

int32_t TagWBWriteMulti(uint64_t instanceId, WBValueArrayHandle values, uint32_t* requestId,
                        uint32_t* timeoutMs, uint32_t* signal, WBStrHandle* error) {
    return WriteOnHostInstance(instanceId, values, requestId, timeoutMs, signal, error,
                               [](const WBValue& element, auto type, std::string& value,
                                  std::string& text) {
                                   return VariantToValueText(element.value, type, value, text);
                               });
}

int32_t TagWBWriteMulti2(uint64_t instanceId, WBValueArray2Handle values, uint32_t* requestId,
                         uint32_t* timeoutMs, uint32_t* signal, WBStrHandle* error) {
    return WriteOnHostInstance(instanceId, values, requestId, timeoutMs, signal, error,
                               [](const WBValue2& element, auto, std::string& value, std::string&) {
                                   value = ReadHostString(element.value);
                                   return 0;
                               });
}
