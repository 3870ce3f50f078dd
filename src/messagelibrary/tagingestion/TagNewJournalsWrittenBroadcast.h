#pragma once

#include <optional>
#include <string>

#include "messagelibrary/BroadcastMessage.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/json/JsonReaders.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagIngestionMessages {

// Tells that new journals were written, by their ids.
class TagNewJournalsWrittenBroadcast : public MessageBus::BroadcastMessage {
public:
    inline static const std::string kMessageName = "TagNewJournalsWrittenBroadcast";

    explicit TagNewJournalsWrittenBroadcast(std::optional<JsonStringList> journalIds);
    // Parses a received body.
    TagNewJournalsWrittenBroadcast(MessageBus::MessageHeaders headers,
                                   const MessageBus::MessageBody& body);

    const std::optional<JsonStringList>& JournalIds() const { return journalIds_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("journalIds", self.journalIds_);
    }

    std::optional<JsonStringList> journalIds_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagIngestionMessages
