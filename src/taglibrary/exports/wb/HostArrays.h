#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <unordered_map>
#include <utility>
#include <vector>

#include "kvveldra/WBTypes.h"
#include "taglibrary/exports/wb/HostStrings.h"

// The host's arrays: reading the ones that come in, sizing and filling the
// ones that go out.
namespace Korvane::Veldra::TagLibrary {

// The elements of an array handle, none for a null handle, a null block or a
// count below 1.
template <typename Array>
std::size_t HostArrayCount(Array** handle) {
    if (handle == nullptr || *handle == nullptr || (*handle)->dimSize <= 0) return 0;
    return static_cast<std::size_t>((*handle)->dimSize);
}

std::vector<std::string> ReadHostStrings(WBStrArrayHandle strings);
// Elements whose key or value handle is null are skipped.
std::unordered_map<std::string, std::string> ReadHostProperties(WBPropertyArrayHandle properties);
std::vector<uint32_t> ReadHostReferences(WBReferenceArrayHandle references);

// Sizes *handle for `count` elements of `elementSize` bytes behind the
// array's header and writes the count. Returns 0, 2 when the host is out of
// memory, or the host's resize status.
template <typename Array>
int32_t SizeHostArray(Array*** handle, std::size_t count,
                      std::size_t elementSize = sizeof(std::declval<Array&>().elt[0])) {
    if (const int32_t status = SizeHostHandle(reinterpret_cast<WBHandle*>(handle),
                                              offsetof(Array, elt), elementSize, count))
        return status;
    (**handle)->dimSize = static_cast<int32_t>(count);
    return 0;
}

// Sizes the array and copies each text into the string handle at its element.
int32_t WriteHostStrings(WBStrArrayHandle* handle, const std::vector<std::string>& texts);
// The same for key and value pairs, in the order given.
int32_t WriteHostProperties(WBPropertyArrayHandle* handle,
                            const std::vector<std::pair<std::string, std::string>>& properties);

}  // namespace Korvane::Veldra::TagLibrary
