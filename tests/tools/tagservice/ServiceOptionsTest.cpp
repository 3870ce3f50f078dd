#include <gtest/gtest.h>

#include <stdexcept>

#include "ServiceOptions.h"

namespace Korvane::Veldra::TagService {
namespace {

TEST(ServiceOptionsTest, DefaultsAndEveryOption) {
    const ServiceOptions defaults = ParseServiceOptions({});
    EXPECT_EQ(defaults.configurationId, "veldra_master");
    EXPECT_TRUE(defaults.storeFile.empty());
    EXPECT_FALSE(defaults.verbose);
    EXPECT_FALSE(defaults.serviceGuid);

    const ServiceOptions all = ParseServiceOptions(
        {"--config", "veldra_localhost", "--store", "/x/t.db", "--verbose", "--connect-timeout",
         "2500", "--service-guid", "9d1e", "--durable-queue", "q", "--queue-type", "quorum",
         "--help"});
    EXPECT_EQ(all.configurationId, "veldra_localhost");
    EXPECT_EQ(all.storeFile, "/x/t.db");
    EXPECT_TRUE(all.verbose);
    EXPECT_TRUE(all.help);
    EXPECT_EQ(all.connectTimeoutMs, 2500);
    EXPECT_EQ(all.serviceGuid, "9d1e");
    EXPECT_EQ(all.queueType, "quorum");
}

TEST(ServiceOptionsTest, BadArgumentsAreRefusedByName) {
    for (const std::vector<std::string>& args :
         std::vector<std::vector<std::string>>{{"--store"},
                                               {"--config", ""},
                                               {"--connect-timeout", "0"},
                                               {"--connect-timeout", "12x"},
                                               {"--service-guid"},
                                               {"--queue-type", "lazy"},
                                               {"--queue-type", "quorum"},
                                               {"--storage", "f"}}) {
        try {
            ParseServiceOptions(args);
            ADD_FAILURE() << args.front() << " was taken";
        } catch (const std::invalid_argument& error) {
            EXPECT_NE(std::string(error.what()).find(args.front()), std::string::npos)
                << error.what();
        }
    }
}

TEST(ServiceOptionsTest, HelpNamesTheReadyLine) {
    EXPECT_NE(UsageText().find(kReadyLine), std::string::npos);
}

}  // namespace
}  // namespace Korvane::Veldra::TagService
