#pragma once

#include <cstddef>
#include <cstdint>

#include "errors/ErrorCodes.h"
#include "kvveldra/WBTypes.h"

namespace Korvane::Veldra::TagLibrary {

// The functions of the graphical host's runtime that the TagWB* family needs.
// The host process provides them; they are looked up by name in the process
// on first use. A function the process does not have stays null.
struct HostRuntime {
    WBHandle (*NewHandleClr)(size_t size) = nullptr;
    int32_t (*ResizeHandleClr)(WBHandle handle, size_t size) = nullptr;
    uint32_t (*AllocSignal)() = nullptr;
    int32_t (*FreeSignal)(uint32_t signal) = nullptr;
    int32_t (*FireSignal)(uint32_t signal) = nullptr;
    void* (*VariantGetDataPtr)(WbVariant* variant) = nullptr;
    int32_t (*VariantNestInVariant)(WbVariant** slot) = nullptr;
    int32_t (*VariantSetDBL)(WbVariant* variant, double value) = nullptr;
    int32_t (*VariantSetI32)(WbVariant* variant, int32_t value) = nullptr;
    int32_t (*VariantSetUI32)(WbVariant* variant, uint32_t value) = nullptr;
    int32_t (*VariantSetBool)(WbVariant* variant, uint8_t value) = nullptr;
    int32_t (*VariantSetLStr)(WbVariant* variant, WBStrHandle value) = nullptr;

    static const HostRuntime& Get();
};

// Returned when the process lacks a host function that a call needs.
constexpr int32_t kHostFunctionMissing = ErrorCodes::kNotSupported;

}  // namespace Korvane::Veldra::TagLibrary
