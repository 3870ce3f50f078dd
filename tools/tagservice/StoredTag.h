#pragma once

#include <optional>
#include <string>
#include <vector>

#include "messagelibrary/TagRecords.h"

namespace Korvane::Veldra::TagService {

using VeldraMessageLibrary::TagAggregates;
using VeldraMessageLibrary::TagRecord;
using VeldraMessageLibrary::TagValueSample;

// Everything the service keeps of one tag. record.path and record.type are
// always set; keywords and properties are set, possibly empty.
struct StoredTag {
    TagRecord record;
    // The last value written; absent until the first write.
    std::optional<TagValueSample> current;
    // Kept while the tag collects aggregates; reset to zero by a reset.
    TagAggregates aggregates;

    const std::string& Path() const { return *record.path; }
};

// The changes of one message, applied all together or not at all.
struct StoreBatch {
    std::vector<StoredTag> put;       // inserted or replaced, by path
    std::vector<std::string> erase;   // removed, by path

    bool Empty() const { return put.empty() && erase.empty(); }
};

}  // namespace Korvane::Veldra::TagService
