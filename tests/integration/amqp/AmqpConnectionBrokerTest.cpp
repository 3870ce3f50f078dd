#include <amqp.h>
#include <gtest/gtest.h>
#include <netdb.h>
#include <netinet/in.h>

#include <filesystem>
#include <memory>
#include <optional>
#include <string>

#include "errors/AmqpException.h"
#include "messagebus/amqp/AmqpConnection.h"
#include "errors/ErrorCodes.h"
#include "messagebus/amqp/TestCertificates.h"
#include "support/BrokerEnvironment.h"
#include "support/RawAmqpConnection.h"

namespace Korvane::Veldra::MessageBus {
namespace {

namespace Harness = ::Korvane::Veldra::Testing;
using Harness::Broker;

// The base connection alone, with no reader or reconnect thread.
class BareConnection : public AmqpConnection {
public:
    using AmqpConnection::AmqpConnection;
    void ReconnectLoop() override {}
    void ReaderLoop() override {}
};

std::unique_ptr<BareConnection> Connect(const std::string& exchange, const std::string& host = "",
                                        const std::string& caPath = "") {
    const bool tls = !host.empty();
    return std::make_unique<BareConnection>(
        nullptr, Broker().User, Broker().Password, tls ? host : Broker().Host,
        tls ? Broker().AmqpsPort : Broker().AmqpPort, exchange, tls, "", caPath, 10000, 30);
}

std::optional<AmqpException> TlsFailure(const std::string& host, const std::string& caPath) {
    try {
        Connect("kvveldra.amqpconn.tls", host, caPath);
    } catch (const AmqpException& error) {
        return error;
    }
    return std::nullopt;
}

// Another name of 127.0.0.1 that the broker's certificate does not carry.
std::optional<std::string> UncertifiedLoopbackName() {
    for (const char* name : {"vm", "runsc", "localhost.localdomain"}) {
        addrinfo hints{};
        hints.ai_family = AF_INET;
        addrinfo* found = nullptr;
        if (getaddrinfo(name, nullptr, &hints, &found) != 0) continue;
        const auto* address = reinterpret_cast<const sockaddr_in*>(found->ai_addr);
        const bool loopback = address->sin_addr.s_addr == htonl(INADDR_LOOPBACK);
        freeaddrinfo(found);
        if (loopback) return std::string(name);
    }
    return std::nullopt;
}

TEST(AmqpConnectionBroker, FreedChannelNumbersAreTakenAgainLowestFirst) {
    const auto connection = Connect("kvveldra.amqpconn.numbering");
    for (uint16_t id = 1; id <= 3; ++id) EXPECT_EQ(connection->CreateChannel()->Id, id);
    connection->CloseChannel(2);
    EXPECT_EQ(connection->FindChannel(2), nullptr);
    EXPECT_EQ(connection->CreateChannel()->Id, 2);
    connection->SetQos(2, 0, 100, false);  // the reused number is open
}

TEST(AmqpConnectionBroker, ExchangeIsDeclaredOncePerConnectionObject) {
    const std::string exchange = "kvveldra.amqpconn.declared-once";
    const auto connection = Connect(exchange);
    connection->CreateChannel();

    // An exchange of another type in its place makes any further declaration
    // of the topic exchange fail.
    Harness::RawAmqpConnection raw;
    ASSERT_EQ(raw.OpenTcp(Broker().Host, Broker().AmqpPort), AMQP_STATUS_OK);
    ASSERT_TRUE(raw.Login(Broker().User, Broker().Password));
    ASSERT_TRUE(raw.OpenChannel(1));
    amqp_exchange_delete(raw.Get(), 1, amqp_cstring_bytes(exchange.c_str()), 0);
    ASSERT_TRUE(Harness::IsNormal(amqp_get_rpc_reply(raw.Get())));
    amqp_exchange_declare(raw.Get(), 1, amqp_cstring_bytes(exchange.c_str()),
                          amqp_cstring_bytes("direct"), 0, 0, 1, 0, amqp_empty_table);
    ASSERT_TRUE(Harness::IsNormal(amqp_get_rpc_reply(raw.Get())));

    EXPECT_EQ(connection->CreateChannel()->Id, 2);  // no second declaration
    try {
        Connect(exchange)->CreateChannel();
        ADD_FAILURE() << "the first channel of a new connection did not declare";
    } catch (const AmqpException& error) {
        EXPECT_EQ(error.Code(), ErrorCodes::kDeclaringExchange);
        EXPECT_EQ(std::string(error.what()),
                  "Error declaring topic exchange. Channel ID: 1. Exchange name: \"" + exchange +
                      "\". AMQP Server Exception. Method Id: " +
                      std::to_string(AMQP_CHANNEL_CLOSE_METHOD));
    }
    amqp_exchange_delete(raw.Get(), 1, amqp_cstring_bytes(exchange.c_str()), 0);
}

TEST(AmqpConnectionBroker, ConnectAgainReopensChannelsWithTheirNumbers) {
    const auto connection = Connect("kvveldra.amqpconn.reopen");
    connection->CreateChannel();
    connection->CreateChannel();
    ASSERT_TRUE(Harness::CloseAllConnections());
    connection->Connect();
    // A method on a channel that is not open would close the connection.
    connection->SetQos(1, 0, 10, false);
    connection->SetQos(2, 0, 10, false);
    EXPECT_EQ(connection->CreateChannel()->Id, 3);
}

TEST(AmqpConnectionBroker, TlsChecksThePeerAlwaysAndTheNameOnlyForNames) {
    // Both are in the certificate; with a name check, the address would fail.
    EXPECT_NO_THROW(Connect("kvveldra.amqpconn.tls", Broker().HostName, Broker().CaCertPath));
    EXPECT_NO_THROW(Connect("kvveldra.amqpconn.tls", Broker().Host, Broker().CaCertPath));

    auto failure = TlsFailure(Broker().HostName, Broker().OtherCaCertPath);
    ASSERT_TRUE(failure.has_value());
    EXPECT_EQ(failure->Code(), ErrorCodes::kPeerVerifyFailed);
    EXPECT_EQ(std::string(failure->what()),
              "SSL peer verification failed. RabbitMQ client (rabbitmq-c) status code: -514");

    const std::string expired =
        (std::filesystem::temp_directory_path() / "kvveldra-amqpconn-expired-ca.pem").string();
    Testing::WriteSelfSignedCa(expired, -7200, -3600);
    failure = TlsFailure(Broker().HostName, expired);
    std::filesystem::remove(expired);
    ASSERT_TRUE(failure.has_value());
    EXPECT_EQ(failure->Code(), ErrorCodes::kCertificateExpired);
    EXPECT_EQ(std::string(failure->what()),
              "Certificate expired or system time incorrect. RabbitMQ client (rabbitmq-c) status "
              "code: -514");

    const auto otherName = UncertifiedLoopbackName();
    if (!otherName) GTEST_SKIP() << "no other name of 127.0.0.1 to check the name with";
    failure = TlsFailure(*otherName, Broker().CaCertPath);
    ASSERT_TRUE(failure.has_value()) << *otherName << " passed the name check";
    EXPECT_EQ(failure->Status(), AMQP_STATUS_SSL_HOSTNAME_VERIFY_FAILED) << failure->what();
}

}  // namespace
}  // namespace Korvane::Veldra::MessageBus
