#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "messagelibrary/TagRecords.h"
#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/json/JsonWriters.h"
#include "messagelibrary/tagsubscription/SubscriptionUpdateMode.h"

// The records of the subscription messages.

namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages {

// How a subscription delivers its updates.
struct SubscriptionOptions {
    std::optional<SubscriptionUpdateMode> updateMode;
    bool updatesOnly = false;
    int32_t batchIntervalSeconds = 0;

    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("updateMode", self.updateMode)
            .Field("updatesOnly", self.updatesOnly)
            .Field("batchIntervalSeconds", self.batchIntervalSeconds);
    }
};

// What happened to the tags of one subscription since its last update.
struct SubscriptionUpdate {
    std::optional<std::string> subscriptionId;
    std::optional<std::string> alias;
    std::optional<std::vector<TagUpdateSet>> updates;
    std::optional<JsonStringList> createdTags;
    std::optional<JsonStringList> deletedTags;
    std::optional<JsonStringList> nonexistentTags;

    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("subscriptionId", self.subscriptionId)
            .Field("alias", self.alias)
            .Field("updates", self.updates)
            .Field("createdTags", self.createdTags)
            .Field("deletedTags", self.deletedTags)
            .Field("nonexistentTags", self.nonexistentTags);
    }
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages
