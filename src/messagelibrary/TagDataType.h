#pragma once

#include <cstdint>

namespace Korvane::Veldra::VeldraMessageLibrary {

// The data type of a tag as the tag services and their messages number it.
enum class TagDataType : int32_t {
    None = 0,
    Double = 1,
    Int = 2,
    String = 3,
    Boolean = 4,
    UInt64 = 5,
    DateTime = 6,
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary
