#pragma once

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "MemoryTagStore.h"
#include "TagServiceLogic.h"

namespace Korvane::Veldra::TagService::Testing {

namespace Tags = VeldraMessageLibrary;
using Tags::JsonStringList;
using Tags::JsonStringMap;
using Tags::TagDataType;

// The rules over a store in memory, with a fixed receive time.
class TagServiceLogicFixture : public ::testing::Test {
protected:
    static Timestamp ReceiveTime() {
        return Timestamp(boost::gregorian::date(2030, 5, 6), boost::posix_time::hours(7));
    }

    TagRecord Record(const std::string& path, TagDataType type, bool collect = false,
                     std::optional<JsonStringList> keywords = std::nullopt,
                     std::optional<JsonStringMap> properties = std::nullopt) {
        return TagRecord{path, type, std::move(properties), std::move(keywords), collect};
    }
    // Creates the tag and expects success.
    void Create(const TagRecord& record) {
        const Outcome outcome = logic.CreateTag(TagInfo::TagInfoCreateTagRoutedMessage(record));
        ASSERT_FALSE(outcome.error) << outcome.error->FullName();
    }
    std::optional<std::string> ErrorOf(const Outcome& outcome) {
        return outcome.error ? std::optional<std::string>(outcome.error->FullName())
                             : std::nullopt;
    }
    TagPage Query(std::optional<JsonStringList> paths, int32_t skip = 0, int32_t take = 0,
                  std::optional<JsonStringMap> properties = std::nullopt,
                  std::optional<JsonStringList> keywords = std::nullopt) {
        return logic.QueryTags(TagInfo::TagInfoQueryTagsRequest(
            std::move(paths), std::move(properties), std::move(keywords), skip, take, false));
    }
    std::vector<std::string> Paths(const TagPage& page) {
        std::vector<std::string> paths;
        for (const auto& tag : page.tags) paths.push_back(*tag.path);
        return paths;
    }
    Outcome Write(std::vector<Tags::TagPathUpdates> updates) {
        return logic.UpdateValues(TagIngest::TagUpdateValuesRoutedMessage(std::move(updates)));
    }
    static Tags::TagValueSample Sample(const std::string& text, Timestamp time = Timestamp()) {
        return Tags::TagValueSample{time, Tags::TagValue{TagDataType::Double, text}};
    }
    std::vector<TagCurrentValue> Read(const JsonStringList& paths) {
        return logic.QueryCurrentValues(TagCv::TagCvQueryCurrentValuesByPathRequest(paths, false));
    }

    MemoryTagStore store;
    TagServiceLogic logic{store, &TagServiceLogicFixture::ReceiveTime};
};

}  // namespace Korvane::Veldra::TagService::Testing
