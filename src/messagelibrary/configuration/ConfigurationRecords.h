#pragma once

#include <optional>
#include <string>

#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/json/JsonWriters.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages {

// The keys and values of one configuration section.
struct ConfigurationSectionKeyValues {
    std::optional<std::string> section;
    std::optional<JsonStringMap> keyValues;

    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("section", self.section).Field("keyValues", self.keyValues);
    }
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages
