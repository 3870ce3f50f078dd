#include <gtest/gtest.h>

#include <sstream>

#include "StdinLines.h"
#include "TimeText.h"

namespace kvtag {
namespace {

std::vector<TagBatch> Read(const std::string& text) {
    std::istringstream in(text);
    return ReadStdinBatches(in);
}

// The line number and message of the error the text gives.
std::pair<std::size_t, std::string> Refusal(const std::string& text) {
    try {
        Read(text);
    } catch (const LineError& failure) {
        return {failure.LineNumber(), failure.what()};
    }
    ADD_FAILURE() << "no error for: " << text;
    return {};
}

TEST(KvtagStdinLines, GroupsByTagKeepingTheOrderOfLines) {
    const auto batches = Read(
        "a.flow 1 2026-03-01T08:00:00Z\n"
        "b.name x\n"
        "a.flow 2 2026-03-01T07:00:00Z\n"
        "a.flow 3\n");
    ASSERT_EQ(batches.size(), 2u);
    EXPECT_EQ(batches[0].path, "a.flow");
    EXPECT_EQ(batches[1].path, "b.name");
    ASSERT_EQ(batches[0].lines.size(), 3u);
    // Lines keep their order even where their times do not.
    EXPECT_EQ(batches[0].lines[0].value, "1");
    EXPECT_EQ(batches[0].lines[1].value, "2");
    EXPECT_EQ(FormatIsoTime(*batches[0].lines[1].time), "2026-03-01T07:00:00.000000Z");
    EXPECT_EQ(batches[0].lines[2].value, "3");
    EXPECT_FALSE(batches[0].lines[2].time);
    EXPECT_EQ(batches[0].lines[2].lineNumber, 4u);
    EXPECT_EQ(batches[1].lines[0].lineNumber, 2u);
}

TEST(KvtagStdinLines, QuotesCommentsBlanksAndLineEnds) {
    const auto batches = Read(
        "# a comment\n"
        "\n"
        "   \t\n"
        "  a.name\t\"Ana \\\"night\\\" shift\"  2026-03-01T08:00:00+01:00\r\n"
        "a.name \"\"\n"
        "a.name \"back\\\\slash\"\n"
        "  # an indented comment\n"
        "a.name last");  // no newline at the end
    ASSERT_EQ(batches.size(), 1u);
    const auto& lines = batches[0].lines;
    ASSERT_EQ(lines.size(), 4u);
    EXPECT_EQ(lines[0].lineNumber, 4u);
    EXPECT_EQ(lines[0].value, "Ana \"night\" shift");
    EXPECT_EQ(FormatIsoTime(*lines[0].time), "2026-03-01T07:00:00.000000Z");
    EXPECT_EQ(lines[1].value, "");
    EXPECT_EQ(lines[2].value, "back\\slash");
    EXPECT_EQ(lines[3].value, "last");
    EXPECT_EQ(lines[3].lineNumber, 8u);
}

TEST(KvtagStdinLines, ABadLineIsNamedByItsNumber) {
    EXPECT_EQ(Refusal("a.b 1\n\na.b\n").first, 3u);
    EXPECT_EQ(Refusal("a.b 1 2026-03-01T08:00:00Z extra\n").first, 1u);
    EXPECT_EQ(Refusal("a.b 1\na.b 2 yesterday\n").first, 2u);
    EXPECT_EQ(Refusal("a.b \"open\n").first, 1u);
    EXPECT_EQ(Refusal("a.b \"x\"y\n").first, 1u);
    EXPECT_EQ(Refusal("a.b x\"y\n").first, 1u);
    EXPECT_EQ(Refusal("a.b \"bad \\n escape\"\n").first, 1u);
    EXPECT_EQ(Refusal("a.* 1\n").first, 1u);
    EXPECT_EQ(Refusal("\"\" 1\n").first, 1u);
    const auto [line, message] = Refusal("a.b 1\nc.d\n");
    EXPECT_EQ(message, "line 2: a line is PATH VALUE [TIME], found 1 word(s)");
    EXPECT_EQ(Refusal("a.b 1 2026-03-01T08:00:00\n").second,
              "line 1: the time '2026-03-01T08:00:00' has no zone: add Z (UTC) or an offset "
              "such as +01:00");
}

TEST(KvtagStdinLines, NothingToWriteIsAnError) {
    EXPECT_EQ(Refusal("").second, "line 0: no PATH VALUE line was given");
    EXPECT_EQ(Refusal("# only\n\n").first, 2u);
}

}  // namespace
}  // namespace kvtag
