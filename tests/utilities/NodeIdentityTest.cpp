#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>

#include "errors/VeldraException.h"
#include "utilities/NodeIdentity.h"
#include "utilities/Paths.h"

using namespace Korvane::Veldra::VeldraUtilities;
namespace fs = std::filesystem;

namespace {

// A configuration directory of the test's own, and VELDRA_NODENAME unset for
// its length.
class NodeName : public ::testing::Test {
protected:
    void SetUp() override {
        const char* saved = std::getenv("VELDRA_NODENAME");
        if (saved != nullptr) savedName_ = saved;
        hadName_ = saved != nullptr;
        unsetenv("VELDRA_NODENAME");
        directory_ = fs::temp_directory_path() /
                     ("kvveldra-node-" + std::to_string(::getpid()) + "-" +
                      ::testing::UnitTest::GetInstance()->current_test_info()->name());
        fs::create_directories(directory_);
    }
    void TearDown() override {
        fs::remove_all(directory_);
        if (hadName_) setenv("VELDRA_NODENAME", savedName_.c_str(), 1);
    }
    void WriteFile(const std::string& text) {
        std::ofstream(directory_ / "NodeName.txt", std::ios::binary) << text;
    }
    std::string Compute() const { return ComputeNodeName(directory_.string()); }
    static std::string LowerHost() {
        std::string host = GetHostName();
        for (char& c : host) c = static_cast<char>(std::tolower(static_cast<unsigned char>(c)));
        return host;
    }

    fs::path directory_;
    std::string savedName_;
    bool hadName_ = false;
};

}  // namespace

TEST_F(NodeName, EnvironmentWinsAndIsLowerCased) {
    WriteFile("from-file");
    setenv("VELDRA_NODENAME", "LINE-7 Station", 1);
    EXPECT_EQ(Compute(), "line-7 station");
}

TEST_F(NodeName, FileReplacesTheHostNameUnlessEmptyOrLocalhost) {
    EXPECT_EQ(Compute(), LowerHost());  // no file
    WriteFile("");
    EXPECT_EQ(Compute(), LowerHost());
    WriteFile("LOCALHOST");
    EXPECT_EQ(Compute(), LowerHost());
    WriteFile("Press-04");
    EXPECT_EQ(Compute(), "press-04");
    WriteFile("localhost\n");  // a newline makes it another name; the file is taken whole
    EXPECT_EQ(Compute(), "localhost\n");
    fs::remove(directory_ / "NodeName.txt");
    fs::create_directory(directory_ / "NodeName.txt");  // not a regular file
    EXPECT_EQ(Compute(), LowerHost());
}

TEST(Paths, LayoutBelowTheDataRoot) {
    const std::string root = GetDataDirectory();
    EXPECT_FALSE(root.empty());  // the root itself is fixed at the first call of the process
    EXPECT_EQ(GetConfigDirectory(), root + "/Config");
    EXPECT_EQ(GetLogDirectory(), root + "/Logs");
    EXPECT_EQ(GetDefaultProductName(), "KV Fenmark");
    try {
        GetApplicationDirectory();
        ADD_FAILURE();
    } catch (Korvane::Veldra::MessageBus::VeldraException* error) {
        EXPECT_STREQ(error->what(), "Could not determine Application Directory");
        delete error;
    }
}

TEST(Paths, NodeNameIsCachedForTheProcess) {
    const std::string first = GetNodeName();
    EXPECT_FALSE(first.empty());
    setenv("VELDRA_NODENAME", "changed-later", 1);
    EXPECT_EQ(GetNodeName(), first);
    unsetenv("VELDRA_NODENAME");
}
