#pragma once

#include <optional>
#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RequestMessage.h"
#include "messagelibrary/json/JsonReaders.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages {

// Ends a subscription to stored values of tags under the search paths.
class TagHistorianAsyncUnsubscribeRequest : public MessageBus::RequestMessage {
public:
    inline static const std::string kMessageName = "TagHistorianAsyncUnsubscribeRequest";

    explicit TagHistorianAsyncUnsubscribeRequest(std::optional<JsonStringList> searchPaths);
    // Parses a received body.
    TagHistorianAsyncUnsubscribeRequest(MessageBus::MessageHeaders headers,
                                        const MessageBus::MessageBody& body);

    const std::optional<JsonStringList>& SearchPaths() const { return searchPaths_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("searchPaths", self.searchPaths_);
    }

    std::optional<JsonStringList> searchPaths_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages
