#include "taglibrary/requests/AsyncRequestWithError.h"

#include <stdexcept>

namespace Korvane::Veldra::TagLibrary {

AsyncRequestWithError::AsyncRequestWithError(std::shared_ptr<AsyncRequest> inner,
                                             int32_t errorCode, std::string errorText)
    : errorCode_(errorCode), errorText_(std::move(errorText)), inner_(std::move(inner)) {
    if (!inner_) throw std::invalid_argument("AsyncRequestWithError needs an inner request");
}

int32_t AsyncRequestWithError::CheckResult(const TagIngestion::Errors& errors,
                                           std::string& error) {
    if (errorCode_ != 0) {
        error = errorText_;
        return errorCode_;
    }
    return inner_->CheckResult(errors, error);
}

bool AsyncRequestWithError::Complete(std::shared_ptr<GenericMessage> reply) {
    SetResponse(reply);
    return inner_->Complete(std::move(reply));
}

}  // namespace Korvane::Veldra::TagLibrary
