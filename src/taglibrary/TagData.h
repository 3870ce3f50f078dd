#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "taglibrary/TagTypes.h"

namespace Korvane::Veldra::TagLibrary {

// The local record of an open tag. The Client's tag map and the exported
// reference table share it. instanceId and path never change; dataType and
// sessionCount are read and changed only under the owning Client's mutex.
class TagData {
public:
    TagData(uint64_t instanceId, std::string path, std::optional<TagDataType> dataType);
    ~TagData();
    TagData(const TagData&) = delete;
    TagData& operator=(const TagData&) = delete;

    const uint64_t instanceId;
    const std::string path;
    std::optional<TagDataType> dataType;
    int32_t sessionCount = 1;

    // The number that callers hold for this record; unique among live records, never 0.
    uint32_t Reference() const { return reference_; }

private:
    const uint32_t reference_;
};

}  // namespace Korvane::Veldra::TagLibrary
