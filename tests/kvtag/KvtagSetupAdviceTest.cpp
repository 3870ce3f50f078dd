// What kvtag reads of the broker configurations, and what it says after the
// library's text when a start fails.
#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>

#include "ConfigurationFiles.h"
#include "SetupAdvice.h"
#include "StatusCodes.h"
#include "support/ScratchDirectory.h"

namespace kvtag {
namespace {

namespace fs = std::filesystem;

// A data root of the test's own, removed when it goes.
class ScratchRoot {
public:
    // Writes VeldraConfigurations/NAME and returns the folder as kvtag reads it.
    ConfigurationFolder With(const std::string& name, const std::string& text) {
        fs::create_directories(fs::path(Path()) / kConfigurationsFolder);
        std::ofstream(fs::path(Path()) / kConfigurationsFolder / name) << text;
        return Folder();
    }
    ConfigurationFolder Folder() const { return ReadConfigurations(Path(), true); }
    const std::string& Path() const { return directory_.Path(); }

private:
    Korvane::Veldra::Testing::ScratchDirectory directory_{"kvtag-advice"};
};

bool Holds(const std::string& text, const std::string& part) {
    return text.find(part) != std::string::npos;
}

const Prober kNoProbe = [](const std::string&, int) {
    ADD_FAILURE() << "a configuration failure needs no probe";
    return ProbeOutcome::Refused;
};

TEST(KvtagConfigurationFiles, KeysAreReadAsTheLibraryReadsThem) {
    auto file = ReadConfigurationText(
        "/d/site.json",
        R"({"Id":"Site","Port":"5672","UseTls":true,"Host":"h","ConnectionType":2,"port":1})");
    EXPECT_TRUE(file.Usable());
    EXPECT_EQ(file.name, "site.json");
    EXPECT_EQ(file.id, "Site");
    EXPECT_EQ(IdKey(file.id), "site");
    EXPECT_EQ(file.port, 5672);
    EXPECT_EQ(file.useTls, true);
    EXPECT_EQ(file.miscasedKeys, std::vector<std::string>{"\"port\" (the library reads \"Port\")"});
    EXPECT_EQ(ReadConfigurationText("f", R"({"Port":1.9})").port, 1);
    EXPECT_TRUE(ReadConfigurationText("f", "null").Usable());

    const std::pair<const char*, const char*> refused[] = {
        {R"({"Port":"abc"})",
         "the key \"Port\" holds the text \"abc\"; it needs a whole number (or a text of one) "
         "within 32 bits"},
        {R"({"Port":3000000000})", "the key \"Port\" holds the number 3000000000; it needs"},
        {R"({"UseTls":"true"})",
         "the key \"UseTls\" holds the text \"true\"; it needs true or false"},
        {R"({"Host":5})", "the key \"Host\" holds the number 5; it needs a text"},
        {R"({"ConnectionType":"master"})",
         "the key \"ConnectionType\" holds the text \"master\"; it needs \"Local\""},
        {"[1]", "it holds an array where an object was expected"},
        {"{\n  \"Id\": \"a\",\n}", "it is not JSON: line 3, column 1: a comma before '}'"},
        {R"({"Id": "a" "Host": "h"})", "it is not JSON: line 1, column 12: expected ',' or '}'"},
        {"", "it is not JSON: line 1, column 1: the file ends where a value should be"},
    };
    for (const auto& [text, problem] : refused) {
        const ConfigurationFile read = ReadConfigurationText("f", text);
        const auto problems =
            read.refused.empty() ? std::vector<std::string>{read.unparsable} : read.refused;
        ASSERT_EQ(problems.size(), 1u) << text;
        EXPECT_EQ(problems.front().rfind(problem, 0), 0u) << problems.front();
    }
}

TEST(KvtagSetupAdvice, EachConfigurationFailureNamesWhatToFix) {
    ScratchRoot root;
    const std::string directory = root.Path() + "/VeldraConfigurations";
    std::string advice =
        ConnectAdvice(status::kDirectoryNotFound, std::nullopt, root.Folder(), kNoProbe);
    EXPECT_TRUE(Holds(advice, "kvtag looked for the configurations in " + directory + ": "))
        << advice;
    EXPECT_TRUE(Holds(advice, "The data root is " + root.Path() + ", from VELDRA_DATA_DIR."));

    // Named configurations alone: the library's first load finds no default.
    advice = ConnectAdvice(status::kNoConfigurations, "site",
                           root.With("site.json", R"({"Id":"Site"})"), kNoProbe);
    EXPECT_TRUE(Holds(advice,
                      "a file with the Id \"veldra_localhost\" or \"veldra_master\" must "
                      "be in " +
                          directory + " beside the named ones"))
        << advice;
    EXPECT_TRUE(Holds(advice, "The Ids found: 'Site' (site.json)."));

    // The Id counts, not the file's name.
    root.With("veldra_master.json", R"({"Id":"veldra_master"})");
    advice = ConnectAdvice(status::kNoConfigurations, "other",
                           root.With("other.json", R"({"id":"other"})"), kNoProbe);
    EXPECT_TRUE(Holds(advice, "No file in " + directory + " has the Id 'other'")) << advice;
    EXPECT_TRUE(Holds(advice, "no Id (other.json), 'Site' (site.json)")) << advice;
    EXPECT_TRUE(Holds(advice, "other.json has the key \"id\" (the library reads \"Id\")"));

    advice = ConnectAdvice(status::kDuplicateId, std::nullopt,
                           root.With("copy.json", R"({"Id":"SITE"})"), kNoProbe);
    EXPECT_TRUE(Holds(advice, "copy.json and site.json have the same Id 'site'")) << advice;

    advice = ConnectAdvice(status::kFailedToParse, std::nullopt,
                           root.With("broken.json", "{\"Id\":}"), kNoProbe);
    EXPECT_EQ(advice, "In " + directory +
                          ", broken.json: it is not JSON: line 1, column 7: expected a value (a "
                          "text in double quotes, a number, true, false, null, an object or an "
                          "array).");
    fs::remove(directory + "/broken.json");
    advice = ConnectAdvice(status::kException, std::nullopt,
                           root.With("port.json", R"({"Id":"p","Port":"x"})"), kNoProbe);
    EXPECT_EQ(advice.rfind("In " + directory + ", port.json: the key \"Port\" holds", 0), 0u)
        << advice;
}

TEST(KvtagSetupAdvice, AFailedConnectionSaysWhatThePortAnswers) {
    ScratchRoot root;
    const ConfigurationFolder folder =
        root.With("a.json", R"({"Id":"veldra_localhost","Host":"broker","Port":5671,"User":"ana",)"
                            R"("UseTls":true,"CertPath":"ca.pem","ExchangeName":"plant.bus"})");
    const std::string file = root.Path() + "/VeldraConfigurations/a.json";
    auto advice = [&](int32_t status, ProbeOutcome outcome) {
        return ConnectAdvice(status, std::nullopt, folder, [&](const std::string& host, int port) {
            EXPECT_EQ(host, "broker");
            EXPECT_EQ(port, 5671);
            return outcome;
        });
    };
    const std::string prefix =
        "Cannot reach the broker broker:5671 (configuration " + file + ", UseTls true): ";
    EXPECT_EQ(advice(-251022, ProbeOutcome::Refused), prefix + "nothing listens on broker:5671.");
    EXPECT_EQ(advice(-251022, ProbeOutcome::PlainAmqp),
              prefix +
                  "the port answers plain AMQP but UseTls is true; give the broker's TLS "
                  "port, or set UseTls to false.");
    EXPECT_EQ(advice(status::kFailedToLogIn, ProbeOutcome::NotPlainAmqp),
              prefix + "the broker refused the user name or password (User 'ana').");
    EXPECT_TRUE(Holds(advice(status::kPeerVerifyFailed, ProbeOutcome::NotPlainAmqp),
                      "CertPath is 'ca.pem' (read as " + root.Path() + "/Certificates/ca.pem)"));
    EXPECT_TRUE(Holds(advice(-251022, ProbeOutcome::Unresolved), "'broker' does not resolve"));

    EXPECT_EQ(ServiceTimeoutAdvice(std::nullopt, folder, 500),
              "No tag service answered within 500 ms on the exchange 'plant.bus' (configuration " +
                  file + "); is one running on that broker with the same ExchangeName?");
}

}  // namespace
}  // namespace kvtag
