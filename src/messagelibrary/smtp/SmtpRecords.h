#pragma once

#include <optional>
#include <string>

#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/json/JsonWriters.h"

// The records of the e-mail messages.

namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages {

// A template as listed: without subject and contents.
struct SmtpTemplateListItem {
    std::optional<std::string> id;
    std::optional<std::string> name;
    std::optional<std::string> description;

    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("id", self.id).Field("name", self.name).Field("description", self.description);
    }
};

// A whole e-mail template; fields of a message fill its contents.
struct SmtpTemplateEntry {
    std::optional<std::string> id;
    std::optional<std::string> name;
    std::optional<std::string> description;
    std::optional<std::string> subject;
    std::optional<std::string> contents;

    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("id", self.id)
            .Field("name", self.name)
            .Field("description", self.description)
            .Field("subject", self.subject)
            .Field("contents", self.contents);
    }
};

// A named group of recipients.
struct SmtpAddressGroup {
    std::optional<std::string> id;
    std::optional<std::string> name;
    std::optional<JsonStringList> toAddresses;
    std::optional<JsonStringList> ccAddresses;
    std::optional<JsonStringList> bccAddresses;

    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("id", self.id)
            .Field("name", self.name)
            .Field("toAddresses", self.toAddresses)
            .Field("ccAddresses", self.ccAddresses)
            .Field("bccAddresses", self.bccAddresses);
    }
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages
