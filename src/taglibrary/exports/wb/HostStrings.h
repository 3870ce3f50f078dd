#pragma once

#include <cstddef>
#include <cstdint>
#include <string>

#include "kvveldra/WBTypes.h"

namespace Korvane::Veldra::TagLibrary {

// The text of a host string; a null pointer, a null handle and a length of
// 0 or less all read as the empty string.
std::string ReadHostString(const WBStrHandle* handle);
std::string ReadHostString(WBStrHandle handle);

// Gives *handle a block of headerSize + max(elementSize * count, elementSize)
// bytes: a new one when *handle is null, else the existing one resized.
// Returns 0, 2 when the host is out of memory, or the host's resize status.
int32_t SizeHostHandle(WBHandle* handle, size_t headerSize, size_t elementSize, size_t count);

// Copies text into the string handle, creating or resizing it. Returns 0, or
// the status of the allocation or resize.
int32_t CopyToHostString(WBStrHandle* handle, const std::string& text);

}  // namespace Korvane::Veldra::TagLibrary
