#include "MemoryTagStore.h"

namespace Korvane::Veldra::TagService {

const StoredTag* MemoryTagStore::Find(const std::string& path) const {
    const auto found = tags_.find(path);
    return found == tags_.end() ? nullptr : &found->second;
}

void MemoryTagStore::ForEach(const std::function<void(const StoredTag&)>& visit) const {
    for (const auto& [path, tag] : tags_) visit(tag);
}

void MemoryTagStore::Apply(const StoreBatch& batch) {
    for (const std::string& path : batch.erase) tags_.erase(path);
    for (const StoredTag& tag : batch.put) tags_.insert_or_assign(tag.Path(), tag);
}

}  // namespace Korvane::Veldra::TagService
