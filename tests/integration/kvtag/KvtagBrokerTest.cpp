// kvtag run as a child process against the private broker and the
// reference tag service: what each subcommand prints and its exit status.
#include <gtest/gtest.h>
#include <netinet/in.h>
#include <sys/socket.h>
#include <unistd.h>

#include <atomic>
#include <filesystem>
#include <fstream>

#include "kvtag/KvtagProcess.h"
#include "messagelibrary/json/JsonParser.h"
#include "support/BrokerEnvironment.h"
#include "support/ScratchDirectory.h"
#include "support/SuiteTagService.h"
#include "support/TagServiceProcess.h"

namespace Korvane::Veldra::Testing {
namespace {

using VeldraMessageLibrary::JsonVariant;

class KvtagBrokerTest : public ::testing::Test {
protected:
    void SetUp() override {
        ASSERT_TRUE(Suite().EnsureSuite([] {
            UseBrokerDataRoot();
            Suite().Start();
        })) << "the tag service did not start (see above)";
    }
    static void TearDownTestSuite() { Suite().Stop(); }

    static SuiteTagService& Suite() {
        static SuiteTagService suite{"kvveldra-kvtag"};
        return suite;
    }

    // A path prefix that no other test or run uses.
    static std::string Prefix(const std::string& stem) {
        static std::atomic<int> counter{0};
        return "kvtag." + std::to_string(getpid()) + "." + std::to_string(++counter) + "." + stem;
    }

    // Runs kvtag and expects the exit status, showing both outputs if not.
    static KvtagRun Expect(int exitCode, const std::vector<std::string>& args,
                           const std::string& input = "") {
        KvtagRun run = RunKvtag(args, input);
        EXPECT_EQ(run.exitCode, exitCode)
            << "kvtag " << Join(args) << "\nstdout: " << run.out << "\nstderr: " << run.err;
        return run;
    }

    static std::string Join(const std::vector<std::string>& args) {
        std::string joined;
        for (const auto& arg : args) joined += arg + " ";
        return joined;
    }

    // Parses the one JSON document of standard output.
    static void ParseJson(const std::string& out, JsonVariant& document) {
        ASSERT_TRUE(VeldraMessageLibrary::Parse(document, out)) << out;
        ASSERT_TRUE(document.IsObject()) << out;
    }

    static std::string Text(const JsonVariant& object, const char* key) {
        const JsonVariant* member = object.Find(key);
        return member && member->IsString() ? std::string(member->AsText()) : "<absent>";
    }
};

TEST_F(KvtagBrokerTest, CreateWriteReadRoundTrip) {
    const std::string flow = Prefix("flow");
    EXPECT_EQ(Expect(0, {"create", flow, "--type", "double"}).out,
              "created " + flow + " (double)\n");
    EXPECT_NE(Expect(2, {"create", flow, "--type", "double"}).err.find("exists already"),
              std::string::npos);
    // Never written: no value and no time, but its type all the same.
    EXPECT_EQ(Expect(0, {"read", flow}).out, flow + "\tdouble\t\t-\n");

    EXPECT_EQ(Expect(0, {"write", flow, "12.5", "--time", "2026-03-01T09:30:00.000250+01:00"}).out,
              "wrote 1 sample to " + flow + " (double)\n");
    EXPECT_EQ(Expect(0, {"read", flow}).out,
              flow + "\tdouble\t12.5\t2026-03-01T08:30:00.000250Z\n");

    // The type of an existing tag rules: a value it cannot hold is a usage
    // error, and another --type is refused.
    EXPECT_EQ(Expect(1, {"write", flow, "twelve"}).err.substr(0, 6), "kvtag:");
    EXPECT_NE(Expect(2, {"write", flow, "1", "--type", "int32"}).err.find("is a double tag"),
              std::string::npos);

    // A string tag made by write --type, read back in JSON with another tag.
    const std::string name = Prefix("name");
    Expect(0, {"write", name, "Ana \"night\"\tshift", "--type", "string", "--time",
               "2026-03-01T08:00:00Z"});
    JsonVariant document;
    ParseJson(Expect(0, {"--json", "read", flow, name}).out, document);
    EXPECT_TRUE(document.Find("ok")->AsBool());
    EXPECT_EQ(Text(document, "command"), "read");
    const JsonVariant* values = document.Find("result")->Find("values");
    ASSERT_TRUE(values && values->IsArray());
    ASSERT_EQ(values->Size(), 2u);
    EXPECT_EQ(Text(*values->At(0), "path"), flow);
    EXPECT_EQ(Text(*values->At(0), "type"), "double");
    EXPECT_EQ(Text(*values->At(0), "time"), "2026-03-01T08:30:00.000250Z");
    EXPECT_TRUE(values->At(0)->Find("aggregates")->IsNull());
    EXPECT_EQ(Text(*values->At(1), "value"), "Ana \"night\"\tshift");
    // Lines come in the order of the arguments.
    const std::string reversed = Expect(0, {"read", name, flow}).out;
    EXPECT_EQ(reversed.substr(0, name.size() + 1), name + "\t") << reversed;
    EXPECT_EQ(Text(*values->At(1), "type"), "string");
}

TEST_F(KvtagBrokerTest, ReadingAndWritingWithoutATypeCreateNothing) {
    const std::string missing = Prefix("missing");
    EXPECT_NE(Expect(2, {"read", missing}).err.find("no tag '" + missing + "'"), std::string::npos);
    EXPECT_NE(Expect(2, {"write", missing, "1"}).err.find("--type"), std::string::npos);
    Expect(2, {"keywords", missing});
    Expect(2, {"delete", missing});
    JsonVariant document;
    ParseJson(Expect(0, {"list", missing, "--json"}).out, document);
    EXPECT_EQ(document.Find("result")->Find("total")->AsNumber(), 0);

    JsonVariant failure;
    ParseJson(Expect(2, {"read", missing, "--json"}).out, failure);
    EXPECT_FALSE(failure.Find("ok")->AsBool());
    EXPECT_EQ(Text(*failure.Find("error"), "kind"), "tool");
}

TEST_F(KvtagBrokerTest, StdinGroupsLinesByTagAndWritesNothingOnABadLine) {
    const std::string a = Prefix("a");
    const std::string b = Prefix("b");
    Expect(0, {"create", a, "--type", "int32"});
    Expect(0, {"aggregates", a, "--collect", "on"});
    const std::string lines = "# two tags, interleaved\n" + a + " 1 2026-03-01T08:00:00Z\n" + b +
                              " \"x y\" 2026-03-01T08:00:00Z\n" + a + " 2 2026-03-01T08:00:01Z\n" +
                              a + " 6 2026-03-01T08:00:02Z\n";
    // b does not exist and no --type is given: nothing is written at all.
    EXPECT_NE(Expect(2, {"write", "--stdin"}, lines).err.find("line 3"), std::string::npos);
    EXPECT_EQ(Expect(0, {"aggregates", a}).out.find("count 0,") != std::string::npos, true);

    Expect(0, {"create", b, "--type", "string"});
    EXPECT_EQ(Expect(0, {"write", "--stdin"}, lines).out,
              "wrote 3 samples to " + a + " (int32)\nwrote 1 sample to " + b + " (string)\n");
    EXPECT_EQ(Expect(0, {"read", a, b}).out, a +
                                                 "\tint32\t6\t2026-03-01T08:00:02.000000Z\t(count "
                                                 "3, average 3, minimum 1, maximum 6)\n" +
                                                 b +
                                                 "\tstring\tx y\t2026-03-01T08:00:00.000000Z\n");

    // A value its tag cannot hold, on line 2: a usage error, nothing written.
    const KvtagRun bad = Expect(1, {"write", "--stdin"}, a + " 7\n" + a + " seven\n" + b + " z\n");
    EXPECT_NE(bad.err.find("line 2: 'seven' is not a value of type int32"), std::string::npos)
        << bad.err;
    EXPECT_NE(bad.err.find("kvtag write --help"), std::string::npos);
    EXPECT_NE(Expect(0, {"read", a}).out.find("\t6\t"), std::string::npos);
    // A line that breaks the grammar names its number too.
    EXPECT_NE(Expect(1, {"write", "--stdin"}, a + " 1\n\n" + a + "\n").err.find("line 3"),
              std::string::npos);
}

TEST_F(KvtagBrokerTest, MetadataListAndDelete) {
    const std::string stem = Prefix("meta");
    for (const char* leaf : {".x", ".y", ".z"}) {
        Expect(0, {"create", stem + leaf, "--type", "bool"});
    }
    EXPECT_EQ(Expect(0, {"keywords", stem + ".x", "--set", "north", "metered"}).out,
              "north\nmetered\n");
    EXPECT_EQ(Expect(0, {"keywords", stem + ".x"}).out, "north\nmetered\n");
    EXPECT_EQ(Expect(0, {"properties", stem + ".y", "--set", "unit=bar", "site=North"}).out,
              "site=North\nunit=bar\n");
    JsonVariant properties;
    ParseJson(Expect(0, {"properties", stem + ".y", "--json"}).out, properties);
    EXPECT_EQ(Text(*properties.Find("result")->Find("properties"), "unit"), "bar");

    const KvtagRun page = Expect(0, {"list", stem + ".*", "--take", "2"});
    EXPECT_EQ(page.out, stem + ".x\tbool\n" + stem + ".y\tbool\n");
    EXPECT_NE(page.err.find("2 of 3"), std::string::npos);
    EXPECT_EQ(Expect(0, {"list", stem + ".*", "--skip", "2"}).out, stem + ".z\tbool\n");
    EXPECT_EQ(Expect(0, {"list", stem + ".*", "--keyword", "metered"}).out, stem + ".x\tbool\n");
    EXPECT_EQ(Expect(0, {"list", stem + ".*", "--property", "site=North"}).out,
              stem + ".y\tbool\n");
    JsonVariant listed;
    ParseJson(Expect(0, {"--json", "list", stem + ".*"}).out, listed);
    EXPECT_EQ(listed.Find("result")->Find("total")->AsNumber(), 3);
    EXPECT_EQ(Text(*listed.Find("result")->Find("tags")->At(2), "type"), "bool");

    EXPECT_EQ(Expect(0, {"delete", stem + ".x", stem + ".z"}).out,
              "deleted " + stem + ".x\ndeleted " + stem + ".z\n");
    EXPECT_EQ(Expect(0, {"list", stem + ".*"}).out, stem + ".y\tbool\n");
}

TEST_F(KvtagBrokerTest, AggregatesCollectAndReset) {
    const std::string tag = Prefix("agg");
    Expect(0, {"create", tag, "--type", "double"});
    EXPECT_EQ(Expect(0, {"aggregates", tag}).out.find(tag + "\tdouble\tcollect off\t"), 0u);
    Expect(0, {"aggregates", tag, "--collect", "on"});
    Expect(0, {"write", "--stdin"}, tag + " 1.5\n" + tag + " 2.5\n");
    JsonVariant document;
    ParseJson(Expect(0, {"aggregates", tag, "--json"}).out, document);
    const JsonVariant* result = document.Find("result");
    EXPECT_TRUE(result->Find("collect")->AsBool());
    EXPECT_EQ(result->Find("aggregates")->Find("count")->AsNumber(), 2);
    EXPECT_EQ(result->Find("aggregates")->Find("average")->AsNumber(), 2.0);
    EXPECT_EQ(Expect(0, {"aggregates", tag, "--reset"}).out.find("count 0,") != std::string::npos,
              true);
}

TEST_F(KvtagBrokerTest, UsageErrorsSendNothingAndHelpAnswers) {
    // The configuration named here does not exist: only a run that never
    // reaches the library can end with status 1.
    const std::string tag = Prefix("usage");
    const KvtagRun run =
        Expect(1, {"--config", "no_such_config", "write", tag, "abc", "--type", "int32"});
    EXPECT_TRUE(run.out.empty());
    EXPECT_NE(run.err.find("'abc' is not a value of type int32"), std::string::npos);
    EXPECT_NE(run.err.find("Try 'kvtag write --help'"), std::string::npos);
    Expect(1, {"--config", "no_such_config", "fetch", tag});
    JsonVariant document;
    ParseJson(Expect(1, {"--json", "--config", "no_such_config", "read"}).out, document);
    EXPECT_EQ(Text(*document.Find("error"), "kind"), "usage");
    EXPECT_EQ(Expect(0, {"list", tag}).out, "");

    EXPECT_EQ(Expect(0, {"write", "--help"}).out.find("Usage: kvtag write PATH VALUE"), 0u);
    EXPECT_EQ(Expect(0, {"help", "write"}).out, Expect(0, {"write", "--help"}).out);
    EXPECT_EQ(Expect(0, {"--help"}).out.find("Usage: kvtag"), 0u);
}

// A loopback port held bound but not listening: connects to it are refused,
// and no other process takes it while this lives.
class RefusingPort {
public:
    RefusingPort() : fd_(socket(AF_INET, SOCK_STREAM, 0)) {
        sockaddr_in address{};
        address.sin_family = AF_INET;
        address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
        socklen_t length = sizeof address;
        auto* any = reinterpret_cast<sockaddr*>(&address);
        if (bind(fd_, any, length) == 0 && getsockname(fd_, any, &length) == 0) {
            port_ = ntohs(address.sin_port);
        }
    }
    ~RefusingPort() { close(fd_); }
    RefusingPort(const RefusingPort&) = delete;
    RefusingPort& operator=(const RefusingPort&) = delete;
    int Port() const { return port_; }

private:
    int fd_;
    int port_ = 0;
};

// A configuration of the private broker with one thing changed.
std::string Configuration(const std::string& id, int port, const std::string& password, bool useTls,
                          const std::string& exchange) {
    const BrokerSettings& broker = Broker();
    return "{\"Id\":\"" + id + "\",\"ExchangeName\":\"" + exchange + "\",\"Host\":\"" +
           broker.Host + "\",\"Port\":" + std::to_string(port) + ",\"User\":\"" + broker.User +
           "\",\"Password\":\"" + password + "\",\"UseTls\":" + (useTls ? "true" : "false") +
           ",\"CertPath\":\"" + broker.CaCertPath + "\"}";
}

// Each set-up that cannot work fails at once with the library's status and
// text first, and then names what to check.
TEST_F(KvtagBrokerTest, EachFailingSetUpSaysWhatToCheck) {
    const BrokerSettings& broker = Broker();
    const std::string exchange = "kvtag.no-service." + std::to_string(getpid());
    const RefusingPort refusing;
    ASSERT_NE(refusing.Port(), 0);
    const int closedPort = refusing.Port();
    struct SetUp {
        const char* what;
        std::string file;  // the one configuration file; "" for none at all
        std::string text;
        std::vector<std::string> args;
        std::vector<std::string> said;  // parts of the message, "@" for the file's path
    };
    const std::vector<SetUp> setUps = {
        {"a data root that does not exist",
         "",
         "",
         {},
         {"status -251012: Veldra configurations "
          "directory not found.",
          "/absent/VeldraConfigurations: ", "VELDRA_DATA_DIR"}},
        {"a file that does not parse",
         "veldra_master.json",
         "{\"Id\": \"veldra_master\",",
         {},
         {"status -251005: Failed to parse.", "veldra_master.json: it is not JSON: line 1"}},
        {"only named configurations",
         "site.json",
         Configuration("site", broker.AmqpPort, broker.Password, false, exchange),
         {"--config", "site"},
         {"status -251011: No Veldra configurations available.",
          "\"veldra_localhost\" or \"veldra_master\"", "'site' (site.json)"}},
        {"a wrong password",
         "veldra_master.json",
         Configuration("veldra_master", broker.AmqpPort, "not-" + broker.Password, false, exchange),
         {},
         {"status -251024: AMQP error: Failed to log in.", "@",
          broker.Host + ":" + std::to_string(broker.AmqpPort),
          "refused the user name or password"}},
        {"plain AMQP on the TLS port",
         "veldra_master.json",
         Configuration("veldra_master", broker.AmqpsPort, broker.Password, false, exchange),
         {},
         {"status -251", "@", broker.Host + ":" + std::to_string(broker.AmqpsPort),
          "does not answer plain AMQP (a TLS port?) but UseTls is false"}},
        {"TLS on the plain port",
         "veldra_master.json",
         Configuration("veldra_master", broker.AmqpPort, broker.Password, true, exchange),
         {},
         {"status -251", "@", broker.Host + ":" + std::to_string(broker.AmqpPort),
          "answers plain AMQP but UseTls is true"}},
        {"a port where nothing listens",
         "veldra_master.json",
         Configuration("veldra_master", closedPort, broker.Password, false, exchange),
         {},
         {"status -251022: AMQP error: Failed to open socket.", "@",
          "nothing listens on " + broker.Host + ":" + std::to_string(closedPort)}},
        {"an exchange without a tag service",
         "veldra_master.json",
         Configuration("veldra_master", broker.AmqpPort, broker.Password, false, exchange),
         {},
         {"status -251001: Request timed out.", "@",
          "within 10000 ms on the exchange '" + exchange + "'", "with the same ExchangeName?"}},
    };
    for (const auto& setUp : setUps) {
        SCOPED_TRACE(setUp.what);
        ScratchDirectory root("kvveldra-kvtag-setup");
        std::string dataRoot = root.Path() + "/absent";
        std::string path;
        if (!setUp.file.empty()) {
            dataRoot = root.Path();
            std::filesystem::create_directories(dataRoot + "/VeldraConfigurations");
            path = dataRoot + "/VeldraConfigurations/" + setUp.file;
            std::ofstream(path) << setUp.text;
        }
        std::vector<std::string> args = setUp.args;
        args.insert(args.end(), {"--json", "--timeout", "500", "read", "any.tag"});
        const KvtagRun run = RunKvtag(args, "", {{"VELDRA_DATA_DIR", dataRoot}}, 60);
        EXPECT_EQ(run.exitCode, 2) << run.err;
        // Only the request to a missing service waits, for the library's 10 s.
        EXPECT_LT(run.elapsed, std::chrono::seconds(15));
        for (const auto& part : setUp.said) {
            EXPECT_NE(run.err.find(part == "@" ? path : part), std::string::npos)
                << "missing: " << (part == "@" ? path : part) << "\nin: " << run.err;
        }
        // The same message, under the library's status, in the JSON document.
        JsonVariant document;
        ParseJson(run.out, document);
        const JsonVariant* error = document.Find("error");
        ASSERT_NE(error, nullptr) << run.out;
        EXPECT_EQ(Text(*error, "kind"), "library");
        EXPECT_LT(error->Find("status")->AsNumber(), 0);
        EXPECT_EQ("kvtag: " + Text(*error, "message") + "\n", run.err);
    }
}

}  // namespace
}  // namespace Korvane::Veldra::Testing
