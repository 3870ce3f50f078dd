#include <gtest/gtest.h>
#include <filesystem>
#include <memory>

#include "MemoryTagStore.h"
#include "SqliteTagStore.h"
#include "StoredTagJson.h"
#include "support/ScratchDirectory.h"

namespace Korvane::Veldra::TagService {
namespace {

namespace Tags = VeldraMessageLibrary;

StoredTag Tag(const std::string& path, Tags::TagDataType type) {
    StoredTag tag;
    tag.record = TagRecord{path, type, Tags::JsonStringMap{{"k", "v \"q\""}},
                           Tags::JsonStringList{"w"}, true};
    return tag;
}

// A store file in a scratch directory.
class ScratchFile {
public:
    std::string Path() const { return directory_.Path() + "/tags.db"; }

private:
    Testing::ScratchDirectory directory_{"kvts"};
};

// Both stores keep the same contract.
class TagStoreTest : public ::testing::TestWithParam<bool> {
protected:
    std::unique_ptr<TagStore> Open() {
        if (GetParam()) return std::make_unique<SqliteTagStore>(file_.Path());
        return std::make_unique<MemoryTagStore>();
    }
    ScratchFile file_;
};

TEST_P(TagStoreTest, ABatchPutsAndErasesAndReadsComeInPathOrder) {
    auto store = Open();
    StoreBatch first;
    first.put = {Tag("b", Tags::TagDataType::Int), Tag("a", Tags::TagDataType::Double),
                 Tag("c", Tags::TagDataType::String)};
    store->Apply(first);
    StoreBatch second;
    second.erase = {"c", "never"};
    StoredTag changed = Tag("a", Tags::TagDataType::Double);
    changed.current = Tags::TagValueSample{Tags::Timestamp(boost::gregorian::date(2001, 2, 3)),
                                           Tags::TagValue{Tags::TagDataType::Double, "1.25"}};
    changed.aggregates = TagAggregates{2, 0.5, std::string("-1"), std::string("2")};
    second.put = {changed};
    store->Apply(second);

    std::vector<std::string> paths;
    store->ForEach([&](const StoredTag& tag) { paths.push_back(tag.Path()); });
    EXPECT_EQ(paths, (std::vector<std::string>{"a", "b"}));
    EXPECT_EQ(store->Find("c"), nullptr);
    ASSERT_NE(store->Find("a"), nullptr);
    EXPECT_EQ(store->Find("a")->current->value->value, "1.25");
    EXPECT_EQ(store->Find("a")->aggregates.max, "2");
}

INSTANTIATE_TEST_SUITE_P(MemoryAndSqlite, TagStoreTest, ::testing::Values(false, true),
                         [](const auto& info) { return info.param ? "Sqlite" : "Memory"; });

TEST(SqliteTagStoreTest, AReopenedFileReadsBackWhatItWasGiven) {
    ScratchFile file;
    StoredTag tag = Tag("p.\xc3\xa9", Tags::TagDataType::UInt64);
    tag.current = Tags::TagValueSample{
        Tags::Timestamp(boost::gregorian::date(2001, 2, 3), boost::posix_time::microseconds(7)),
        Tags::TagValue{Tags::TagDataType::UInt64, "18446744073709551615"}};
    tag.aggregates = TagAggregates{3, 1.0 / 3.0, std::string("0"), std::string("9")};
    {
        auto store = std::make_unique<SqliteTagStore>(file.Path());
        StoreBatch batch;
        batch.put = {tag, Tag("gone", Tags::TagDataType::Int)};
        store->Apply(batch);
        StoreBatch erase;
        erase.erase = {"gone"};
        store->Apply(erase);
    }
    auto reopened = std::make_unique<SqliteTagStore>(file.Path());
    EXPECT_EQ(reopened->Find("gone"), nullptr);
    const StoredTag* read = reopened->Find(tag.Path());
    ASSERT_NE(read, nullptr);
    EXPECT_EQ(StoredTagToJson(*read), StoredTagToJson(tag));
    EXPECT_EQ(read->aggregates.avg, 1.0 / 3.0);
    EXPECT_EQ(read->current->timestamp, tag.current->timestamp);
}

// The times a message can carry; +infinity cannot, its text reads back as
// the last microsecond of 9999.
TEST(StoredTagJsonTest, ExtremeTimesReadBack) {
    using boost::posix_time::ptime;
    for (const Tags::Timestamp time :
         {ptime(boost::posix_time::neg_infin),
          ptime(boost::gregorian::date(9999, 12, 31), boost::posix_time::microseconds(86399999999)),
          ptime(boost::gregorian::date(1400, 1, 1))}) {
        StoredTag tag = Tag("t", Tags::TagDataType::DateTime);
        tag.current = Tags::TagValueSample{time, Tags::TagValue{Tags::TagDataType::DateTime, "x"}};
        const StoredTag read = StoredTagFromJson(StoredTagToJson(tag));
        EXPECT_EQ(StoredTagToJson(read), StoredTagToJson(tag));
    }
}

TEST(SqliteTagStoreTest, ASecondStoreOnAFileInUseIsRefused) {
    ScratchFile file;
    SqliteTagStore first(file.Path());
    EXPECT_THROW(SqliteTagStore second(file.Path()), StoreError);
    StoreBatch batch;
    batch.put = {Tag("still", Tags::TagDataType::Int)};
    first.Apply(batch);
    EXPECT_NE(first.Find("still"), nullptr);
}

TEST(SqliteTagStoreTest, AFileThatIsNotAStoreIsRefusedWithItsReason) {
    ScratchFile file;
    {
        SqliteDatabase db(file.Path());
        db.Execute("CREATE TABLE tags (path TEXT PRIMARY KEY NOT NULL, body TEXT NOT NULL)");
        db.Execute("INSERT INTO tags VALUES ('x', '{\"tag\":{\"path\":\"x\"}}')");
    }
    try {
        SqliteTagStore store(file.Path());
        FAIL() << "a row without a type was read";
    } catch (const StoreError& error) {
        EXPECT_NE(std::string(error.what()).find("'x'"), std::string::npos) << error.what();
    }
    EXPECT_THROW(SqliteTagStore(file.Path() + ".d/none/tags.db"), StoreError);
}

}  // namespace
}  // namespace Korvane::Veldra::TagService
