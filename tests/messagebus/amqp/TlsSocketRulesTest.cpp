#include <gtest/gtest.h>

#include "messagebus/amqp/TlsSocketRules.h"

namespace Korvane::Veldra::MessageBus {
namespace {

TEST(TlsSocketRules, HostNamesAreVerifiedAndAddressLiteralsAreNot) {
    for (const char* name : {"localhost", "broker.example.com", "10.0.0.1a"}) {
        EXPECT_TRUE(VerifiesHostName(name)) << name;
    }
    for (const char* literal : {"10.0.0.1", "[::1]", "::1", "fe80::1%eth0", ""}) {
        EXPECT_FALSE(VerifiesHostName(literal)) << literal;
    }
}

TEST(TlsSocketRules, BareCertificateNamesLieUnderTheDataRoot) {
    EXPECT_EQ(ResolveCaCertificatePath("ca.pem", "/data"), "/data/Certificates/ca.pem");
    for (const char* path : {"/etc/ssl/ca.pem", "certs/ca.pem", "./ca.pem"}) {
        EXPECT_EQ(ResolveCaCertificatePath(path, "/data"), path);
    }
}

}  // namespace
}  // namespace Korvane::Veldra::MessageBus
