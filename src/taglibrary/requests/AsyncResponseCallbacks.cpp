#include "taglibrary/requests/AsyncResponseCallbacks.h"

namespace Korvane::Veldra::TagLibrary {

void GenericAsyncResponseCallback::OnResponse(std::shared_ptr<GenericMessage> reply,
                                              uint32_t state) {
    requests_->Complete(state, reply);
}

void IgnoringAsyncResponseCallback::OnResponse(std::shared_ptr<GenericMessage> reply,
                                               uint32_t state) {
    if (!reply || !reply->HasError()) return;
    inner_.OnResponse(std::move(reply), state);
}

}  // namespace Korvane::Veldra::TagLibrary
