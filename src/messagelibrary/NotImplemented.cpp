#include "messagelibrary/NotImplemented.h"

#include "errors/VeldraException.h"
#include "messagebus/BusErrorCodes.h"

namespace Korvane::Veldra::MessageBus {

void ThrowNotImplemented() {
    throw VeldraException(BusErrorCodes::kException, "Not implemented");
}

}  // namespace Korvane::Veldra::MessageBus
