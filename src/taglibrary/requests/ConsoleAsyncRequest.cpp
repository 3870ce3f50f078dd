#include "taglibrary/requests/ConsoleAsyncRequest.h"

namespace Korvane::Veldra::TagLibrary {

bool ConsoleAsyncRequest::Complete(std::shared_ptr<GenericMessage> reply) {
    SetResponse(std::move(reply));
    completed_.Set();
    return true;
}

}  // namespace Korvane::Veldra::TagLibrary
