#include "messagelibrary/GenericMessage.h"

#include <utility>

namespace Korvane::Veldra::MessageBus {

GenericMessage::GenericMessage(MessageHeaders headers, MessageBody body)
    : headers_(std::move(headers)), body_(std::move(body)) {}

}  // namespace Korvane::Veldra::MessageBus
