#pragma once

#include <map>
#include <set>
#include <string>

#include "TagStore.h"

namespace Korvane::Veldra::TagService {

// The tags one message changes, copied out of the store on first touch, so
// that a message sees its own earlier changes and the store sees them only
// as one batch.
class PendingTags {
public:
    explicit PendingTags(const TagStore& store) : store_(store) {}

    // The tag as the message has left it so far, or null.
    const StoredTag* Find(const std::string& path) const;
    // A copy of the tag to change, or null when there is none.
    StoredTag* Change(const std::string& path);
    // Adds or replaces a tag.
    void Put(StoredTag tag);
    void Erase(const std::string& path);
    // Everything changed, as one batch.
    StoreBatch Batch() const;

private:
    const TagStore& store_;
    std::map<std::string, StoredTag> changed_;
    std::set<std::string> erased_;
};

}  // namespace Korvane::Veldra::TagService
