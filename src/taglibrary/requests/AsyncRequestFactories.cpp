#include "taglibrary/requests/AsyncRequestFactories.h"

#include "taglibrary/requests/AsyncRequestWithError.h"
#include "taglibrary/requests/ConsoleAsyncRequest.h"
#include "taglibrary/requests/WBAsyncRequest.h"

namespace Korvane::Veldra::TagLibrary {

std::shared_ptr<AsyncRequest> MakeConsoleAsyncRequest() {
    return std::make_shared<ConsoleAsyncRequest>();
}

std::shared_ptr<AsyncRequest> MakeWBAsyncRequest(uint32_t& signal) {
    auto request = std::make_shared<WBAsyncRequest>();
    signal = request->SignalNumber();
    return request;
}

std::shared_ptr<AsyncRequest> MakeAsyncRequestWithError(std::shared_ptr<AsyncRequest> inner,
                                                        int32_t errorCode, std::string errorText) {
    return std::make_shared<AsyncRequestWithError>(std::move(inner), errorCode,
                                                   std::move(errorText));
}

}  // namespace Korvane::Veldra::TagLibrary
