#include "taglibrary/requests/WBDynamicSignal.h"

#include "errors/VeldraException.h"
#include "taglibrary/exports/wb/HostRuntime.h"

namespace kvsup::wb {

using Korvane::Veldra::TagLibrary::HostRuntime;
using Korvane::Veldra::TagLibrary::kHostFunctionMissing;

WBDynamicSignal::WBDynamicSignal() {
    const HostRuntime& host = HostRuntime::Get();
    if (host.AllocSignal == nullptr || host.FireSignal == nullptr) {
        throw Korvane::Veldra::MessageBus::VeldraException(
            kHostFunctionMissing, "The host runtime has no WBAllocSignal or WBFireSignal.");
    }
    number_ = host.AllocSignal();
    owned_ = 1;
}

WBDynamicSignal::~WBDynamicSignal() {
    const HostRuntime& host = HostRuntime::Get();
    if (owned_ != 0 && host.FreeSignal != nullptr) host.FreeSignal(number_);
}

int32_t WBDynamicSignal::Fire() const {
    return HostRuntime::Get().FireSignal(number_);
}

}  // namespace kvsup::wb
