#include <gtest/gtest.h>

#include "CommandLine.h"
#include "QueryString.h"
#include "RequestBody.h"

namespace kvtag::serve {
namespace {

TEST(KvtagServeRequest, TargetsDecodeTheirPathAndRepeatedParameters) {
    const Target target = ParseTarget("/api/read?path=a%2Eb+c&path=%3Cimg%3E&&flag&take=5");
    EXPECT_EQ(target.path, "/api/read");
    EXPECT_EQ(target.parameters.at("path"), (std::vector<std::string>{"a.b c", "<img>"}));
    EXPECT_EQ(target.First("flag", "x"), "");
    EXPECT_EQ(target.First("take"), "5");
    EXPECT_EQ(target.First("absent", "7"), "7");
    // '+' is a space only in the query.
    EXPECT_EQ(ParseTarget("/a+b").path, "/a+b");
    for (const char* bad : {"/api/list?pattern=%", "/api/list?pattern=%4", "/%zz"}) {
        EXPECT_THROW(ParseTarget(bad), QueryError) << bad;
    }
}

TEST(KvtagServeRequest, BodiesTakeTheirMembersAndNothingElse) {
    EXPECT_EQ(ParseReadBody(R"({"paths": ["a", "b\u00e9"]})"),
              (std::vector<std::string>{"a", "b\xc3\xa9"}));
    EXPECT_EQ(ParseWriteBody(R"({"path": "a", "value": "1.5"})").value, "1.5");
    EXPECT_EQ(ParseWriteBody(R"({"value": -2e3, "path": "a"})").value, "-2e3");
    EXPECT_EQ(ParseWriteBody(R"({"path": "a", "value": true})").value, "true");

    const std::pair<const char*, const char*> refused[] = {
        {R"({"paths": [)", "not JSON: line 1, column 12"},
        {R"({"paths": "a"})", "must be an array"},
        {R"({"paths": ["a", 1]})", "texts only, not a number"},
        {R"({"paths": []})", "no path to read"},
        {R"({"paths": ["a"], "paths": ["b"]})", "given twice"},
        {R"({"path": "a*", "value": "1"})", "may not hold '*'"},
        {R"({"path": "a"})", "lacks the member \"value\""},
        {R"({"path": "a", "value": null})", "not null"},
        {R"({"path": "a", "value": ["1"]})", "not an array"}};
    for (const auto& [body, message] : refused) {
        const std::string text = body;
        try {
            if (text.find("\"paths\"") != std::string::npos) {
                ParseReadBody(text);
            } else {
                ParseWriteBody(text);
            }
            ADD_FAILURE() << body << " was taken";
        } catch (const BodyError& error) {
            EXPECT_NE(std::string(error.what()).find(message), std::string::npos)
                << body << ": " << error.what();
        }
    }
    EXPECT_THROW(ParseReadBody(std::string("{\"paths\": [\"a\"]}\0x", 18)), BodyError);
    std::string many = "{\"paths\": [\"a\"";
    for (std::size_t i = 0; i < kMaxReadPaths; ++i) many += ",\"a\"";
    try {
        ParseReadBody(many + "]}");
        ADD_FAILURE() << "too many paths were taken";
    } catch (const BodyError& error) {
        EXPECT_STREQ(error.what(), "at most 200 paths in one read, not 201");
    }
}

TEST(KvtagServeRequest, ServeTakesItsOptionsOnly) {
    const Invocation call =
        ParseCommandLine({"serve", "--listen", "[::1]:0", "--instance", "7", "--allow-write"});
    EXPECT_EQ(call.command, Command::Serve);
    EXPECT_EQ(call.listenHost, "::1");
    EXPECT_EQ(call.listenPort, 0);
    EXPECT_EQ(call.instance, 7u);
    EXPECT_TRUE(call.allowWrite);
    const Invocation plain = ParseCommandLine({"serve"});
    EXPECT_EQ(plain.listenHost, "127.0.0.1");
    EXPECT_EQ(plain.listenPort, 8080);
    EXPECT_FALSE(plain.allowWrite);
    for (const auto& args :
         std::vector<std::vector<std::string>>{{"serve", "--listen", "127.0.0.1"},
                                               {"serve", "--listen", "127.0.0.1:65536"},
                                               {"serve", "--instance", "0"},
                                               {"serve", "line1.*"},
                                               {"read", "a", "--allow-write"}}) {
        EXPECT_THROW(ParseCommandLine(args), UsageError) << args.back();
    }
}

}  // namespace
}  // namespace kvtag::serve
