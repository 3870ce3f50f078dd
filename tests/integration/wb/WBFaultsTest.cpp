// What a host sees when things go wrong: a reply that does not come, a
// signal it gave up, memory or variant calls that fail, and many requests
// from several threads at once.
#include <cstdlib>
#include <thread>

#include "wb/WBTestSupport.h"

namespace Korvane::Veldra::Testing {
namespace {

TEST_F(WBBrokerTest, AFinishAfterTheWaitRanOutReportsATimeOut) {
    const uint32_t reference = Open(UniquePath("away"), kDouble);
    StopService();
    HostString error;
    Pending read;
    ASSERT_EQ(TagWBRead(reference, &read.id, &read.timeoutMs, &read.signal, &error.handle), 0);
    EXPECT_EQ(WBWaitSignal(read.signal, 50), 0);  // the host stops waiting early
    HostVariant value;
    WBTimestamp time{};
    WBAggregates aggregates{};
    EXPECT_EQ(TagWBFinishRead(reference, kDouble, read.id, &value.variant, &time, &aggregates, &error.handle),
              kRequestTimedOut);
    EXPECT_EQ(error.Text(), "Request timed out.");
    // The request is gone: a second finish of its id is a state error.
    EXPECT_EQ(TagWBFinishRequestSession(reference, read.id, &error.handle), kInvalidState);
    StartService();
    Write(reference, kDouble, "1.5", 0);
    EXPECT_EQ(ReadText(reference, kDouble), "1.5");
    Close(reference);
}

TEST_F(WBBrokerTest, AReplyToASignalTheHostFreedErasesTheRequest) {
    const uint32_t reference = Open(UniquePath("freed"), kInt);
    HostString error;
    // The reply may in principle beat the free; such a round is repeated.
    bool freedFirst = false;
    for (int attempt = 0; attempt < 5 && !freedFirst; ++attempt) {
        Pending read;
        ASSERT_EQ(TagWBRead(reference, &read.id, &read.timeoutMs, &read.signal, &error.handle), 0);
        freedFirst = WBWaitSignal(read.signal, 0) == 0;
        ASSERT_EQ(WBFreeSignal(read.signal), 0);
        ASSERT_EQ(WBWaitFireAttempt(read.signal, read.timeoutMs), 1);
        if (!freedFirst) {
            TagWBFinishRequestSession(reference, read.id, &error.handle);
            continue;
        }
        HostString value;
        WBTimestamp time{};
        WBAggregates2 aggregates{};
        EXPECT_EQ(TagWBFinishRead2(reference, kInt, read.id, &value.handle, &time, &aggregates, &error.handle),
                  kInvalidState);
        EXPECT_EQ(error.Text(), "Invalid state.");
    }
    EXPECT_TRUE(freedFirst);
    Close(reference);
}

// Starts `start(pending)`, waits, then fails the next allocation or variant
// call and runs `finish(pending)`.
template <typename Start, typename Finish>
int32_t FinishStarved(Start start, Finish finish, bool variantCall = false) {
    Pending pending;
    EXPECT_EQ(start(pending), 0);
    EXPECT_TRUE(Await(pending));
    if (variantCall) {
        WbVariantFailNextCalls(1, 42);
    } else {
        WBFailNextAllocations(1);
    }
    const int32_t status = finish(pending);
    WBFailNextAllocations(0);
    WbVariantFailNextCalls(0, 0);
    return status;
}

TEST_F(WBBrokerTest, OutOfMemoryAtEachKindOfHandleGivesTwoAndAVariantFailureItsStatus) {
    const std::string stem = UniquePath("starved");
    const uint32_t reference = Open(stem, kDouble);
    Write(reference, kDouble, "2.5", 1795000000000000);
    HostString error;
    const auto read = [&](Pending& p) {
        return TagWBRead(reference, &p.id, &p.timeoutMs, &p.signal, &error.handle);
    };
    WBTimestamp time{};

    HostString text;
    WBAggregates2 textAggregates{};
    EXPECT_EQ(FinishStarved(read, [&](Pending& p) {
                  return TagWBFinishRead2(reference, kDouble, p.id, &text.handle, &time, &textAggregates,
                                          &error.handle);
              }),
              2);
    HostVariant value;
    WBAggregates aggregates{};
    EXPECT_EQ(FinishStarved(
                  read,
                  [&](Pending& p) {
                      return TagWBFinishRead(reference, kDouble, p.id, &value.variant, &time, &aggregates,
                                             &error.handle);
                  },
                  true),
              42);
    EXPECT_EQ(error.handle, nullptr);  // a host status comes with no text

    HostArray<WBStrArray> keywords;
    EXPECT_EQ(FinishStarved(
                  [&](Pending& p) {
                      return TagWBGetKeywords(reference, &p.id, &p.timeoutMs, &p.signal, &error.handle);
                  },
                  [&](Pending& p) { return TagWBFinishGetKeywords(reference, p.id, keywords.Out(), &error.handle); }),
              2);
    HostArray<WBPropertyArray> properties;
    EXPECT_EQ(FinishStarved(
                  [&](Pending& p) {
                      return TagWBGetProperties(reference, &p.id, &p.timeoutMs, &p.signal, &error.handle);
                  },
                  [&](Pending& p) {
                      return TagWBFinishGetProperties(reference, p.id, properties.Out(), &error.handle);
                  }),
              2);
    HostArray<WBReferenceArray> one({reference});
    bool anyInvalid = false;
    HostArray<WBValueArray> values;
    EXPECT_EQ(FinishStarved(
                  [&](Pending& p) {
                      return TagWBReadMulti(0, one.Get(), &anyInvalid, &p.id, &p.timeoutMs, &p.signal,
                                            &error.handle);
                  },
                  [&](Pending& p) { return TagWBFinishReadMulti(0, p.id, &anyInvalid, values.Out(), &error.handle); }),
              2);

    // A list that cannot deliver its references gives their sessions back:
    // the open's close is then the last.
    HostArray<WBStrArray> paths(NewHostStrings({stem}));
    HostArray<WBTypeArray> types;
    HostArray<WBStrArray> listed;
    HostArray<WBReferenceArray> references;
    uint32_t total = 0;
    EXPECT_EQ(FinishStarved(
                  [&](Pending& p) {
                      return TagWBList(0, paths.Get(), nullptr, nullptr, &p.id, &p.timeoutMs, &p.signal,
                                       &error.handle);
                  },
                  [&](Pending& p) {
                      return TagWBFinishList2(0, p.id, types.Out(), listed.Out(), references.Out(), &total,
                                              &error.handle);
                  }),
              2);
    Close(reference);
    EXPECT_EQ(TagWBClose(reference, &error.handle), kInvalidTagReference);
}

TEST_F(WBBrokerTest, ManyRequestsInFlightFromSeveralHostThreads) {
    constexpr int kThreads = 4;
    constexpr int kRequests = 25;
    std::vector<uint32_t> tags;
    for (int t = 0; t < kThreads; ++t) tags.push_back(Open(UniquePath("thread" + std::to_string(t)), kInt));
    std::vector<std::thread> threads;
    for (int t = 0; t < kThreads; ++t) {
        threads.emplace_back([&, t] {
            const uint32_t reference = tags[t];
            HostString error;
            std::vector<Pending> writes(kRequests);
            for (int i = 0; i < kRequests; ++i) {  // all in flight before any finish
                HostArray<WBStrArray> values(NewHostStrings({std::to_string(t * 1000 + i)}));
                EXPECT_EQ(TagWBWrite2(reference, kInt, values.Get(), nullptr, &writes[i].id, &writes[i].timeoutMs,
                                      &writes[i].signal, &error.handle),
                          0);
            }
            for (auto it = writes.rbegin(); it != writes.rend(); ++it) {  // finished in reverse
                EXPECT_TRUE(Await(*it));
                EXPECT_EQ(TagWBFinishRequestSession(reference, it->id, &error.handle), 0) << error.Text();
            }
            std::vector<Pending> reads(kRequests);
            for (auto& read : reads) {
                EXPECT_EQ(TagWBRead(reference, &read.id, &read.timeoutMs, &read.signal, &error.handle), 0);
            }
            for (auto& read : reads) {
                EXPECT_TRUE(Await(read));
                HostString value;
                WBTimestamp time{};
                WBAggregates2 aggregates{};
                EXPECT_EQ(TagWBFinishRead2(reference, kInt, read.id, &value.handle, &time, &aggregates,
                                           &error.handle),
                          0);
                // One of this thread's own values: the service may take the
                // writes in any order, but no reply goes to another thread.
                const int written = std::atoi(value.Text().c_str());
                EXPECT_EQ(written / 1000, t) << value.Text();
                EXPECT_LT(written % 1000, kRequests) << value.Text();
                DisposeElement(aggregates.max);
                DisposeElement(aggregates.min);
            }
        });
    }
    for (auto& thread : threads) thread.join();
    for (uint32_t reference : tags) Close(reference);
}

}  // namespace
}  // namespace Korvane::Veldra::Testing
