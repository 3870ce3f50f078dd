#pragma once

#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "errors/Errors.h"
#include "messagelibrary/GenericMessage.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageError.h"

namespace Korvane::Veldra::TagLibrary::Testing {

// A reply of the type with the body, carrying the error in its headers.
inline std::shared_ptr<MessageBus::GenericMessage> Reply(
    const std::string& type, const std::string& body = "{}",
    const std::optional<MessageBus::MessageError>& error = std::nullopt) {
    MessageBus::MessageHeaders headers;
    headers.messageType = type;
    headers.SetError(error);
    return std::make_shared<MessageBus::GenericMessage>(headers, MessageBus::MessageBody(body));
}

inline std::shared_ptr<MessageBus::GenericMessage> ErrorReply(
    const std::string& name, std::vector<std::string> args = {}) {
    return Reply("GenericResponse", "{}", MessageBus::MessageError::Named(name, std::move(args)));
}

inline std::shared_ptr<TagIngestion::Errors> InitializedErrors() {
    auto errors = std::make_shared<TagIngestion::Errors>();
    errors->initialize();
    return errors;
}

}  // namespace Korvane::Veldra::TagLibrary::Testing
