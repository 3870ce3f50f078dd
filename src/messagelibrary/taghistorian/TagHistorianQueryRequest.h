#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RequestMessage.h"
#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/json/Timestamp.h"
#include "messagelibrary/taghistorian/HistorianSortOrder.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages {

// Asks for the stored values of tags between two times, paged and thinned
// out by decimation.
class TagHistorianQueryRequest : public MessageBus::RequestMessage {
public:
    inline static const std::string kMessageName = "TagHistorianQueryRequest";

    TagHistorianQueryRequest(std::optional<JsonStringList> paths, Timestamp startTime,
                             Timestamp endTime, int32_t skip, int32_t take, int32_t decimation,
                             std::optional<HistorianSortOrder> sortOrder);
    // Parses a received body.
    TagHistorianQueryRequest(MessageBus::MessageHeaders headers,
                             const MessageBus::MessageBody& body);

    const std::optional<JsonStringList>& Paths() const { return paths_; }
    const Timestamp& StartTime() const { return startTime_; }
    const Timestamp& EndTime() const { return endTime_; }
    int32_t Skip() const { return skip_; }
    int32_t Take() const { return take_; }
    int32_t Decimation() const { return decimation_; }
    const std::optional<HistorianSortOrder>& SortOrder() const { return sortOrder_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("paths", self.paths_)
            .Field("startTime", self.startTime_)
            .Field("endTime", self.endTime_)
            .Field("skip", self.skip_)
            .Field("take", self.take_)
            .Field("decimation", self.decimation_)
            .Field("sortOrder", self.sortOrder_);
    }

    std::optional<JsonStringList> paths_;
    Timestamp startTime_;
    Timestamp endTime_;
    int32_t skip_ = 0;
    int32_t take_ = 0;
    int32_t decimation_ = 0;
    std::optional<HistorianSortOrder> sortOrder_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages
