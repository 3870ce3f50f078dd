#pragma once

#include <functional>
#include <string>

#include "StoredTag.h"

namespace Korvane::Veldra::TagService {

// Where the service keeps its tags. Reads see every batch applied before.
// Not thread-safe: the service calls it from one thread at a time.
class TagStore {
public:
    virtual ~TagStore() = default;

    // The tag of the path, or null. Valid until the next Apply.
    virtual const StoredTag* Find(const std::string& path) const = 0;
    // Every tag in order of path (byte order).
    virtual void ForEach(const std::function<void(const StoredTag&)>& visit) const = 0;
    // Applies the whole batch or, when it throws, nothing. A store on disk
    // has the batch on disk when this returns.
    virtual void Apply(const StoreBatch& batch) = 0;
};

}  // namespace Korvane::Veldra::TagService
