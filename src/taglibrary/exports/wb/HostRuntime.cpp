#include "taglibrary/exports/wb/HostRuntime.h"

#include <dlfcn.h>

namespace Korvane::Veldra::TagLibrary {
namespace {

template <typename Function>
void Resolve(Function& target, const char* name) {
    target = reinterpret_cast<Function>(dlsym(RTLD_DEFAULT, name));
}

HostRuntime Load() {
    HostRuntime runtime;
    Resolve(runtime.NewHandleClr, "WBNewHandleClr");
    Resolve(runtime.ResizeHandleClr, "WBResizeHandleClr");
    Resolve(runtime.AllocSignal, "WBAllocSignal");
    Resolve(runtime.FreeSignal, "WBFreeSignal");
    Resolve(runtime.FireSignal, "WBFireSignal");
    Resolve(runtime.VariantGetDataPtr, "WbVariantGetDataPtr");
    Resolve(runtime.VariantNestInVariant, "WbVariantNestInVariant");
    Resolve(runtime.VariantSetDBL, "WbVariantSetDBL");
    Resolve(runtime.VariantSetI32, "WbVariantSetI32");
    Resolve(runtime.VariantSetUI32, "WbVariantSetUI32");
    Resolve(runtime.VariantSetBool, "WbVariantSetBool");
    Resolve(runtime.VariantSetLStr, "WbVariantSetLStr");
    return runtime;
}

}  // namespace

const HostRuntime& HostRuntime::Get() {
    static const HostRuntime runtime = Load();
    return runtime;
}

}  // namespace Korvane::Veldra::TagLibrary
