#include "taglibrary/requests/AsyncUpdateRequest.h"

#include <stdexcept>

#include "messagelibrary/taginfo/TagInfoCreateOrUpdateTagsResponse.h"

namespace Korvane::Veldra::TagLibrary {

AsyncUpdateRequest::AsyncUpdateRequest(std::shared_ptr<AsyncRequest> inner)
    : inner_(std::move(inner)) {
    if (!inner_) throw std::invalid_argument("AsyncUpdateRequest needs an inner request");
}

int32_t AsyncUpdateRequest::CheckResult(const TagIngestion::Errors& errors, std::string& error) {
    const int32_t status = inner_->CheckResult(errors, error);
    if (status != 0) return status;
    const auto& reply = inner_->Response();
    const VeldraMessageLibrary::TagInfoMessages::TagInfoCreateOrUpdateTagsResponse response(
        reply->Headers(), reply->Body());
    const auto& record = response.Errors();
    if (!record || !record->innerErrors) return 0;
    const std::string name = record->innerErrors->empty()
                                 ? std::string("Tag.InvalidState")
                                 : record->innerErrors->front().name.value_or("");
    error = errors.messageForName(name);
    return errors.codeForName(name);
}

bool AsyncUpdateRequest::Complete(std::shared_ptr<GenericMessage> reply) {
    SetResponse(reply);
    return inner_->Complete(std::move(reply));
}

}  // namespace Korvane::Veldra::TagLibrary
