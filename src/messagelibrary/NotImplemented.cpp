#include "messagelibrary/NotImplemented.h"

#include "errors/VeldraException.h"
#include "errors/ErrorCodes.h"

namespace Korvane::Veldra::MessageBus {

void ThrowNotImplemented() {
    throw VeldraException(ErrorCodes::kException, "Not implemented");
}

}  // namespace Korvane::Veldra::MessageBus
