#pragma once

#include <optional>
#include <string>
#include <vector>

#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/json/JsonWriters.h"

namespace Korvane::Veldra::VeldraMessageLibrary {

// A structured error inside a message body, with the errors that caused it.
// Independent of the error a response carries in its headers.
struct ErrorRecord {
    std::optional<std::string> name;  // the error's full name: "Tag.NoSuchTag"
    std::optional<std::string> message;
    std::optional<JsonStringList> args;
    std::optional<std::vector<ErrorRecord>> innerErrors;
    std::optional<std::string> resourceId;
    std::optional<std::string> resourceType;

    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("name", self.name)
            .Field("message", self.message)
            .Field("args", self.args)
            .Field("innerErrors", self.innerErrors)
            .Field("resourceId", self.resourceId)
            .Field("resourceType", self.resourceType);
    }
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary
