#pragma once

#include <optional>
#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RequestMessage.h"
#include "messagelibrary/json/JsonReaders.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages {

// Deletes stored values of one tag by their ids.
class TagHistorianDeleteValuesByIdRequest : public MessageBus::RequestMessage {
public:
    inline static const std::string kMessageName = "TagHistorianDeleteValuesByIdRequest";

    TagHistorianDeleteValuesByIdRequest(std::optional<std::string> path,
                                        std::optional<JsonStringList> ids);
    // Parses a received body.
    TagHistorianDeleteValuesByIdRequest(MessageBus::MessageHeaders headers,
                                        const MessageBus::MessageBody& body);

    const std::optional<std::string>& Path() const { return path_; }
    const std::optional<JsonStringList>& Ids() const { return ids_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("path", self.path_).Field("ids", self.ids_);
    }

    std::optional<std::string> path_;
    std::optional<JsonStringList> ids_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages
