#include <amqp.h>
#include <amqp_ssl_socket.h>
#include <dlfcn.h>
#include <gtest/gtest.h>

#include <string>

#include "support/BrokerEnvironment.h"
#include "support/RawAmqpConnection.h"

namespace Korvane::Veldra::Testing {
namespace {

// Starts OpenSSL the way the message bus does: through the platform's TLS
// library, loaded by name, with rabbitmq-c told to leave OpenSSL alone.
// Failures are reported by each test: a failed SetUpTestSuite would show as
// skipped tests.
class BrokerTlsSmoke : public ::testing::Test {
protected:
    static void SetUpTestSuite() {
        library_ = dlopen(KVVELDRA_SSLINIT_SONAME, RTLD_LAZY | RTLD_GLOBAL);
        if (library_ == nullptr) {
            error_ = dlerror();
            return;
        }
        auto init = reinterpret_cast<void* (*)()>(dlsym(library_, "KVSSLINIT_Init"));
        context_ = init != nullptr ? init() : nullptr;
        if (context_ == nullptr) {
            error_ = "KVSSLINIT_Init is missing or failed";
            return;
        }
        amqp_set_initialize_ssl_library(0);
    }

    static void TearDownTestSuite() {
        if (library_ == nullptr) {
            return;
        }
        auto uninit = reinterpret_cast<void (*)(void*)>(dlsym(library_, "KVSSLINIT_Uninit"));
        if (uninit != nullptr && context_ != nullptr) {
            uninit(context_);
        }
        dlclose(library_);
        library_ = nullptr;
        context_ = nullptr;
    }

    void SetUp() override {
        if (!error_.empty()) {
            GTEST_FAIL() << "the TLS start-up library did not start: " << error_;
        }
    }

    static void* library_;
    static void* context_;
    static std::string error_;
};

void* BrokerTlsSmoke::library_ = nullptr;
void* BrokerTlsSmoke::context_ = nullptr;
std::string BrokerTlsSmoke::error_;

TEST_F(BrokerTlsSmoke, VerifiesTheServerAgainstTheTestCaAndLogsIn) {
    struct Case {
        const char* name;
        std::string host;
        bool verifyHostname;
    };
    const Case cases[] = {
        {"by name, name checked", Broker().HostName, true},
        {"by address, name not checked", Broker().Host, false},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.name);
        RawAmqpConnection connection;
        ASSERT_EQ(
            connection.OpenTls(c.host, Broker().AmqpsPort, Broker().CaCertPath, c.verifyHostname),
            AMQP_STATUS_OK);
        ASSERT_TRUE(connection.Login(Broker().User, Broker().Password));
        ASSERT_TRUE(connection.OpenChannel(1));
        EXPECT_TRUE(IsNormal(amqp_channel_close(connection.Get(), 1, AMQP_REPLY_SUCCESS)));
    }
}

TEST_F(BrokerTlsSmoke, AnUnrelatedCaFailsPeerVerification) {
    RawAmqpConnection connection;
    EXPECT_EQ(
        connection.OpenTls(Broker().HostName, Broker().AmqpsPort, Broker().OtherCaCertPath, true),
        AMQP_STATUS_SSL_PEER_VERIFY_FAILED);
}

TEST_F(BrokerTlsSmoke, AMissingCaFileFailsBeforeConnecting) {
    RawAmqpConnection connection;
    EXPECT_NE(connection.OpenTls(Broker().HostName, Broker().AmqpsPort,
                                 Broker().Directory + "/no-such-ca.pem", true),
              AMQP_STATUS_OK);
}

}  // namespace
}  // namespace Korvane::Veldra::Testing
