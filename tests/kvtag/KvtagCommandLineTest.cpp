#include <gtest/gtest.h>

#include "CommandLine.h"
#include "TimeText.h"

namespace kvtag {
namespace {

Invocation Parse(std::vector<std::string> args) {
    return ParseCommandLine(args);
}

// The message of the usage error the arguments give, and the command its
// hint names ("" for the tool's own help).
std::pair<std::string, std::string> Refusal(std::vector<std::string> args) {
    try {
        ParseCommandLine(args);
    } catch (const UsageError& failure) {
        const auto command = failure.HelpCommand();
        return {failure.what(), command ? CommandName(*command) : ""};
    }
    ADD_FAILURE() << "no usage error";
    return {};
}

TEST(KvtagCommandLine, GlobalOptionsStandAnywhereInBothForms) {
    const auto call =
        Parse({"--json", "read", "a.b", "--timeout=250", "--config", "site", "c.d", "--verbose"});
    EXPECT_EQ(call.command, Command::Read);
    EXPECT_EQ(call.paths, (std::vector<std::string>{"a.b", "c.d"}));
    EXPECT_TRUE(call.global.json);
    EXPECT_TRUE(call.global.verbose);
    EXPECT_EQ(call.global.config, "site");
    EXPECT_EQ(call.global.timeoutMs, 250u);
}

TEST(KvtagCommandLine, ListCollectsRepeatedFiltersAndThePage) {
    const auto call = Parse({"list", "plant.*", "--skip", "5", "--take=10", "--keyword", "k1",
                             "--keyword=k2", "--property", "unit=m3/h", "--property", "eq=a=b"});
    EXPECT_EQ(call.paths, std::vector<std::string>{"plant.*"});
    EXPECT_EQ(call.skip, 5u);
    EXPECT_EQ(call.take, 10u);
    EXPECT_EQ(call.keywords, (std::vector<std::string>{"k1", "k2"}));
    ASSERT_EQ(call.properties.size(), 2u);
    EXPECT_EQ(call.properties[0], std::make_pair(std::string("unit"), std::string("m3/h")));
    // Only the first '=' splits.
    EXPECT_EQ(call.properties[1], std::make_pair(std::string("eq"), std::string("a=b")));
}

TEST(KvtagCommandLine, WriteTakesValuesThatLookLikeOptions) {
    auto call = Parse({"write", "a.b", "-5", "--type", "int32"});
    EXPECT_EQ(call.value, "-5");
    EXPECT_EQ(call.type, 1);
    call = Parse({"write", "a.b", "--", "--not-an-option"});
    EXPECT_EQ(call.value, "--not-an-option");
    call = Parse({"write", "a.b", "", "--time", "2026-03-01T08:30:00.25+01:00"});
    EXPECT_EQ(call.value, "");
    ASSERT_TRUE(call.time);
    EXPECT_EQ(FormatIsoTime(*call.time), "2026-03-01T07:30:00.250000Z");
}

TEST(KvtagCommandLine, SetCommandsTakeTheirItemsAfterThePath) {
    auto call = Parse({"keywords", "a.b", "--set", "one", "two"});
    EXPECT_TRUE(call.set);
    EXPECT_EQ(call.paths, std::vector<std::string>{"a.b"});
    EXPECT_EQ(call.keywords, (std::vector<std::string>{"one", "two"}));
    call = Parse({"keywords", "a.b", "--set"});
    EXPECT_TRUE(call.set);
    EXPECT_TRUE(call.keywords.empty());
    call = Parse({"properties", "a.b", "--set", "unit=bar", "site="});
    ASSERT_EQ(call.properties.size(), 2u);
    EXPECT_EQ(call.properties[1].second, "");
    call = Parse({"aggregates", "a.b", "--collect", "off", "--reset"});
    EXPECT_EQ(call.collect, false);
    EXPECT_TRUE(call.reset);
}

TEST(KvtagCommandLine, HelpInEveryForm) {
    auto call = Parse({"--help"});
    EXPECT_EQ(call.command, Command::Help);
    EXPECT_FALSE(call.helpTopic);
    call = Parse({"help", "write"});
    EXPECT_EQ(call.helpTopic, Command::Write);
    call = Parse({"write", "--help"});
    EXPECT_EQ(call.helpTopic, Command::Write);
    // Help wins over arguments that would be missing or wrong.
    call = Parse({"create", "-h"});
    EXPECT_EQ(call.command, Command::Help);
    EXPECT_EQ(call.helpTopic, Command::Create);
    EXPECT_EQ(Refusal({"help", "frobnicate"}).first, "no command named 'frobnicate'");
}

TEST(KvtagCommandLine, RefusesWhatCannotRunAndPointsAtTheRightHelp) {
    EXPECT_EQ(Refusal({}), std::make_pair(std::string("no command given"), std::string()));
    EXPECT_EQ(Refusal({"fetch", "a"}).first, "unknown command 'fetch'");
    EXPECT_EQ(Refusal({"read", "--type", "double", "a"}),
              std::make_pair(std::string("--type is not an option of read"), std::string("read")));
    EXPECT_EQ(Refusal({"read", "a", "--bogus"}).first, "unknown option --bogus");
    EXPECT_EQ(Refusal({"read"}).second, "read");
    EXPECT_EQ(Refusal({"create", "a.b"}).first, "create needs --type");
    EXPECT_EQ(Refusal({"create", "a.b", "--type", "int64"}).second, "create");
    EXPECT_EQ(Refusal({"write", "a.b"}).second, "write");
    EXPECT_EQ(Refusal({"write", "a.b", "1", "--time", "2026-03-01 08:30:00"}).second, "write");
    EXPECT_EQ(Refusal({"write", "--stdin", "a.b", "1"}).first,
              "write --stdin takes no PATH or VALUE");
    EXPECT_EQ(Refusal({"write", "--stdin", "--time", "2026-03-01T08:30:00Z"}).second, "write");
    EXPECT_EQ(Refusal({"keywords", "a.b", "extra"}).second, "keywords");
    EXPECT_EQ(Refusal({"properties", "a.b", "--set", "novalue"}).second, "properties");
    EXPECT_EQ(Refusal({"properties", "a.b", "--set", "=v"}).second, "properties");
    EXPECT_EQ(Refusal({"aggregates", "a.b", "--collect", "yes"}).second, "aggregates");
    EXPECT_EQ(Refusal({"aggregates", "a.b", "--collect"}).first, "--collect needs a value");
    EXPECT_EQ(Refusal({"read", "a.*"}).second, "read");
    EXPECT_EQ(Refusal({"delete", ""}).second, "delete");
    EXPECT_EQ(Refusal({"list", "a", "--json=yes"}).first, "--json takes no value");
    EXPECT_EQ(Refusal({"create", "a", "--type", "double", "--type", "bool"}).first,
              "--type given twice");
}

TEST(KvtagCommandLine, NumbersAreWholeAndInRange) {
    EXPECT_EQ(Parse({"list", "*", "--take", "4294967295"}).take, 4294967295u);
    for (const char* bad : {"-1", "4294967296", "1e3", "", " 7", "12345678901"}) {
        EXPECT_EQ(Refusal({"list", "*", "--skip", bad}).second, "list") << bad;
    }
    // 0 is the library's single connect attempt.
    EXPECT_EQ(Parse({"read", "a", "--timeout", "0"}).global.timeoutMs, 0u);
    EXPECT_EQ(Refusal({"read", "a", "--timeout", "-1"}).first,
              "--timeout needs a whole number from 0 to 4294967295, not '-1'");
}

TEST(KvtagCommandLine, RefusalsSayWhatIsMissing) {
    EXPECT_EQ(Refusal({"write", "a.b", "1", "--time", "2026-03-01T08:30:00"}).first,
              "--time '2026-03-01T08:30:00' has no zone: add Z (UTC) or an offset such as +01:00");
    EXPECT_EQ(Refusal({"read", ""}).first, "a tag path may not be empty");
    EXPECT_EQ(Refusal({"keywords", "a.b", "--set", "k", ""}).first, "a keyword may not be empty");
    EXPECT_EQ(Parse({"create", "a.b", "--type", "Float"}).type, 0);
}

TEST(KvtagCommandLine, JsonIsWantedBeforeTheEndOfOptionsOnly) {
    EXPECT_TRUE(WantsJson({"bogus", "--json"}));
    EXPECT_FALSE(WantsJson({"write", "a", "--", "--json"}));
    EXPECT_FALSE(WantsJson({"read", "a"}));
}

}  // namespace
}  // namespace kvtag
