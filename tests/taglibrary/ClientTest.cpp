#include <gtest/gtest.h>

#include <set>
#include <thread>

#include "taglibrary/Client.h"

using namespace Korvane::Veldra::TagLibrary;
using Korvane::Veldra::MessageBus::VeldraException;

namespace {

class ClientTest : public ::testing::Test {
protected:
    void SetUp() override {
        errors_ = std::make_shared<Korvane::Veldra::TagIngestion::Errors>();
        errors_->initialize();
        client_ = std::make_unique<Client>(Client::LocalOnly{}, "veldra_master", 1000, true, false, errors_);
    }

    std::shared_ptr<Korvane::Veldra::TagIngestion::Errors> errors_;
    std::unique_ptr<Client> client_;
};

}  // namespace

TEST_F(ClientTest, SessionsOfOnePathShareOneRecord) {
    const auto first = client_->MapTag(3, "a/b", TagDataType::Double);
    const auto second = client_->MapTag(9, "a/b", TagDataType::Int);
    ASSERT_EQ(first, second);
    EXPECT_EQ(first->sessionCount, 2);
    EXPECT_EQ(first->instanceId, 3u);  // an existing record keeps its instance
    EXPECT_EQ(first->dataType, TagDataType::Int);
    EXPECT_NE(first->Reference(), 0u);

    bool last = true;
    std::string error;
    EXPECT_EQ(client_->CloseTag(first, last, error), 0);
    EXPECT_FALSE(last);
    EXPECT_EQ(client_->OpenTagCount(), 1u);
    EXPECT_EQ(client_->CloseTag(first, last, error), 0);
    EXPECT_TRUE(last);
    EXPECT_EQ(client_->OpenTagCount(), 0u);

    // A path opened anew gets a fresh record, which a stale close must not remove.
    const auto reopened = client_->MapTag(3, "a/b", TagDataType::Double);
    EXPECT_NE(reopened, first);
    EXPECT_EQ(client_->CloseTag(first, last, error), 0);
    EXPECT_EQ(client_->OpenTagCount(), 1u);
}

TEST_F(ClientTest, LocalGettersAndNullRecords) {
    const auto tag = client_->MapTag(0, "plant/temp", TagDataType::Boolean);
    int32_t type = -7;
    std::string path, error;
    EXPECT_EQ(client_->GetDataType(tag, type, error), 0);
    EXPECT_EQ(type, 3);
    EXPECT_EQ(client_->GetPath(tag, path, error), 0);
    EXPECT_EQ(path, "plant/temp");

    const auto untyped = client_->MapTag(0, "other", std::nullopt);
    EXPECT_EQ(client_->GetDataType(untyped, type, error), 0);
    EXPECT_EQ(type, -1);

    bool last = false;
    EXPECT_EQ(client_->CloseTag(nullptr, last, error), -251900);
    EXPECT_EQ(error, "Invalid tag reference.");
    error.clear();
    EXPECT_EQ(client_->GetPath(nullptr, path, error), -251900);
    EXPECT_EQ(error, "Invalid tag reference.");
    EXPECT_EQ(client_->GetDataType(nullptr, type, error), -251900);
}

TEST_F(ClientTest, VerboseLinesCarryThePath) {
    client_->SetVerbose(true);
    testing::internal::CaptureStdout();
    const auto tag = client_->MapTag(0, "p/1", TagDataType::Double);
    client_->MapTag(0, "p/1", TagDataType::Double);
    int32_t type = 0;
    std::string path, error;
    client_->GetDataType(tag, type, error);
    client_->GetPath(tag, path, error);
    bool last = false;
    client_->CloseTag(tag, last, error);
    client_->SetVerbose(false);
    client_->CloseTag(tag, last, error);
    EXPECT_EQ(testing::internal::GetCapturedStdout(),
              "Tag data for p/1 is not mapped and will be created.\n"
              "Tag data for p/1 is already mapped and will be updated.\n"
              "Getting DataType for tag: p/1\n"
              "Getting Path for tag: p/1\n"
              "Closing tag session for tag: p/1\n");
}

TEST_F(ClientTest, ReportingForms) {
    std::string error;
    EXPECT_EQ(client_->ReportError("Tag.NoSuchTag", error, {"x"}), -251909);
    EXPECT_EQ(error, "No such tag: 'x'.");
    EXPECT_EQ(client_->ReportException(VeldraException(-251005, "Failed to parse: key"), error),
              -251005);
    EXPECT_EQ(error, "Failed to parse.");
    EXPECT_EQ(client_->ReportUnexpectedException(std::runtime_error("boom"), error), -251037);
    EXPECT_EQ(error, "An unexpected exception occurred: boom");
    EXPECT_EQ(client_->ReportResponseError("Remote.NotKnownHere", {"a"}, error), -251000);
    EXPECT_EQ(error, "");
}

TEST_F(ClientTest, ConcurrentOpensAndClosesBalance) {
    constexpr int kThreads = 4;
    constexpr int kRounds = 500;
    std::vector<std::thread> threads;
    for (int t = 0; t < kThreads; ++t) {
        threads.emplace_back([this, t] {
            std::string error;
            bool last = false;
            for (int i = 0; i < kRounds; ++i) {
                const std::string path = "tag/" + std::to_string((i + t) % 7);
                const auto tag = client_->MapTag(0, path, TagDataType::Double);
                client_->CloseTag(tag, last, error);
            }
        });
    }
    for (auto& thread : threads) thread.join();
    EXPECT_EQ(client_->OpenTagCount(), 0u);
}

TEST(TagData, ReferencesAreUniqueAmongLiveRecordsAndNeverZero) {
    std::vector<std::unique_ptr<TagData>> records;
    std::set<uint32_t> seen;
    for (int i = 0; i < 1000; ++i) {
        records.push_back(std::make_unique<TagData>(0, "p", std::nullopt));
        EXPECT_NE(records.back()->Reference(), 0u);
        EXPECT_TRUE(seen.insert(records.back()->Reference()).second);
    }
}
