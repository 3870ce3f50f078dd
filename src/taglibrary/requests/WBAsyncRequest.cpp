#include "taglibrary/requests/WBAsyncRequest.h"

namespace Korvane::Veldra::TagLibrary {

WBAsyncRequest::WBAsyncRequest() : signal_(new kvsup::wb::WBDynamicSignal()) {}

bool WBAsyncRequest::Complete(std::shared_ptr<GenericMessage> reply) {
    SetResponse(std::move(reply));
    return signal_->Fire() == 0;
}

}  // namespace Korvane::Veldra::TagLibrary
