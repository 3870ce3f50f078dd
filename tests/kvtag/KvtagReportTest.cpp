#include <gtest/gtest.h>

#include <limits>

#include "JsonWriter.h"
#include "LibraryText.h"
#include "Report.h"
#include "TextEscape.h"
#include "TimeText.h"

namespace kvtag {
namespace {

TEST(KvtagReport, ValuesShowTypeByNameTimeInUtcAndAggregatesWhenCounted) {
    TagConsoleValue counted;
    counted.path = "a.flow";
    counted.dataType = 0;
    counted.value = "12.5";
    counted.timestamp = *ParseIsoTime("2026-03-01T08:30:00.25Z");
    counted.aggregateCount = 2;
    counted.aggregateAverage = 12.25;
    counted.aggregateMinimum = "12";
    counted.aggregateMaximum = "12.5";
    TagConsoleValue unwritten;
    unwritten.path = "a.name";
    unwritten.dataType = 2;
    unwritten.timestamp = TagConsoleTime::min();

    const Rendered out = RenderValues({counted, unwritten});
    EXPECT_EQ(out.text,
              "a.flow\tdouble\t12.5\t2026-03-01T08:30:00.250000Z\t"
              "(count 2, average 12.25, minimum 12, maximum 12.5)\n"
              "a.name\tstring\t\t-\n");
    EXPECT_EQ(out.json,
              "{\"values\":[{\"path\":\"a.flow\",\"type\":\"double\",\"value\":\"12.5\","
              "\"time\":\"2026-03-01T08:30:00.250000Z\",\"aggregates\":{\"count\":2,"
              "\"average\":12.25,\"minimum\":\"12\",\"maximum\":\"12.5\"}},"
              "{\"path\":\"a.name\",\"type\":\"string\",\"value\":\"\",\"time\":null,"
              "\"aggregates\":null}]}");
}

TEST(KvtagReport, JsonEscapesEveryTextAndKeepsNumbersShort) {
    EXPECT_EQ(JsonQuote("q\"b\\n\n\t\x01\xc3\xa9"), "\"q\\\"b\\\\n\\n\\t\\u0001\xc3\xa9\"");
    EXPECT_EQ(NumberText(0.1), "0.1");
    EXPECT_EQ(NumberText(1.0 / 3.0), "0.3333333333333333");
    EXPECT_EQ(NumberText(0.1 + 0.2), "0.30000000000000004");
    JsonWriter json;
    json.BeginObject()
        .Key("n")
        .Number(std::numeric_limits<double>::infinity())
        .Key("a")
        .BeginArray()
        .Integer(-1)
        .Bool(false)
        .Null()
        .EndArray()
        .EndObject();
    EXPECT_EQ(json.Text(), "{\"n\":null,\"a\":[-1,false,null]}");
}

TEST(KvtagReport, PropertiesSortedAndEnvelopes) {
    const Rendered out = RenderProperties("p", {{"site", "North"}, {"unit", "m3/h"}, {"a", ""}});
    EXPECT_EQ(out.text, "a=\nsite=North\nunit=m3/h\n");
    EXPECT_EQ(out.json,
              "{\"path\":\"p\",\"properties\":{\"a\":\"\",\"site\":\"North\","
              "\"unit\":\"m3/h\"}}");
    EXPECT_EQ(JsonSuccess("create", "{}"), "{\"ok\":true,\"command\":\"create\",\"result\":{}}");
    const int32_t status = -251900;
    EXPECT_EQ(JsonFailure("read", "library", &status, "x"),
              "{\"ok\":false,\"command\":\"read\",\"error\":{\"kind\":\"library\","
              "\"status\":-251900,\"message\":\"x\"}}");
    EXPECT_EQ(JsonFailure("kvtag", "usage", nullptr, "y"),
              "{\"ok\":false,\"command\":\"kvtag\",\"error\":{\"kind\":\"usage\","
              "\"status\":null,\"message\":\"y\"}}");
}

TEST(KvtagReport, TextOutputKeepsEachRecordOnOneLine) {
    EXPECT_EQ(EscapeText("a\tb\nc\rd\\e\x01\x7f\xc3\xa9"), "a\\tb\\nc\\rd\\\\e\\x01\\x7f\xc3\xa9");
    ListReport list;
    list.tags = {{"line\nbreak", 0}};
    EXPECT_EQ(RenderList(list).text, "line\\nbreak\tdouble\n");
    TagConsoleValue value;
    value.path = "p";
    value.dataType = 2;
    value.value = "x\ty";
    value.timestamp = TagConsoleTime::min();
    EXPECT_EQ(RenderValues({value}).text, "p\tstring\tx\\ty\t-\n");
    EXPECT_EQ(RenderProperties("p", {{"k\n", "v\\"}}).text, "k\\n=v\\\\\n");
}

TEST(KvtagReport, AggregatesWithoutSamplesShowNothingForTheirValues) {
    AggregatesReport report;
    report.path = "p";
    report.type = 0;
    const Rendered out = RenderAggregates(report);
    EXPECT_EQ(out.text, "p\tdouble\tcollect off\tcount 0, average -, minimum -, maximum -\n");
    EXPECT_EQ(out.json,
              "{\"path\":\"p\",\"type\":\"double\",\"collect\":false,\"aggregates\":{"
              "\"count\":0,\"average\":null,\"minimum\":null,\"maximum\":null}}");
}

TEST(KvtagReport, RefusalsThatLostTheirInsertsAreFilled) {
    const std::string lost =
        "Too few inserts passed to format the message: \"Tag '{0}' has type string and "
        "cannot collect aggregates.\"";
    EXPECT_EQ(FilledLibraryText(lost, {"plant.name"}),
              "Tag 'plant.name' has type string and cannot collect aggregates.");
    // An insert kvtag does not know leaves the library's text as it is.
    const std::string two = "Too few inserts passed to format the message: \"'{0}': '{1}'\"";
    EXPECT_EQ(FilledLibraryText(two, {"a"}), two);
    EXPECT_EQ(FilledLibraryText(two, {"a", "b", "surplus"}), "'a': 'b'");
    EXPECT_EQ(
        FilledLibraryText("Too few inserts passed to format the message: \"{x} {} {0}\"", {"p"}),
        "{x} {} p");
    EXPECT_EQ(FilledLibraryText("Request timed out.", {"p"}), "Request timed out.");
}

TEST(KvtagReport, ListAndWritesNameTypes) {
    ListReport list;
    list.tags = {{"a.b", 4}, {"a.c", 5}};
    list.total = 3;
    list.take = 2;
    const Rendered listed = RenderList(list);
    EXPECT_EQ(listed.text, "a.b\tuint64\na.c\tdatetime\n");
    EXPECT_EQ(listed.json,
              "{\"total\":3,\"skip\":0,\"take\":2,\"tags\":[{\"path\":\"a.b\","
              "\"type\":\"uint64\"},{\"path\":\"a.c\",\"type\":\"datetime\"}]}");
    EXPECT_EQ(RenderWrites({{"a.b", 3, 1}, {"a.c", 1, 2}}).text,
              "wrote 1 sample to a.b (bool)\nwrote 2 samples to a.c (int32)\n");
}

}  // namespace
}  // namespace kvtag
