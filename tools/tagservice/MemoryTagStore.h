#pragma once

#include <map>
#include <string>

#include "TagStore.h"

namespace Korvane::Veldra::TagService {

// Tags in memory, ordered by path; gone when the process ends.
class MemoryTagStore : public TagStore {
public:
    const StoredTag* Find(const std::string& path) const override;
    void ForEach(const std::function<void(const StoredTag&)>& visit) const override;
    void Apply(const StoreBatch& batch) override;

private:
    std::map<std::string, StoredTag> tags_;
};

}  // namespace Korvane::Veldra::TagService
