#pragma once

#include <cstdint>
#include <map>
#include <memory>
#include <mutex>

#include "taglibrary/requests/AsyncRequest.h"

namespace Korvane::Veldra::TagLibrary {

// The requests in flight of one Client, by request id. Ids count up from 1
// and wrap past 0xFFFFFFFF to 1; 0 is never issued. The mutex also covers the
// completion of a request by a reply, so Complete never overlaps a Take.
class AsyncRequestMap {
public:
    // `lastId` is the id before the first one issued.
    explicit AsyncRequestMap(uint32_t lastId = 0) : lastId_(lastId) {}

    // Files the request under the next id, replacing an entry of that id that
    // survived a full wrap of the counter.
    uint32_t Add(std::shared_ptr<AsyncRequest> request);
    // Removes and returns the request; null when the id is absent.
    std::shared_ptr<AsyncRequest> Take(uint32_t requestId);
    // Stores the reply in the request of that id, if any. A request whose
    // completion fails is dropped. Runs on the bus thread.
    void Complete(uint32_t requestId, const std::shared_ptr<GenericMessage>& reply);

    std::size_t Size() const;

private:
    mutable std::mutex mutex_;
    uint32_t lastId_ = 0;
    std::map<uint32_t, std::shared_ptr<AsyncRequest>> requests_;
};

}  // namespace Korvane::Veldra::TagLibrary
