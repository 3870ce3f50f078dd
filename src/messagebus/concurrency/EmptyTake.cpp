#include "messagebus/concurrency/EmptyTake.h"

#include "errors/VeldraException.h"
#include "errors/ErrorCodes.h"

namespace Korvane::Veldra::MessageBus {

void ThrowEmptyTake(bool closed, const std::string& errorText) {
    if (closed) throw VeldraException(ErrorCodes::kEndOfStream, "End Of Stream.");
    throw VeldraException(ErrorCodes::kQueueEmpty, errorText);
}

}  // namespace Korvane::Veldra::MessageBus
