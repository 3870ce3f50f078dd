#include "messagelibrary/GenericResponse.h"

#include <utility>

#include "messagelibrary/json/JsonReaders.h"

namespace Korvane::Veldra::MessageBus {

GenericResponse::GenericResponse(const Interfaces::IRoutingSource& request,
                                 const std::string& requestName,
                                 const std::optional<MessageError>& error)
    : ResponseMessage(kMessageName, "application/json", request.ReplyTo()),
      requestName_(requestName) {
    AnswerTo(request, error);
}

GenericResponse::GenericResponse(MessageHeaders headers, const MessageBody& body)
    : ResponseMessage(std::move(headers)) {
    using namespace VeldraMessageLibrary;
    const JsonVariant json = ParseJsonBody(body.ToString(), MessageType());
    JsonBodyReader(json).Field("RequestName", requestName_);
}

MessageBody GenericResponse::Serialize() const {
    return MessageBody("{\"RequestName\":\"" + requestName_ + "\"}");
}

}  // namespace Korvane::Veldra::MessageBus
