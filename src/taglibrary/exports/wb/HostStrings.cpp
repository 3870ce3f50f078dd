#include "taglibrary/exports/wb/HostStrings.h"

#include <algorithm>
#include <cstring>
#include <limits>

#include "taglibrary/exports/wb/HostRuntime.h"

namespace Korvane::Veldra::TagLibrary {

std::string ReadHostString(WBStrHandle handle) {
    if (handle == nullptr || *handle == nullptr || (*handle)->cnt <= 0) return std::string();
    const WBStr* block = *handle;
    return std::string(reinterpret_cast<const char*>(block->str),
                       static_cast<std::size_t>(block->cnt));
}

std::string ReadHostString(const WBStrHandle* handle) {
    return handle == nullptr ? std::string() : ReadHostString(*handle);
}

int32_t SizeHostHandle(WBHandle* handle, size_t headerSize, size_t elementSize, size_t count) {
    const auto& host = HostRuntime::Get();
    const size_t size = headerSize + std::max(elementSize * count, elementSize);
    if (*handle == nullptr) {
        if (host.NewHandleClr == nullptr) return kHostFunctionMissing;
        *handle = host.NewHandleClr(size);
        return *handle == nullptr ? 2 : 0;
    }
    if (host.ResizeHandleClr == nullptr) return kHostFunctionMissing;
    return host.ResizeHandleClr(*handle, size);
}

int32_t CopyToHostString(WBStrHandle* handle, const std::string& text) {
    if (handle == nullptr) return 0;  // no place for the text; the caller's status stands
    if (text.size() > static_cast<size_t>(std::numeric_limits<int32_t>::max())) return 1;
    const int32_t status =
        SizeHostHandle(reinterpret_cast<WBHandle*>(handle), offsetof(WBStr, str), 1, text.size());
    if (status != 0) return status;
    WBStr* block = **handle;
    if (!text.empty()) std::memcpy(block->str, text.data(), text.size());
    block->cnt = static_cast<int32_t>(text.size());
    return 0;
}

}  // namespace Korvane::Veldra::TagLibrary
