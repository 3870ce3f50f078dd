#pragma once

#include "taglibrary/requests/AsyncRequest.h"

namespace Korvane::Veldra::TagLibrary {

// Carries a local error that the call reports at its end, after the remote
// part has run: a non-zero code goes before any error of the reply and
// before a time-out. The caller waits on `inner`.
class AsyncRequestWithError : public AsyncRequest {
public:
    AsyncRequestWithError(std::shared_ptr<AsyncRequest> inner, int32_t errorCode,
                          std::string errorText);

    int32_t CheckResult(const TagIngestion::Errors& errors, std::string& error) override;
    bool Complete(std::shared_ptr<GenericMessage> reply) override;

private:
    const int32_t errorCode_;
    const std::string errorText_;
    const std::shared_ptr<AsyncRequest> inner_;
};

}  // namespace Korvane::Veldra::TagLibrary
