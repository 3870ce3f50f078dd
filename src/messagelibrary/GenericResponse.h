#pragma once

#include <optional>
#include <string>
#include <type_traits>

#include "messagebus/interfaces/IRoutingSource.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageError.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/ResponseMessage.h"

namespace Korvane::Veldra::MessageBus {

// The bare reply to a message: its outcome in the headers and, in the body,
// the name of the message it answers: {"RequestName":"<name>"}.
class GenericResponse : public ResponseMessage {
public:
    inline static const std::string kMessageName = "GenericResponse";

    // Answers a received or typed message (anything with a MessageType()).
    template <typename Request,
              typename = std::enable_if_t<std::is_base_of_v<Interfaces::IRoutingSource, Request>>>
    explicit GenericResponse(const Request& request,
                             const std::optional<MessageError>& error = std::nullopt)
        : GenericResponse(static_cast<const Interfaces::IRoutingSource&>(request),
                          request.MessageType(), error) {}
    // Parses a received body.
    GenericResponse(MessageHeaders headers, const MessageBody& body);

    const std::string& RequestName() const { return requestName_; }
    // The name is written as it stands, without escaping: message names hold
    // no character that would need it.
    MessageBody Serialize() const override;

private:
    GenericResponse(const Interfaces::IRoutingSource& request, const std::string& requestName,
                    const std::optional<MessageError>& error);

    std::string requestName_;
};

}  // namespace Korvane::Veldra::MessageBus
