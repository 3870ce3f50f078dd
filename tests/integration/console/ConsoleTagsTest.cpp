// Opening, listing and closing through the exported console functions.
#include <algorithm>
#include <set>

#include "console/ConsoleTestSupport.h"

namespace Korvane::Veldra::Testing {
namespace {

TEST_F(ConsoleBrokerTest, OnePathOpenedTwiceIsOneReferenceThatTakesTwoCloses) {
    const std::string path = UniquePath("twice");
    const uint32_t first = Open(path, kDouble);
    const uint32_t second = Open(path, kDouble);
    EXPECT_EQ(first, second);

    Close(first);
    std::string answer, error;
    EXPECT_EQ(TagConsoleGetPath(first, false, &answer, &error), 0) << error;
    EXPECT_EQ(answer, path);
    Close(first);
    EXPECT_EQ(TagConsoleGetPath(first, false, &answer, &error), kInvalidTagReference);
    EXPECT_EQ(error, "Invalid tag reference.");
}

TEST_F(ConsoleBrokerTest, OpenRefusesAConflictingTypeAndAStarredPath) {
    const std::string path = UniquePath("conflict");
    const uint32_t reference = Open(path, kDouble);
    const std::string starred = path + "*";
    for (const auto& [tried, type, expected] :
         {std::tuple{path, kInt, -251907}, std::tuple{starred, kDouble, -251904}}) {
        uint32_t other = 0;
        std::string error;
        EXPECT_EQ(TagConsoleOpen(0, &tried, type, false, &other, &error), expected) << tried;
        EXPECT_EQ(other, 0u);
    }
    Close(reference);
}

TEST_F(ConsoleBrokerTest, AListPagesItsMatchesAndOpensEachOneItGives) {
    const std::string prefix = UniquePath("page");
    std::set<std::string> created;
    for (int i = 0; i < 25; ++i) {
        const std::string path = prefix + "." + std::to_string(i);
        Close(Open(path, i % 2 == 0 ? kDouble : kString));
        created.insert(path);
    }

    const std::vector<std::string> search{prefix + ".*"};
    const TagConsoleProperties noProperties;
    const std::vector<std::string> noKeywords;
    std::set<std::string> listed;
    for (const auto& [skip, expectedSize] : {std::pair{0u, 10u}, {10u, 10u}, {20u, 5u}}) {
        std::vector<int32_t> types{99};
        std::vector<std::string> paths{"left over"};
        std::vector<uint32_t> references;
        uint32_t total = 0;
        std::string error;
        ASSERT_EQ(TagConsoleListTag(0, &search, &noProperties, &noKeywords, skip, 10, true, false,
                                    &types, &paths, &references, &total, &error),
                  0)
            << error;
        EXPECT_EQ(total, 25u);
        ASSERT_EQ(paths.size(), expectedSize);
        ASSERT_EQ(types.size(), expectedSize);
        ASSERT_EQ(references.size(), expectedSize);
        for (std::size_t i = 0; i < paths.size(); ++i) {
            const bool even = std::stoi(paths[i].substr(prefix.size() + 1)) % 2 == 0;
            EXPECT_EQ(types[i], even ? kDouble : kString) << paths[i];
            std::string path, error2;
            EXPECT_EQ(TagConsoleGetPath(references[i], false, &path, &error2), 0);
            EXPECT_EQ(path, paths[i]);
            listed.insert(paths[i]);
            Close(references[i]);
        }
    }
    EXPECT_EQ(listed, created);
}

TEST_F(ConsoleBrokerTest, TwoListsAndAnOpenOfOneTagTakeThreeCloses) {
    const std::string path = UniquePath("thrice");
    Close(Open(path, kInt));
    const std::vector<std::string> search{path};
    const TagConsoleProperties noProperties;
    const std::vector<std::string> noKeywords;
    uint32_t reference = 0;
    for (int list = 0; list < 2; ++list) {
        std::vector<int32_t> types;
        std::vector<std::string> paths;
        std::vector<uint32_t> references;
        uint32_t total = 0;
        std::string error;
        ASSERT_EQ(TagConsoleListTag(0, &search, &noProperties, &noKeywords, 0, 10, true, false,
                                    &types, &paths, &references, &total, &error),
                  0)
            << error;
        ASSERT_EQ(references.size(), 1u);
        reference = references.front();
    }
    EXPECT_EQ(Open(path, kInt), reference);

    Close(reference, 3);
    std::string error;
    EXPECT_EQ(TagConsoleClose(reference, false, &error), kInvalidTagReference);
}

TEST_F(ConsoleBrokerTest, NullOutArgumentsGiveOneAndUnknownInstancesAreRefused) {
    const std::string path = UniquePath("null");
    std::string error;
    EXPECT_EQ(TagConsoleOpen(0, &path, kDouble, false, nullptr, &error), 1);
    EXPECT_EQ(TagConsoleOpen(0, nullptr, kDouble, false, nullptr, &error), 1);
    uint32_t reference = 0;
    EXPECT_EQ(TagConsoleOpen(4242, &path, kDouble, false, &reference, &error),
              kInvalidTagReference);
    EXPECT_EQ(TagConsoleReadValues(0, nullptr, false, 0, nullptr, &error), 1);
}

}  // namespace
}  // namespace Korvane::Veldra::Testing
