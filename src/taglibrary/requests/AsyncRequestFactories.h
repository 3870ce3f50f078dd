#pragma once

#include <cstdint>
#include <memory>
#include <string>

#include "taglibrary/requests/AsyncRequest.h"

namespace Korvane::Veldra::TagLibrary {

// The requests that the exported families hand to the Client.
std::shared_ptr<AsyncRequest> MakeConsoleAsyncRequest();
// Also gives the number of the request's host signal, for the host to wait on.
std::shared_ptr<AsyncRequest> MakeWBAsyncRequest(uint32_t& signal);
std::shared_ptr<AsyncRequest> MakeAsyncRequestWithError(std::shared_ptr<AsyncRequest> inner,
                                                        int32_t errorCode, std::string errorText);

}  // namespace Korvane::Veldra::TagLibrary
