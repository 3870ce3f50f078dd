#pragma once

#include <optional>
#include <string>
#include <vector>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RequestMessage.h"
#include "messagelibrary/taghistorian/HistorianRecords.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages {

// Changes properties and expiration dates of stored values of one tag.
class TagHistorianUpdateValuesRequest : public MessageBus::RequestMessage {
public:
    inline static const std::string kMessageName = "TagHistorianUpdateValuesRequest";

    TagHistorianUpdateValuesRequest(std::optional<std::string> path,
                                    std::optional<std::vector<HistorianValueUpdate>> values);
    // Parses a received body.
    TagHistorianUpdateValuesRequest(MessageBus::MessageHeaders headers,
                                    const MessageBus::MessageBody& body);

    const std::optional<std::string>& Path() const { return path_; }
    const std::optional<std::vector<HistorianValueUpdate>>& Values() const { return values_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("path", self.path_).Field("values", self.values_);
    }

    std::optional<std::string> path_;
    std::optional<std::vector<HistorianValueUpdate>> values_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages
