#include "taglibrary/exports/wb/HostValues.h"

#include <algorithm>
#include <vector>

#include "taglibrary/ValueText.h"
#include "taglibrary/exports/Frame.h"
#include "taglibrary/exports/wb/HostArrays.h"
#include "taglibrary/exports/wb/HostRuntime.h"
#include "taglibrary/exports/wb/HostStrings.h"

namespace Korvane::Veldra::TagLibrary {
namespace {

int32_t NamedError(const char* name, std::string& text) {
    return FormatNamedError(name, {}, text);
}

// Stores `value` in the variant through a string handle of the host's own
// memory manager: the host takes the handle over and may free or resize it.
int32_t SetVariantText(const HostRuntime& host, WbVariant* variant, const std::string& value) {
    WBStrHandle handle = nullptr;
    if (const int32_t status = CopyToHostString(&handle, value)) return status;
    return host.VariantSetLStr(variant, handle);
}

}  // namespace

int32_t VariantToValueText(WbVariant* variant, std::optional<TagDataType> type, std::string& value,
                           std::string& text) {
    const HostRuntime& host = HostRuntime::Get();
    if (host.VariantGetDataPtr == nullptr) return NamedError("Veldra.NotSupported", text);
    if (!type || (*type != TagDataType::Double && *type != TagDataType::Int &&
                  *type != TagDataType::Boolean && *type != TagDataType::String))
        return NamedError("Tag.InvalidTagDataType", text);
    const void* data = variant == nullptr ? nullptr : host.VariantGetDataPtr(variant);
    if (data == nullptr) {
        // An empty element: the text of a value never set, which reads as an
        // empty string, NaN, 0 or false.
        value.clear();
        return 0;
    }
    switch (*type) {
        case TagDataType::Double:
            value = FormatDouble(*static_cast<const double*>(data));
            break;
        case TagDataType::Int:
            value = std::to_string(*static_cast<const int32_t*>(data));
            break;
        case TagDataType::Boolean:
            value = *static_cast<const uint8_t*>(data) != 0 ? "True" : "False";
            break;
        default:
            value = ReadHostString(*static_cast<const WBStrHandle*>(data));
            break;
    }
    return 0;
}

Timestamp HostTimestampOrNone(const WBTimestamp& hostTime) {
    return IsZeroHostTime(hostTime) ? Timestamp() : HostTimeToTimestamp(hostTime);
}

Timestamp HostTimestampAt(WBTimestampArrayHandle timestamps, std::size_t index) {
    if (index >= HostArrayCount(timestamps)) return Timestamp();
    return HostTimestampOrNone((*timestamps)->elt[index]);
}

int32_t ValueTextToVariant(WbVariant** slot, std::optional<TagDataType> type,
                           const std::string& value, IntVariant intVariant, std::string& text) {
    const HostRuntime& host = HostRuntime::Get();
    if (host.VariantNestInVariant == nullptr || host.VariantSetDBL == nullptr ||
        host.VariantSetI32 == nullptr || host.VariantSetUI32 == nullptr ||
        host.VariantSetBool == nullptr || host.VariantSetLStr == nullptr)
        return NamedError("Veldra.NotSupported", text);
    if (const int32_t status = host.VariantNestInVariant(slot)) return status;
    WbVariant* variant = *slot;
    switch (type.value_or(TagDataType::None)) {
        case TagDataType::Int:
            if (intVariant == IntVariant::Signed) return host.VariantSetI32(variant, ParseInt(value));
            return host.VariantSetUI32(variant, static_cast<uint32_t>(ParseInt(value)));
        case TagDataType::Double:
            return host.VariantSetDBL(variant, ParseDouble(value));
        case TagDataType::Boolean:
            return host.VariantSetBool(variant, ParseBool(value) ? 1 : 0);
        case TagDataType::String:
            return SetVariantText(host, variant, value);
        default:
            return NamedError("Tag.InvalidTagDataType", text);
    }
}

int32_t FillHostAggregates(const TagAggregates& aggregates, WBAggregates& cluster) {
    cluster.count = static_cast<uint32_t>(aggregates.count);
    cluster.avg = aggregates.avg;
    cluster.max = ParseDouble(aggregates.max.value_or(""));
    cluster.min = ParseDouble(aggregates.min.value_or(""));
    return 0;
}

int32_t FillHostAggregates(const TagAggregates& aggregates, WBAggregates2& cluster) {
    cluster.count = static_cast<uint32_t>(aggregates.count);
    cluster.avg = aggregates.avg;
    if (const int32_t status = CopyToHostString(&cluster.max, aggregates.max.value_or("")))
        return status;
    return CopyToHostString(&cluster.min, aggregates.min.value_or(""));
}

const VeldraMessageLibrary::TagValue* RecordValue(
    const VeldraMessageLibrary::TagCurrentValue& record) {
    if (!record.current || !record.current->value) return nullptr;
    return &*record.current->value;
}

}  // namespace Korvane::Veldra::TagLibrary
