#include "PendingTags.h"

namespace Korvane::Veldra::TagService {

const StoredTag* PendingTags::Find(const std::string& path) const {
    if (const auto found = changed_.find(path); found != changed_.end()) return &found->second;
    if (erased_.count(path) != 0) return nullptr;
    return store_.Find(path);
}

StoredTag* PendingTags::Change(const std::string& path) {
    if (const auto found = changed_.find(path); found != changed_.end()) return &found->second;
    const StoredTag* stored = Find(path);
    if (stored == nullptr) return nullptr;
    return &changed_.emplace(path, *stored).first->second;
}

void PendingTags::Put(StoredTag tag) {
    erased_.erase(tag.Path());
    const std::string path = tag.Path();
    changed_.insert_or_assign(path, std::move(tag));
}

void PendingTags::Erase(const std::string& path) {
    changed_.erase(path);
    erased_.insert(path);
}

StoreBatch PendingTags::Batch() const {
    StoreBatch batch;
    batch.erase.assign(erased_.begin(), erased_.end());
    for (const auto& [path, tag] : changed_) batch.put.push_back(tag);
    return batch;
}

}  // namespace Korvane::Veldra::TagService
