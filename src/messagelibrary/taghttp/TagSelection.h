#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/json/JsonWriters.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHttpMessages {

// A named selection of tags by search paths, dropped after inactivityTimeout
// without use.
struct TagSelection {
    std::optional<std::string> id;
    std::optional<JsonStringList> searchPaths;
    int32_t inactivityTimeout = 0;

    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("id", self.id)
            .Field("searchPaths", self.searchPaths)
            .Field("inactivityTimeout", self.inactivityTimeout);
    }
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHttpMessages
