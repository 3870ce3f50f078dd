// What the console family does not reach: the Client's multi-path write and
// its synchronous deletion of every tag.
#include <gtest/gtest.h>

#include <map>

#include "client/ClientBrokerSupport.h"

namespace Korvane::Veldra::Testing {
namespace {

using VeldraMessageLibrary::TagCurrentValue;
using VeldraMessageLibrary::TagValue;
using VeldraMessageLibrary::TagValueSample;

TagValueSample IntSample(const std::string& text, int seconds) {
    return TagValueSample{VeldraMessageLibrary::TimestampFromUnixSeconds(seconds),
                          TagValue{TagDataType::Int, text}};
}

// Sends with a fresh request, waits for it, and finishes with `finish`.
template <typename Start, typename Finish>
int32_t Blocking(Start start, Finish finish, std::string& error) {
    const auto request = std::make_shared<ConsoleAsyncRequest>();
    uint32_t id = 0, timeoutMs = 0;
    if (const int32_t status = start(request, id, timeoutMs, error)) return status;
    request->Wait(timeoutMs);
    return finish(id, error);
}

TEST_F(ClientBrokerTest, WriteMultiGroupsByPathAndKeepsEachPathsSamplesInOrder) {
    const auto client = NewClient();
    std::shared_ptr<TagData> a, b;
    std::string error;
    const std::string pathA = UniquePath("multi.a"), pathB = UniquePath("multi.b");
    ASSERT_EQ(Open(*client, pathA, TagDataType::Int, a, error), 0) << error;
    ASSERT_EQ(Open(*client, pathB, TagDataType::Int, b, error), 0) << error;
    const auto finish = [&](uint32_t id, std::string& text) { return client->FinishRequest(id, text); };
    ASSERT_EQ(Blocking([&](auto request, uint32_t& id, uint32_t& timeoutMs,
                           std::string& text) {
                  return client->SetCollectAggregates(a, true, request, id, timeoutMs, text);
              },
                       finish, error),
              0)
        << error;

    ASSERT_EQ(Blocking([&](auto request, uint32_t& id, uint32_t& timeoutMs, std::string& text) {
                  return client->WriteMulti({pathA, pathB, pathA},
                                            {IntSample("1", 1), IntSample("2", 2), IntSample("3", 3)},
                                            request, id, timeoutMs, text);
              },
                       finish, error),
              0)
        << error;

    std::vector<TagCurrentValue> values;
    ASSERT_EQ(Blocking([&](auto request, uint32_t& id, uint32_t& timeoutMs,
                           std::string& text) {
                  return client->ReadValues({a, b}, true, request, id, timeoutMs, text);
              },
                       [&](uint32_t id, std::string& text) {
                           return client->FinishReadValues(id, values, text);
                       },
                       error),
              0)
        << error;
    std::map<std::string, TagCurrentValue> byPath;
    for (const auto& value : values) byPath[value.path.value_or("")] = value;
    ASSERT_EQ(byPath.size(), 2u);
    // Both samples of a arrived, 1 before 3.
    EXPECT_EQ(byPath[pathA].current->value->value, "3");
    ASSERT_TRUE(byPath[pathA].aggregates);
    EXPECT_EQ(byPath[pathA].aggregates->count, 2);
    EXPECT_EQ(byPath[pathA].aggregates->min, "1");
    EXPECT_EQ(byPath[pathB].current->value->value, "2");

    // A sample list shorter than the paths is refused before anything goes out.
    uint32_t id = 0, timeoutMs = 0;
    EXPECT_EQ(client->WriteMulti({pathA, pathB}, {IntSample("4", 4)},
                                 std::make_shared<ConsoleAsyncRequest>(), id, timeoutMs, error),
              -251914);
    EXPECT_EQ(client->RequestMap()->Size(), 0u);
}

TEST_F(ClientBrokerTest, DeleteAllTagsEmptiesTheServiceAndLeavesTheLocalRecords) {
    const auto client = NewClient();
    std::shared_ptr<TagData> tag;
    std::string error;
    ASSERT_EQ(Open(*client, UniquePath("all.one"), TagDataType::Double, tag, error), 0) << error;
    ASSERT_EQ(Open(*client, UniquePath("all.two"), TagDataType::String, tag, error), 0) << error;

    ASSERT_EQ(client->DeleteAllTags(error), 0) << error;
    EXPECT_EQ(client->OpenTagCount(), 2u);

    std::vector<std::shared_ptr<TagData>> listed;
    int32_t total = -1;
    ASSERT_EQ(Blocking([&](auto request, uint32_t& id, uint32_t& timeoutMs, std::string& text) {
                  return client->ListTags({"*"}, {}, {}, 0, 100, true, request, id, timeoutMs,
                                          text);
              },
                       [&](uint32_t id, std::string& text) {
                           return client->FinishListTags(7, id, listed, total, text);
                       },
                       error),
              0)
        << error;
    EXPECT_EQ(total, 0);
    EXPECT_TRUE(listed.empty());
}

}  // namespace
}  // namespace Korvane::Veldra::Testing
