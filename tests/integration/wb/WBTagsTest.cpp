// Opening and listing tags as a host diagram does: start, wait on the
// signal, finish.
#include "support/BusSniffer.h"
#include "wb/WBTestSupport.h"

namespace Korvane::Veldra::Testing {
namespace {

TEST_F(WBBrokerTest, AnOpenTakesTwoWaitsForANewPathAndOneForAnExistingOne) {
    const std::string path = UniquePath("open");
    const uint32_t created = Open(path, kInt);
    int32_t type = -1;
    HostString error;
    EXPECT_EQ(TagWBGetDataType(created, &type, &error.handle), 0);
    EXPECT_EQ(type, kInt);

    // Now the lookup finds it: no create, no new signal, the same reference.
    HostString text(path);
    Pending lookup;
    ASSERT_EQ(TagWBLookupTag(0, &text.handle, &lookup.id, &lookup.timeoutMs, &lookup.signal, &error.handle), 0);
    EXPECT_GT(lookup.timeoutMs, 0u);
    ASSERT_TRUE(Await(lookup));
    bool found = false;
    uint32_t reference = 0;
    Pending create{lookup.id, 0, 0};
    ASSERT_EQ(TagWBOpenOrCreate(0, &text.handle, kInt, &found, &reference, &create.id, &create.timeoutMs,
                                &create.signal, &error.handle),
              0)
        << error.Text();
    EXPECT_TRUE(found);
    EXPECT_EQ(reference, created);
    EXPECT_EQ(create.signal, 0u);

    // Another type for the same path is refused at the evaluation.
    ASSERT_EQ(TagWBLookupTag(0, &text.handle, &lookup.id, &lookup.timeoutMs, &lookup.signal, &error.handle), 0);
    ASSERT_TRUE(Await(lookup));
    EXPECT_EQ(TagWBOpenOrCreate(0, &text.handle, kString, &found, &reference, &lookup.id, &lookup.timeoutMs,
                                &lookup.signal, &error.handle),
              kConflictingTagTypes);
    EXPECT_EQ(error.Text(), "Conflicting types for tag '" + path + "': 'String' != 'Int'.");

    // A starred path never leaves; a missing out-pointer is 1 and no text.
    HostString starred("a.*"), untouched;
    EXPECT_EQ(TagWBLookupTag(0, &starred.handle, &lookup.id, &lookup.timeoutMs, &lookup.signal, &error.handle),
              -251904);
    EXPECT_EQ(TagWBLookupTag(0, &text.handle, &lookup.id, nullptr, &lookup.signal, &untouched.handle), 1);
    EXPECT_EQ(untouched.handle, nullptr);
    Close(created);
    Close(created);
}

TEST_F(WBBrokerTest, AListDeliversOpenReferencesAndTheDefaultsGoOnTheWire) {
    const std::string stem = UniquePath("list");
    const uint32_t first = Open(stem + ".a", kDouble);
    const uint32_t second = Open(stem + ".b", kString);

    HostArray<WBStrArray> paths(NewHostStrings({stem + ".*"})), keywords;
    HostArray<WBPropertyArray> properties({WBProperty{nullptr, NewHostString("skipped")}});
    HostString error;
    Pending list;
    ASSERT_EQ(TagWBList2(0, paths.Get(), properties.Get(), keywords.Get(), 0, 10, &list.id, &list.timeoutMs,
                         &list.signal, &error.handle),
              0);
    ASSERT_TRUE(Await(list));
    HostArray<WBTypeArray> types;
    HostArray<WBStrArray> listed;
    HostArray<WBReferenceArray> references;
    uint32_t total = 0;
    ASSERT_EQ(TagWBFinishList2(0, list.id, types.Out(), listed.Out(), references.Out(), &total, &error.handle), 0)
        << error.Text();
    ASSERT_EQ(total, 2u);
    ASSERT_EQ(listed.Size(), 2u);
    EXPECT_EQ(Text(listed[0]), stem + ".a");
    EXPECT_EQ(Text(listed[1]), stem + ".b");
    EXPECT_EQ(types[0], kDouble);
    EXPECT_EQ(types[1], kString);
    EXPECT_EQ(references[0], first);
    EXPECT_EQ(references[1], second);
    // The reference array keeps the room of two numbers a tag.
    EXPECT_EQ(WBHandleSize(reinterpret_cast<WBHandle>(references.Get())), 4u + 2 * 8u);

    // An empty path array goes as "*", and TagWBList pages 0 and 1000.
    BusSniffer sniffer;
    ASSERT_TRUE(sniffer.Ready());
    HostArray<WBStrArray> none;
    ASSERT_EQ(TagWBList(0, none.Get(), nullptr, nullptr, &list.id, &list.timeoutMs, &list.signal, &error.handle),
              0);
    const std::string body = sniffer.WaitForBody("\"searchPaths\"", std::chrono::milliseconds(list.timeoutMs));
    EXPECT_NE(body.find("\"searchPaths\":[\"*\"]"), std::string::npos) << body;
    EXPECT_NE(body.find("\"skip\":0"), std::string::npos) << body;
    EXPECT_NE(body.find("\"take\":1000"), std::string::npos) << body;
    ASSERT_TRUE(Await(list));
    HostArray<WBTypeArray> allTypes;
    HostArray<WBStrArray> allPaths;
    HostArray<WBReferenceArray> allReferences;
    ASSERT_EQ(TagWBFinishList(0, list.id, allTypes.Out(), allPaths.Out(), allReferences.Out(), &error.handle), 0);
    EXPECT_GE(allPaths.Size(), 2u);
    for (std::size_t i = 0; i < allReferences.Size(); ++i) Close(allReferences[i]);

    for (uint32_t reference : {first, second}) {
        Close(reference);  // the list's session
        Close(reference);  // the open's
        EXPECT_EQ(TagWBClose(reference, &error.handle), kInvalidTagReference);
    }
}

}  // namespace
}  // namespace Korvane::Veldra::Testing
