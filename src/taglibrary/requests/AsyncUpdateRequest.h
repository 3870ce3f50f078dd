#pragma once

#include "taglibrary/requests/AsyncRequest.h"

namespace Korvane::Veldra::TagLibrary {

// For the reply to a TagInfoCreateOrUpdateTagsRequest, whose failures travel
// in the body while the headers stay clean. The caller waits on `inner`.
class AsyncUpdateRequest : public AsyncRequest {
public:
    explicit AsyncUpdateRequest(std::shared_ptr<AsyncRequest> inner);

    // The inner result first; then the first of the body's inner errors, by
    // its name without inserts. A body that does not parse throws.
    int32_t CheckResult(const TagIngestion::Errors& errors, std::string& error) override;
    bool Complete(std::shared_ptr<GenericMessage> reply) override;
    bool CallerWaits() const override { return inner_->CallerWaits(); }

private:
    const std::shared_ptr<AsyncRequest> inner_;
};

}  // namespace Korvane::Veldra::TagLibrary
