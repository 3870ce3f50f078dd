#pragma once

#include <cstdint>

#include "messagelibrary/json/JsonEnum.h"

namespace Korvane::Veldra::VeldraMessageLibrary::HttpMessages {

// The method of an HTTP request carried over the bus. An unknown text is
// refused.
enum class HttpMethod : int32_t {
    Get = 0,
    Put = 1,
    Post = 2,
    Delete = 3,
    Patch = 4,
    Options = 5,
    Head = 6,
};

inline constexpr JsonEnumText kHttpMethodTexts[] = {
    {0, "GET"}, {1, "PUT"}, {2, "POST"}, {3, "DELETE"}, {4, "PATCH"}, {5, "OPTIONS"}, {6, "HEAD"}};
inline JsonEnumTexts JsonEnumTextsOf(HttpMethod) {
    return kHttpMethodTexts;
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::HttpMessages
