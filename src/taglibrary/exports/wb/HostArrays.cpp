#include "taglibrary/exports/wb/HostArrays.h"

namespace Korvane::Veldra::TagLibrary {

std::vector<std::string> ReadHostStrings(WBStrArrayHandle strings) {
    const std::size_t count = HostArrayCount(strings);
    std::vector<std::string> result;
    result.reserve(count);
    for (std::size_t i = 0; i < count; ++i) result.push_back(ReadHostString((*strings)->elt[i]));
    return result;
}

std::unordered_map<std::string, std::string> ReadHostProperties(WBPropertyArrayHandle properties) {
    const std::size_t count = HostArrayCount(properties);
    std::unordered_map<std::string, std::string> result;
    for (std::size_t i = 0; i < count; ++i) {
        const WBProperty& element = (*properties)->elt[i];
        if (element.key == nullptr || element.value == nullptr) continue;
        result[ReadHostString(element.key)] = ReadHostString(element.value);
    }
    return result;
}

std::vector<uint32_t> ReadHostReferences(WBReferenceArrayHandle references) {
    const std::size_t count = HostArrayCount(references);
    if (count == 0) return {};
    const uint32_t* first = (*references)->elt;
    return std::vector<uint32_t>(first, first + count);
}

int32_t WriteHostStrings(WBStrArrayHandle* handle, const std::vector<std::string>& texts) {
    if (const int32_t status = SizeHostArray(handle, texts.size())) return status;
    for (std::size_t i = 0; i < texts.size(); ++i) {
        if (const int32_t status = CopyToHostString(&(**handle)->elt[i], texts[i])) return status;
    }
    return 0;
}

int32_t WriteHostProperties(WBPropertyArrayHandle* handle,
                            const std::vector<std::pair<std::string, std::string>>& properties) {
    if (const int32_t status = SizeHostArray(handle, properties.size())) return status;
    for (std::size_t i = 0; i < properties.size(); ++i) {
        WBProperty& element = (**handle)->elt[i];
        if (const int32_t status = CopyToHostString(&element.key, properties[i].first))
            return status;
        if (const int32_t status = CopyToHostString(&element.value, properties[i].second))
            return status;
    }
    return 0;
}

}  // namespace Korvane::Veldra::TagLibrary
