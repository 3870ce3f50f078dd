// The bus half of the Client: construction and shutdown in their order, the
// two send paths and the finish step that every operation shares.
#include <amqp.h>

#include <algorithm>
#include <chrono>
#include <limits>

#include "errors/AmqpException.h"
#include "errors/ErrorCodes.h"
#include "messagebus/amqp/AmqpConnectionManager.h"
#include "messagebus/config/BusConfigurations.h"
#include "messagebus/service/MessageService.h"
#include "messagelibrary/tagcurrentvalue/TagCvQueryCurrentValuesByPathResponse.h"
#include "messagelibrary/taginfo/TagInfoCreateOrUpdateTagsResponse.h"
#include "messagelibrary/taginfo/TagInfoQueryTagsResponse.h"
#include "taglibrary/Client.h"
#include "utilities/tracelogging/ProcessLogger.h"
#include "utilities/tracelogging/TraceLogger.h"

namespace Korvane::Veldra::TagLibrary {

namespace {

const char* const kServiceName = "TagClient";

}  // namespace

Client::Client(const std::string& configurationId, uint32_t timeoutMs, bool allowFallback,
               bool verbose, std::shared_ptr<TagIngestion::Errors> errors)
    : verbose_(verbose),
      requestMap_(std::make_shared<AsyncRequestMap>()),
      configurationId_(configurationId),
      timeoutMs_(timeoutMs),
      allowFallback_(allowFallback) {
    using namespace MessageBus;
    const BusConfigurationEntry entry =
        BusConfigurations::GetNamed(configurationId, allowFallback);
    connectionManager_ = std::make_shared<AmqpConnectionManager>(entry.Configuration);
    // The time that a first connection may take; not the time-out of requests.
    connectionManager_->SetConnectTimeout(static_cast<int32_t>(
        std::min<uint32_t>(timeoutMs, std::numeric_limits<int32_t>::max())));

    MessageServiceSettings settings;
    settings.Name = kServiceName;
    settings.ConnectionManager = connectionManager_.get();
    messageService_ = std::make_shared<MessageService>(settings);

    errors_ = std::move(errors);
    tags_ = std::make_shared<TagMap>();
    try {
        responseCallback_ = std::make_shared<GenericAsyncResponseCallback>(requestMap_);
        processLogger_ = std::make_shared<VeldraUtilities::TraceLogging::ProcessLogger>(
            kServiceName, messageService_->GetPublishCallback(),
            messageService_->GetRegisterCallback());
        messageService_->SetTraceLogger(
            std::make_shared<VeldraUtilities::TraceLogging::TraceLogger>(kServiceName,
                                                                         processLogger_));
        for (const std::string* name :
             {&VeldraMessageLibrary::TagCurrentValueMessages::TagCvQueryCurrentValuesByPathResponse::
                  kMessageName,
              &VeldraMessageLibrary::TagInfoMessages::TagInfoCreateOrUpdateTagsResponse::kMessageName,
              &VeldraMessageLibrary::TagInfoMessages::TagInfoQueryTagsResponse::kMessageName}) {
            messageService_->RegisterResponseCallback(*name, responseCallback_.get());
        }
    } catch (...) {
        ShutdownBus();
        throw;
    }
}

Client::~Client() {
    ShutdownBus();
}

void Client::ShutdownBus() noexcept {
    // The logger publishes through the service, and the service delivers to
    // the logger's snapshot callback: stop the logger's thread, let the
    // service's threads end, and only then let the logger go.
    if (processLogger_) processLogger_->Stop();
    std::shared_ptr<MessageBus::MessageService> service = std::move(messageService_);
    service.reset();
    std::shared_ptr<VeldraUtilities::TraceLogging::ProcessLogger> logger =
        std::move(processLogger_);
    logger.reset();
}

uint32_t Client::RequestTimeoutMs() const {
    return messageService_ ? messageService_->DefaultTimeoutMs()
                           : MessageBus::MessageServiceSettings().DefaultTimeoutMs;
}

int32_t Client::AwaitReplyRoute(MessageBus::MessageService& service, const AsyncRequest& request,
                                std::string& error) const {
    // Deliberate hardening: after a reconnect the reply queue exists again
    // only once its consumer has declared and bound it; a reply sent before
    // that is dropped by the broker. A blocking caller waits for it within
    // its request's time-out, one that must not block is told at once.
    if (service.AwaitReplyRoute(request.CallerWaits() ? service.DefaultTimeoutMs() : 0)) return 0;
    // A lost publisher fails the send itself at once, with its own error.
    if (service.IsPublisherLost()) return 0;
    if (request.CallerWaits()) return ReportError("Veldra.RequestTimedOut", error);
    return ReportException(
        MessageBus::AmqpException(ErrorCodes::kPublishingMessage,
                                  "Error publishing message. The reply queue is being declared "
                                  "and bound again after a reconnect; try again shortly.",
                                  AMQP_STATUS_CONNECTION_CLOSED),
        error);
}

template <typename Send>
int32_t Client::FileAndSend(MessageBus::MessageBase& message,
                            const std::shared_ptr<AsyncRequest>& request, Send send,
                            uint32_t& requestId, uint32_t& timeoutMs, std::string& error) {
    const auto started = std::chrono::steady_clock::now();
    // The identity first, so that the request knows its correlation id
    // before anyone can finish it.
    message.Headers().EnsureIdentity();
    request->SetCorrelationId(message.CorrelationId());
    // Filed before the send: the reply cannot come before its request is.
    requestId = requestMap_->Add(request);
    if (requestId == 0) return ReportError("Tag.InvalidState", error);
    try {
        if (!messageService_) {
            requestMap_->Take(requestId);
            return ReportError("Tag.InvalidState", error);
        }
        const int32_t routeStatus = AwaitReplyRoute(*messageService_, *request, error);
        if (routeStatus != 0) {
            requestMap_->Take(requestId);
            return routeStatus;
        }
        send(*messageService_, requestId);
        // The wait for the reply queue counts in the request's time-out.
        const auto spent = std::chrono::duration_cast<std::chrono::milliseconds>(
                               std::chrono::steady_clock::now() - started)
                               .count();
        const uint32_t requestTimeoutMs = messageService_->DefaultTimeoutMs();
        timeoutMs = spent >= int64_t{requestTimeoutMs}
                        ? 0
                        : requestTimeoutMs - static_cast<uint32_t>(spent);
        return 0;
    } catch (const MessageBus::VeldraException& exception) {
        Forget(requestId, *request);
        return ReportException(exception, error);
    } catch (const std::exception& exception) {
        Forget(requestId, *request);
        return ReportUnexpectedException(exception, error);
    }
}

void Client::Forget(uint32_t requestId, const AsyncRequest& request) {
    requestMap_->Take(requestId);
    // No reply can come for a message that was not sent.
    if (messageService_) {
        messageService_->Subscriber()->CorrIdCallbacks()->Erase(request.CorrelationId());
    }
}

int32_t Client::SendTrackedRequest(MessageBus::MessageBase& message,
                                   const std::shared_ptr<AsyncRequest>& request,
                                   uint32_t& requestId, uint32_t& timeoutMs, std::string& error) {
    return FileAndSend(
        message, request,
        [&](MessageBus::MessageService& service, uint32_t state) {
            // The response finds the callback by its message name.
            service.SendRequestAsync(message, state, true);
        },
        requestId, timeoutMs, error);
}

int32_t Client::SendTrackedRouted(MessageBus::MessageBase& message,
                                  const std::shared_ptr<AsyncRequest>& request,
                                  uint32_t& requestId, uint32_t& timeoutMs, std::string& error) {
    return FileAndSend(
        message, request,
        [&](MessageBus::MessageService& service, uint32_t state) {
            // The reply, a GenericResponse, goes straight to the callback by
            // the correlation id: routed messages have no response name. The
            // entry goes when the request times out.
            service.Subscriber()->RegisterCorrelationCallback(
                message.CorrelationId(), responseCallback_, state, service.DefaultTimeoutMs());
            service.SendRouted(message, false);
        },
        requestId, timeoutMs, error);
}

int32_t Client::TakeFinishedRequest(uint32_t requestId, std::shared_ptr<AsyncRequest>& request,
                                    std::string& error) {
    request = requestMap_->Take(requestId);
    if (!request) return ReportError("Tag.InvalidState", error);
    // A reply that did not come leaves its correlation entry: it ends here,
    // with its request.
    if (messageService_ && !request->CorrelationId().empty()) {
        messageService_->Subscriber()->CorrIdCallbacks()->Erase(request->CorrelationId());
    }
    return request->CheckResult(*errors_, error);
}

int32_t Client::FinishRequest(uint32_t requestId, std::string& error) {
    std::shared_ptr<AsyncRequest> request;
    return TakeFinishedRequest(requestId, request, error);
}

}  // namespace Korvane::Veldra::TagLibrary
