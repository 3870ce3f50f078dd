#include "taglibrary/requests/AsyncRequestMap.h"

namespace Korvane::Veldra::TagLibrary {

uint32_t AsyncRequestMap::Add(std::shared_ptr<AsyncRequest> request) {
    std::lock_guard<std::mutex> lock(mutex_);
    ++lastId_;
    if (lastId_ == 0) lastId_ = 1;
    requests_[lastId_] = std::move(request);
    return lastId_;
}

std::shared_ptr<AsyncRequest> AsyncRequestMap::Take(uint32_t requestId) {
    std::lock_guard<std::mutex> lock(mutex_);
    const auto found = requests_.find(requestId);
    if (found == requests_.end()) return nullptr;
    auto request = std::move(found->second);
    requests_.erase(found);
    return request;
}

void AsyncRequestMap::Complete(uint32_t requestId, const std::shared_ptr<GenericMessage>& reply) {
    std::lock_guard<std::mutex> lock(mutex_);
    const auto found = requests_.find(requestId);
    // A reply after its caller finished: dropped without a word.
    if (found == requests_.end() || !found->second) return;
    if (!found->second->Complete(reply)) requests_.erase(found);
}

std::size_t AsyncRequestMap::Size() const {
    std::lock_guard<std::mutex> lock(mutex_);
    return requests_.size();
}

}  // namespace Korvane::Veldra::TagLibrary
