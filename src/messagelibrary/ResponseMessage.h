#pragma once

#include <optional>
#include <string>
#include <utility>

#include "messagebus/interfaces/IRoutingSource.h"
#include "messagelibrary/MessageBase.h"

namespace Korvane::Veldra::MessageBus {

// The answer to a request. A concrete response is sent to the request's reply
// queue and carries the request's correlation id and, on failure, an error:
//
//   SomeResponse(const Interfaces::IRoutingSource& request,
//                const std::optional<MessageError>& error = std::nullopt)
//       : ResponseMessage(kName, "application/json", request.ReplyTo()) {
//       AnswerTo(request, error);
//   }
class ResponseMessage : public MessageBase {
public:
    ResponseMessage(const std::string& messageType, const std::string& contentType,
                    const std::string& target)
        : MessageBase(messageType, contentType, target) {}
    explicit ResponseMessage(MessageHeaders headers) : MessageBase(std::move(headers)) {}

protected:
    // Takes the request's correlation id, and the error when there is one.
    void AnswerTo(const Interfaces::IRoutingSource& request,
                  const std::optional<MessageError>& error) {
        SetCorrelationId(request.CorrelationId());
        if (error) SetError(error);
    }
};

}  // namespace Korvane::Veldra::MessageBus
