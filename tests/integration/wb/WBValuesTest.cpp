// Writing and reading values in the host's forms: variants, text and
// 128-bit timestamps.
#include <chrono>
#include <cmath>
#include <tuple>

#include "support/BusSniffer.h"
#include "wb/WBTestSupport.h"

namespace Korvane::Veldra::Testing {
namespace {

int64_t NowMicros() {
    return std::chrono::duration_cast<std::chrono::microseconds>(
               std::chrono::system_clock::now().time_since_epoch())
        .count();
}

// Starts a write through variants; the status of the request function.
int32_t StartVariantWrite(uint32_t reference, int32_t type, const std::vector<WbVariant*>& variants,
                          WBTimestampArrayHandle timestamps, Pending& write, HostString& error) {
    HostArray<WBVariantArray> values(variants);  // owns the variants from here
    return TagWBWrite(reference, type, values.Get(), timestamps, &write.id, &write.timeoutMs, &write.signal,
                      &error.handle);
}

WbVariant* TextVariant(const std::string& text) {
    WbVariant* variant = WbVariantNew();
    // The variant takes the handle over.
    WbVariantSetLStr(variant, NewHostString(text));
    return variant;
}

TEST_F(WBBrokerTest, EveryTypeIsWrittenAsTextAndTheFourVariantTypesAsVariants) {
    struct Case {
        int32_t type;
        std::string text;
        WbVariant* (*variant)();  // null: the type cannot go as a variant
    };
    const Case cases[] = {
        {kDouble, "0.10000000000000001", [] { WbVariant* v = WbVariantNew(); WbVariantSetDBL(v, 0.1); return v; }},
        {kInt, "-2147483648", [] { WbVariant* v = WbVariantNew(); WbVariantSetI32(v, INT32_MIN); return v; }},
        {kString, "h\xC3\xA5st \"x\"", [] { return TextVariant("h\xC3\xA5st \"x\""); }},
        {kBoolean, "True", [] { WbVariant* v = WbVariantNew(); WbVariantSetBool(v, 7); return v; }},
        {kUInt64, "18446744073709551615", nullptr},
        {kDateTime, "2026-11-23T12:34:56.123456Z", nullptr},
    };
    int64_t micros = 1795000000123456;
    for (const Case& c : cases) {
        SCOPED_TRACE(c.text);
        const uint32_t reference = Open(UniquePath("type" + std::to_string(c.type)), c.type);
        Write(reference, c.type, c.text, ++micros);
        WBTimestamp time{};
        EXPECT_EQ(ReadText(reference, c.type, &time), c.text);
        EXPECT_EQ(UnixMicros(time), micros);

        HostString error;
        Pending write;
        HostArray<WBTimestampArray> timestamps({HostTime(++micros)});
        if (c.variant == nullptr) {
            EXPECT_EQ(StartVariantWrite(reference, c.type, {TextVariant(c.text)}, timestamps.Get(), write, error),
                      kInvalidTagDataType);
        } else {
            Write(reference, c.type, c.type == kBoolean ? "False" : "0", 1);  // something else first
            ASSERT_EQ(StartVariantWrite(reference, c.type, {c.variant()}, timestamps.Get(), write, error), 0)
                << error.Text();
            ASSERT_TRUE(Await(write));
            EXPECT_EQ(TagWBFinishRequestSession(reference, write.id, &error.handle), 0) << error.Text();
            EXPECT_EQ(ReadText(reference, c.type, &time), c.text);
            EXPECT_EQ(UnixMicros(time), micros);
        }
        // Another type than the tag's is refused before anything goes out.
        EXPECT_EQ(StartVariantWrite(reference, (c.type + 1) % 4, {TextVariant("1")}, nullptr, write, error),
                  kInvalidTagDataType);
        Close(reference);
    }
}

TEST_F(WBBrokerTest, ZeroMissingAndTooFewTimestampsLeaveTheTimeToTheService) {
    const uint32_t reference = Open(UniquePath("times"), kInt);
    BusSniffer sniffer;
    ASSERT_TRUE(sniffer.Ready());
    HostString error;
    const int64_t given = 978307200000000;  // 2001-01-01
    // Three values and one timestamp; then one value with a zero timestamp.
    HostArray<WBStrArray> three(NewHostStrings({"1", "2", "3"}));
    HostArray<WBTimestampArray> one({HostTime(given)});
    HostArray<WBStrArray> single(NewHostStrings({"4"}));
    HostArray<WBTimestampArray> zero({WBTimestamp{}});
    for (auto [values, timestamps, last] :
         {std::tuple{three.Get(), one.Get(), "3"}, std::tuple{single.Get(), zero.Get(), "4"}}) {
        const int64_t before = NowMicros();
        Pending write;
        ASSERT_EQ(TagWBWrite2(reference, kInt, values, timestamps, &write.id, &write.timeoutMs, &write.signal,
                              &error.handle),
                  0);
        const std::string body = sniffer.WaitForBody("\"value\":\"" + std::string(last) + "\"",
                                                    std::chrono::milliseconds(write.timeoutMs));
        ASSERT_TRUE(Await(write));
        ASSERT_EQ(TagWBFinishRequestSession(reference, write.id, &error.handle), 0) << error.Text();
        WBTimestamp time{};
        ReadText(reference, kInt, &time);
        EXPECT_GE(UnixMicros(time), before - 1000000) << body;  // the service's clock, not 2001
        EXPECT_EQ(body.find("2001-01-01") != std::string::npos, values == three.Get()) << body;
    }
    EXPECT_EQ(ReadText(reference, kInt), "4");
    Close(reference);
}

TEST_F(WBBrokerTest, ReadsGiveVariantsTextAndAggregates) {
    const uint32_t number = Open(UniquePath("number"), kInt);
    const uint32_t text = Open(UniquePath("text"), kString);
    HostString error;
    uint64_t instance = 99;
    Pending set;
    const bool collect = true;
    ASSERT_EQ(TagWBSetCollectAggregates(number, &collect, &instance, &set.id, &set.timeoutMs, &set.signal,
                                        &error.handle),
              0);
    EXPECT_EQ(instance, 0u);
    ASSERT_EQ(AwaitAndFinish(set), 0);

    // Nothing written yet: the outputs stay as they were.
    Pending read;
    ASSERT_EQ(TagWBRead(number, &read.id, &read.timeoutMs, &read.signal, &error.handle), 0);
    ASSERT_TRUE(Await(read));
    HostVariant unread;
    WBTimestamp untouched{1, 2};
    WBAggregates noAggregates{};
    EXPECT_EQ(TagWBFinishRead(number, kInt, read.id, &unread.variant, &untouched, &noAggregates, &error.handle), 0);
    EXPECT_EQ(WbVariantGetType(unread.variant), WbVariantEmpty);
    EXPECT_EQ(untouched.seconds, 2);

    Write(number, kInt, "5", 1795000000000001);
    Write(number, kInt, "-1", 1795000000000002);
    Write(text, kString, "abc", 1795000000000003);

    ASSERT_EQ(TagWBRead(number, &read.id, &read.timeoutMs, &read.signal, &error.handle), 0);
    ASSERT_TRUE(Await(read));
    HostVariant value;
    WBTimestamp time{};
    WBAggregates aggregates{};
    ASSERT_EQ(TagWBFinishRead(number, kInt, read.id, &value.variant, &time, &aggregates, &error.handle), 0)
        << error.Text();
    ASSERT_EQ(WbVariantGetType(value.variant), WbVariantI32);
    EXPECT_EQ(*static_cast<int32_t*>(WbVariantGetDataPtr(value.variant)), -1);
    EXPECT_EQ(UnixMicros(time), 1795000000000002);
    EXPECT_EQ(aggregates.count, 2u);
    EXPECT_EQ(aggregates.min, -1.0);
    EXPECT_EQ(aggregates.max, 5.0);
    EXPECT_EQ(aggregates.avg, 2.0);

    // The caller's type must be the record's.
    ASSERT_EQ(TagWBRead(number, &read.id, &read.timeoutMs, &read.signal, &error.handle), 0);
    ASSERT_TRUE(Await(read));
    EXPECT_EQ(TagWBFinishRead(number, kDouble, read.id, &value.variant, &time, &aggregates, &error.handle),
              kConflictingTagTypes);

    // The same as text, max and min too.
    ASSERT_EQ(TagWBRead(number, &read.id, &read.timeoutMs, &read.signal, &error.handle), 0);
    ASSERT_TRUE(Await(read));
    HostString valueText;
    WBAggregates2 textAggregates{};
    ASSERT_EQ(TagWBFinishRead2(number, kInt, read.id, &valueText.handle, &time, &textAggregates, &error.handle), 0);
    EXPECT_EQ(valueText.Text(), "-1");
    EXPECT_EQ(Text(textAggregates.max), "5");
    EXPECT_EQ(Text(textAggregates.min), "-1");
    DisposeElement(textAggregates.max);
    DisposeElement(textAggregates.min);

    // Two tags and a reference that is not one: the array is filled, and the
    // finish reports the bad reference. An Int reaches a multi read unsigned.
    HostArray<WBReferenceArray> references({number, 4000000000u, text});
    bool anyInvalid = false;
    for (bool asText : {false, true}) {
        Pending multi;
        ASSERT_EQ(TagWBReadMulti(0, references.Get(), &anyInvalid, &multi.id, &multi.timeoutMs, &multi.signal,
                                 &error.handle),
                  0);
        EXPECT_TRUE(anyInvalid);
        ASSERT_TRUE(Await(multi));
        if (!asText) {
            HostArray<WBValueArray> values;
            EXPECT_EQ(TagWBFinishReadMulti(0, multi.id, &anyInvalid, values.Out(), &error.handle),
                      kInvalidTagReference);
            ASSERT_EQ(values.Size(), 2u);
            EXPECT_EQ(values[0].dataType, kInt);
            ASSERT_EQ(WbVariantGetType(values[0].value), WbVariantUI32);
            EXPECT_EQ(*static_cast<uint32_t*>(WbVariantGetDataPtr(values[0].value)), 4294967295u);
            EXPECT_EQ(UnixMicros(values[0].timestamp), 1795000000000002);
            ASSERT_EQ(WbVariantGetType(values[1].value), WbVariantLStr);
            EXPECT_EQ(Text(*static_cast<WBStrHandle*>(WbVariantGetDataPtr(values[1].value))), "abc");
        } else {
            HostArray<WBValueArray2> values;
            EXPECT_EQ(TagWBFinishReadMulti2(0, multi.id, &anyInvalid, values.Out(), &error.handle),
                      kInvalidTagReference);
            EXPECT_EQ(error.Text(), "Invalid tag reference.");
            ASSERT_EQ(values.Size(), 2u);
            EXPECT_EQ(Text(values[0].value), "-1");
            EXPECT_NE(Text(values[1].path).find(".text"), std::string::npos);
            EXPECT_EQ(values[1].dataType, kString);
            EXPECT_EQ(Text(values[1].value), "abc");
        }
    }
    Close(number);
    Close(text);
}

TEST_F(WBBrokerTest, MetadataIsSetByTagAndFinishedByInstance) {
    const uint32_t reference = Open(UniquePath("meta"), kDouble);
    HostString error;
    uint64_t instance = 99;
    Pending set;
    HostArray<WBStrArray> keywords(NewHostStrings({"b", "a"}));
    ASSERT_EQ(TagWBSetKeywords(reference, keywords.Get(), &instance, &set.id, &set.timeoutMs, &set.signal,
                               &error.handle),
              0);
    EXPECT_EQ(instance, 0u);
    ASSERT_EQ(AwaitAndFinish(set), 0);
    HostArray<WBPropertyArray> first({WBProperty{NewHostString("unit"), NewHostString("V")}});
    HostArray<WBPropertyArray> second({WBProperty{NewHostString("site"), NewHostString("north")}});
    ASSERT_EQ(TagWBSetProperties(reference, first.Get(), &instance, &set.id, &set.timeoutMs, &set.signal,
                                 &error.handle),
              0);
    ASSERT_EQ(AwaitAndFinish(set), 0);
    ASSERT_EQ(TagWBUpdateProperties(reference, second.Get(), &instance, &set.id, &set.timeoutMs, &set.signal,
                                    &error.handle),
              0);
    ASSERT_EQ(AwaitAndFinish(set), 0);

    Pending get;
    ASSERT_EQ(TagWBGetKeywords(reference, &get.id, &get.timeoutMs, &get.signal, &error.handle), 0);
    ASSERT_TRUE(Await(get));
    HostArray<WBStrArray> gotKeywords;
    ASSERT_EQ(TagWBFinishGetKeywords(reference, get.id, gotKeywords.Out(), &error.handle), 0) << error.Text();
    ASSERT_EQ(gotKeywords.Size(), 2u);
    ASSERT_EQ(TagWBGetProperties(reference, &get.id, &get.timeoutMs, &get.signal, &error.handle), 0);
    ASSERT_TRUE(Await(get));
    HostArray<WBPropertyArray> gotProperties;
    ASSERT_EQ(TagWBFinishGetProperties(reference, get.id, gotProperties.Out(), &error.handle), 0);
    ASSERT_EQ(gotProperties.Size(), 2u);  // merged, in key order
    EXPECT_EQ(Text(gotProperties[0].key), "site");
    EXPECT_EQ(Text(gotProperties[1].key), "unit");
    EXPECT_EQ(Text(gotProperties[1].value), "V");
    // A get's finish reads reference 0 as a bad data type, by design.
    bool collect = true;
    EXPECT_EQ(TagWBFinishGetCollectAggregates(0, get.id, &collect, &error.handle), kInvalidTagDataType);
    ASSERT_EQ(TagWBGetCollectAggregates(reference, &get.id, &get.timeoutMs, &get.signal, &error.handle), 0);
    ASSERT_TRUE(Await(get));
    EXPECT_EQ(TagWBFinishGetCollectAggregates(reference, get.id, &collect, &error.handle), 0);
    EXPECT_FALSE(collect);

    // A delete with one bad reference deletes the rest and says so at the finish.
    HostArray<WBReferenceArray> references({reference, 4000000001u});
    Pending remove;
    ASSERT_EQ(TagWBDelete(0, references.Get(), &remove.id, &remove.timeoutMs, &remove.signal, &error.handle), 0);
    std::string text;
    EXPECT_EQ(AwaitAndFinish(remove, &text), kInvalidTagReference);
    EXPECT_EQ(text, "Invalid tag reference.");
    ASSERT_EQ(TagWBGetKeywords(reference, &get.id, &get.timeoutMs, &get.signal, &error.handle), 0);
    ASSERT_TRUE(Await(get));
    EXPECT_EQ(TagWBFinishGetKeywords(reference, get.id, gotKeywords.Out(), &error.handle), -251909);
    Close(reference);
}

}  // namespace
}  // namespace Korvane::Veldra::Testing
