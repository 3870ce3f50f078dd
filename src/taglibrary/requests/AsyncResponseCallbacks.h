#pragma once

#include <memory>
#include <string>

#include "messagebus/interfaces/IResponseCallback.h"
#include "taglibrary/requests/AsyncRequestMap.h"

namespace Korvane::Veldra::TagLibrary {

// Completes the request whose id the reply's state carries.
class GenericAsyncResponseCallback : public MessageBus::Interfaces::IResponseCallback {
public:
    explicit GenericAsyncResponseCallback(std::shared_ptr<AsyncRequestMap> requests)
        : requests_(std::move(requests)) {}
    void OnResponse(std::shared_ptr<GenericMessage> reply, uint32_t state) override;
    // Completing a request never blocks and runs no caller's code.
    bool RunsOnReader(const std::string&) const override { return true; }

private:
    const std::shared_ptr<AsyncRequestMap> requests_;
};

// Lets a reply without error pass unnoticed and completes the request only
// with a failure.
class IgnoringAsyncResponseCallback : public MessageBus::Interfaces::IResponseCallback {
public:
    explicit IgnoringAsyncResponseCallback(std::shared_ptr<AsyncRequestMap> requests)
        : inner_(std::move(requests)) {}
    void OnResponse(std::shared_ptr<GenericMessage> reply, uint32_t state) override;
    // Completing a request never blocks and runs no caller's code.
    bool RunsOnReader(const std::string&) const override { return true; }

private:
    GenericAsyncResponseCallback inner_;
};

}  // namespace Korvane::Veldra::TagLibrary
