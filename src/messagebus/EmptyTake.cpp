#include "messagebus/EmptyTake.h"

#include "errors/VeldraException.h"
#include "messagebus/BusErrorCodes.h"

namespace Korvane::Veldra::MessageBus {

void ThrowEmptyTake(bool closed, const std::string& errorText) {
    if (closed) throw VeldraException(BusErrorCodes::kEndOfStream, "End Of Stream.");
    throw VeldraException(BusErrorCodes::kQueueEmpty, errorText);
}

}  // namespace Korvane::Veldra::MessageBus
