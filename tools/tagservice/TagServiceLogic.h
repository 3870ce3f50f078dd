#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <vector>

#include "ServiceErrors.h"
#include "TagStore.h"
#include "messagelibrary/MessageBase.h"
#include "messagelibrary/MessageError.h"
#include "messagelibrary/tagcurrentvalue/TagCvQueryCurrentValuesByPathRequest.h"
#include "messagelibrary/tagcurrentvalue/TagCvResetAggregatesRoutedMessage.h"
#include "messagelibrary/taginfo/TagInfoCreateOrUpdateTagsRequest.h"
#include "messagelibrary/taginfo/TagInfoCreateTagRoutedMessage.h"
#include "messagelibrary/taginfo/TagInfoDeleteTagsRoutedMessage.h"
#include "messagelibrary/taginfo/TagInfoQueryTagsRequest.h"
#include "messagelibrary/taginfo/TagInfoUpdateTagRoutedMessage.h"
#include "messagelibrary/tagingestion/TagUpdateValuesRoutedMessage.h"

namespace Korvane::Veldra::TagService {

namespace TagInfo = VeldraMessageLibrary::TagInfoMessages;
namespace TagCv = VeldraMessageLibrary::TagCurrentValueMessages;
namespace TagIngest = VeldraMessageLibrary::TagIngestionMessages;
using VeldraMessageLibrary::TagCurrentValue;
using VeldraMessageLibrary::Timestamp;
using Broadcasts = std::vector<std::shared_ptr<MessageBus::MessageBase>>;

// The outcome of a routed message: its error, if it failed, and the
// broadcasts to send once it is answered.
struct Outcome {
    std::optional<MessageBus::MessageError> error;
    Broadcasts broadcasts;
};

// One page of a tag query and the count of all matches.
struct TagPage {
    std::vector<TagRecord> tags;
    int32_t totalCount = 0;
};

// The outcome of a create-or-update: the failures of single changes in one
// aggregate record, absent when every change went through.
struct ChangeOutcome {
    std::optional<ErrorRecord> errors;
    Broadcasts broadcasts;
};

// The rules of the three tag services over a store. Each operation takes a
// parsed message, reads the store, and writes what it changed as one batch
// before it returns; a message that fails changes nothing, except where a
// create-or-update applies its good changes. Not thread-safe.
class TagServiceLogic {
public:
    using Clock = std::function<Timestamp()>;

    // clock gives the receive time of samples that come without one.
    explicit TagServiceLogic(TagStore& store, Clock clock = UtcNow);

    // ---- TagInfo ----
    TagPage QueryTags(const TagInfo::TagInfoQueryTagsRequest& request) const;
    Outcome CreateTag(const TagInfo::TagInfoCreateTagRoutedMessage& message);
    ChangeOutcome CreateOrUpdateTags(const TagInfo::TagInfoCreateOrUpdateTagsRequest& request);
    Outcome UpdateTag(const TagInfo::TagInfoUpdateTagRoutedMessage& message);
    Outcome DeleteTags(const TagInfo::TagInfoDeleteTagsRoutedMessage& message);

    // ---- TagIngestion ----
    Outcome UpdateValues(const TagIngest::TagUpdateValuesRoutedMessage& message);

    // ---- TagCurrentValue ----
    std::vector<TagCurrentValue> QueryCurrentValues(
        const TagCv::TagCvQueryCurrentValuesByPathRequest& request) const;
    Outcome ResetAggregates(const TagCv::TagCvResetAggregatesRoutedMessage& message);

    static Timestamp UtcNow();

private:
    TagStore& store_;
    Clock clock_;
};

// The current value of a tag as a reply gives it: no "current" before the
// first write, aggregates only where a numeric tag collects them.
TagCurrentValue CurrentValueOf(const StoredTag& tag);

}  // namespace Korvane::Veldra::TagService
