#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>

#include "errors/VeldraException.h"
#include "messagebus/config/BusConfigurations.h"
#include "messagelibrary/json/JsonParser.h"
#include "utilities/Paths.h"

using namespace Korvane::Veldra::MessageBus;
namespace fs = std::filesystem;

namespace {

// A configurations directory of the test's own and a clock the test moves.
class Configurations : public ::testing::Test {
protected:
    void SetUp() override {
        directory_ = fs::temp_directory_path() /
                     ("kvveldra-conf-" + std::to_string(::getpid()) + "-" +
                      ::testing::UnitTest::GetInstance()->current_test_info()->name());
        fs::remove_all(directory_);
        fs::create_directories(directory_);
    }
    void TearDown() override { fs::remove_all(directory_); }

    void Write(const std::string& name, const std::string& text) {
        std::ofstream(directory_ / name, std::ios::binary) << text;
    }
    static std::string Config(const std::string& id, const std::string& host = "broker") {
        return "{\"Id\":\"" + id + "\",\"Host\":\"" + host + "\",\"Port\":5672}";
    }
    BusConfigurations Store(const std::string& id = "", bool fallback = true) {
        return BusConfigurations(directory_, id, fallback, [this] { return now_; });
    }
    // The code and text of the VeldraException that call throws.
    template <typename Call>
    static std::pair<int32_t, std::string> Failure(Call&& call) {
        try {
            call();
        } catch (const VeldraException& error) {
            return {error.Code(), error.what()};
        }
        return {0, "<nothing thrown>"};
    }

    fs::path directory_;
    std::chrono::steady_clock::time_point now_{std::chrono::hours(1)};
};

}  // namespace

TEST_F(Configurations, LoadsMatchingFilesAndSelects) {
    Write("master.json", Config("Veldra_Master", "m"));
    Write("SITE.JSON", Config("Site-A", "a"));
    Write(".json", Config("bare"));
    Write("notes.txt", Config("text"));
    fs::create_directory(directory_ / "nested.json");
    auto store = Store("SITE-a", false);
    store.Load();
    EXPECT_EQ(store.Count(), 2u);
    EXPECT_EQ(store.Selected().Configuration.Host, "a");
    EXPECT_EQ(store.Selected().Configuration.Id, "site-a");
    EXPECT_EQ(store.Selected().Path, (directory_ / "SITE.JSON").string());
    EXPECT_TRUE(store.Selected().Configuration.Loaded);

    EXPECT_EQ(store.Select("", false).Configuration.Host, "m");  // empty id: always the fallback
    EXPECT_EQ(store.Select("elsewhere", true).Configuration.Host, "m");
    EXPECT_EQ(Failure([&] { store.Select("elsewhere", false); }),
              std::make_pair(-251011, std::string("No Veldra configuration 'elsewhere' found, and "
                                                  "fallback configurations were not enabled.")));

    Write("local.json", Config("veldra_localhost", "l"));
    store.Load();
    EXPECT_EQ(store.Select("elsewhere", true).Configuration.Host, "l");  // localhost first
}

TEST_F(Configurations, SelectionWithoutFallbackEntries) {
    Write("a.json", Config("only"));
    auto store = Store("only");
    store.Load();
    EXPECT_EQ(Failure([&] { store.Select("", true); }),
              std::make_pair(-251011, std::string("No Veldra configurations available.")));
    EXPECT_EQ(Failure([&] { store.Select("x", true); }),
              std::make_pair(-251011, std::string("No Veldra configuration 'x' found, and no "
                                                  "fallback configurations available.")));
}

TEST_F(Configurations, BadFilesGiveTheirErrorsAndKeepWhatWasLoaded) {
    Write("good.json", Config("veldra_master", "kept"));
    auto store = Store();
    store.Load();

    struct Case {
        std::string file, text;
        int32_t code;
        std::string message;
    };
    const std::string bad = (directory_ / "bad.json").string();
    const Case cases[] = {
        {"bad.json", "{\"Id\":", -251005, "Malformed Veldra configuration file '" + bad + "'."},
        {"bad.json", "{\"Id\":\"x\",\"Port\":true}", -251004, "Failed to parse: "},
        {"bad.json", "{\"Id\":\"x\",\"Port\":\"56x72\"}", -251004, "Failed to parse: "},
        {"bad.json", "{\"Id\":\"x\",\"ConnectionType\":\"master\"}", -251004, "Failed to parse: "},
        {"bad.json", "[1,2]", -251004, "Failed to parse: "},
        {"bad.json", "{\"Id\":\"VELDRA_master\"}", -251013, ""},
    };
    for (const auto& c : cases) {
        Write(c.file, c.text);
        const auto failure = Failure([&] { store.Load(); });
        EXPECT_EQ(failure.first, c.code) << c.text;
        if (!c.message.empty()) {
            EXPECT_EQ(failure.second, c.message) << c.text;
        }
        EXPECT_EQ(store.Count(), 1u);
        EXPECT_EQ(store.Selected().Configuration.Host, "kept");
    }
    fs::remove(directory_ / "good.json");
    fs::remove(directory_ / "bad.json");
    Write("one.json", "{\"Host\":\"a\"}");
    Write("two.json", "null");  // a null root is an empty record with the id ""
    const auto duplicate = Failure([&] { store.Load(); });
    EXPECT_EQ(duplicate.first, -251013);
    EXPECT_NE(duplicate.second.find("Duplicate id '' in Veldra configuration file '"),
              std::string::npos);

    fs::remove(directory_ / "one.json");
    fs::remove(directory_ / "two.json");
    EXPECT_EQ(Failure([&] { store.Load(); }),
              std::make_pair(
                  -251011, "No Veldra configurations found in directory: " + directory_.string()));
    fs::remove_all(directory_);
    EXPECT_EQ(Failure([&] { store.Load(); }),
              std::make_pair(-251012,
                             "Veldra configurations directory not found: " + directory_.string() +
                                 ". Error: No such file or directory"));
}

TEST_F(Configurations, RefreshLooksAtMostEveryFiveSeconds) {
    Write("a.json", Config("veldra_master", "first"));
    auto store = Store();
    store.Load();

    fs::remove(directory_ / "a.json");
    Write("b.json", Config("veldra_master", "second"));
    now_ += std::chrono::milliseconds(4999);
    store.Refresh();  // too soon: the disk is not looked at
    EXPECT_EQ(store.Selected().Configuration.Host, "first");

    now_ += std::chrono::milliseconds(1);
    store.Refresh();
    EXPECT_EQ(store.Selected().Configuration.Host, "second");

    Write("c.json", Config("other"));
    now_ += std::chrono::seconds(5);
    store.Refresh();
    EXPECT_EQ(store.Count(), 2u);
    fs::remove(directory_ / "c.json");  // one file fewer: reloaded
    now_ += std::chrono::seconds(5);
    store.Refresh();
    EXPECT_EQ(store.Count(), 1u);

    // A broken file breaks look-ups until it is mended; the old entries stay.
    Write("d.json", "{");
    now_ += std::chrono::seconds(5);
    EXPECT_EQ(Failure([&] { store.Refresh(); }).first, -251005);
    EXPECT_EQ(store.Selected().Configuration.Host, "second");
}

TEST(VeldraConfiguration, WriterAndReader) {
    VeldraConfiguration record;
    record.Id = "veldra_master";
    record.Host = "";
    record.Port = 5671;
    record.UseTls = true;
    record.ConnectionType = ConnectionType::Master;
    record.Password = "p\"w";
    EXPECT_EQ(record.ToJson(),
              "{\"Id\":\"veldra_master\",\"DisplayName\":null,\"ConnectionType\":\"Master\","
              "\"ExchangeName\":null,\"Host\":\"\",\"VirtualHost\":null,\"Port\":5671,"
              "\"User\":null,\"Password\":\"p\\\"w\",\"UseTls\":true,\"TlsServerName\":null,"
              "\"CertPath\":null}");

    Korvane::Veldra::VeldraMessageLibrary::JsonVariant root;
    ASSERT_TRUE(Korvane::Veldra::VeldraMessageLibrary::Parse(root, record.ToJson()));
    const auto back = VeldraConfiguration::FromJson(root);
    EXPECT_EQ(back.ToJson(), record.ToJson());
    EXPECT_FALSE(back.DisplayName.has_value());
    EXPECT_EQ(back.Host, "");

    ASSERT_TRUE(Korvane::Veldra::VeldraMessageLibrary::Parse(root, "{\"ConnectionType\":7}"));
    const auto numbered = VeldraConfiguration::FromJson(root);
    EXPECT_EQ(ConnectionTypeText(numbered.ConnectionType), "Local");
    EXPECT_EQ(ConnectionTypeText(std::nullopt), "");
    ASSERT_TRUE(Korvane::Veldra::VeldraMessageLibrary::Parse(root, "{\"ConnectionType\":3}"));
    EXPECT_EQ(ConnectionTypeText(VeldraConfiguration::FromJson(root).ConnectionType), "Client");

    SubjectAltNames names;
    EXPECT_EQ(names.ToJson(), "{\"SubjectAltNames\":null}");
    names.Names = std::vector<std::string>{"broker", "10.0.0.1"};
    EXPECT_EQ(names.ToJson(), "{\"SubjectAltNames\":[\"broker\",\"10.0.0.1\"]}");
    ASSERT_TRUE(Korvane::Veldra::VeldraMessageLibrary::Parse(root, names.ToJson()));
    EXPECT_EQ(SubjectAltNames::FromJson(root).Names, names.Names);
}

TEST_F(Configurations, ProcessStoreUnderTheDataRoot) {
    // The data root is read once per process; this test runs in a process of
    // its own under ctest and skips when an earlier test fixed another root.
    const char* saved = std::getenv("VELDRA_DATA_DIR");
    const std::string savedRoot = saved != nullptr ? saved : "";
    setenv("VELDRA_DATA_DIR", directory_.c_str(), 1);
    const bool ours = Korvane::Veldra::VeldraUtilities::GetDataDirectory() == directory_.string();
    if (saved != nullptr) {
        setenv("VELDRA_DATA_DIR", savedRoot.c_str(), 1);
    } else {
        unsetenv("VELDRA_DATA_DIR");
    }
    if (!ours) GTEST_SKIP() << "data root already fixed in this process";
    fs::create_directories(directory_ / "VeldraConfigurations");
    std::ofstream(directory_ / "VeldraConfigurations" / "m.json") << Config("veldra_master", "pm");
    EXPECT_EQ(BusConfigurations::GetNamed("any", true).Configuration.Host, "pm");
    EXPECT_EQ(BusConfigurations::GetSelected().Configuration.Host, "pm");
    try {
        BusConfigurations::Initialize("x", false);
        ADD_FAILURE();
    } catch (VeldraException* error) {
        EXPECT_EQ(error->Code(), -251010);
        EXPECT_STREQ(error->what(),
                     "Attempt to reinitialize Message Bus with multiple configurations.");
        delete error;
    }
    BusConfigurations::Discard();
}
