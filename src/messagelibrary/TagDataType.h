#pragma once

#include <cstdint>

#include "messagelibrary/json/JsonEnum.h"

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

inline constexpr JsonEnumText kTagDataTypeTexts[] = {
    {0, "NONE"},    {1, "DOUBLE"},  {2, "INT"},       {3, "STRING"},
    {4, "BOOLEAN"}, {5, "U_INT64"}, {6, "DATE_TIME"},
};
inline JsonEnumTexts JsonEnumTextsOf(TagDataType) {
    return kTagDataTypeTexts;
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary
