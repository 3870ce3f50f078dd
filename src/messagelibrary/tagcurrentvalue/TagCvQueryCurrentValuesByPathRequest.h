#pragma once

#include <optional>
#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RequestMessage.h"
#include "messagelibrary/json/JsonReaders.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagCurrentValueMessages {

// Asks for the current values of tags by path.
class TagCvQueryCurrentValuesByPathRequest : public MessageBus::RequestMessage {
public:
    inline static const std::string kMessageName = "TagCvQueryCurrentValuesByPathRequest";

    TagCvQueryCurrentValuesByPathRequest(std::optional<JsonStringList> paths, bool allowStale);
    // Parses a received body.
    TagCvQueryCurrentValuesByPathRequest(MessageBus::MessageHeaders headers,
                                         const MessageBus::MessageBody& body);

    const std::optional<JsonStringList>& Paths() const { return paths_; }
    bool AllowStale() const { return allowStale_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("paths", self.paths_).Field("allowStale", self.allowStale_);
    }

    std::optional<JsonStringList> paths_;
    bool allowStale_ = false;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagCurrentValueMessages
