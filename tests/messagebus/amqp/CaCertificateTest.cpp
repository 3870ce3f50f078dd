#include <gtest/gtest.h>

#include <string>

#include "errors/VeldraException.h"
#include "messagebus/amqp/CaCertificate.h"

namespace Korvane::Veldra::MessageBus {
namespace {

TEST(CaCertificate, Asn1TimesOfBothKinds) {
    struct Case {
        int kind;
        const char* text;
        std::optional<std::time_t> expected;
    };
    const Case cases[] = {
        {kAsn1UtcTime, "700101000000Z", 0},
        {kAsn1UtcTime, "691231235959Z", 3155759999},  // below 70: 20yy
        {kAsn1UtcTime, "240229123456Z", 1709210096},
        {kAsn1GeneralizedTime, "20240229123456Z", 1709210096},
        {kAsn1UtcTime, "2402291234Z", std::nullopt},
        {kAsn1UtcTime, "24022912345xZ", std::nullopt},
        {kAsn1GeneralizedTime, "240229123456Z", std::nullopt},
        {22, "240229123456Z", std::nullopt},
    };
    for (const Case& c : cases) EXPECT_EQ(ParseAsn1Time(c.kind, c.text), c.expected) << c.text;
}

TEST(CaCertificate, MissingFileGivesItsStep) {
    try {
        CaCertificate certificate("/nonexistent/ca.pem");
        FAIL() << "no exception";
    } catch (const VeldraException& error) {
        EXPECT_EQ(error.Code(), -251036);
        EXPECT_EQ(std::string(error.what())
                      .rfind("Failed to load SSL certificate from path "
                             "'/nonexistent/ca.pem'.  BIO read filename "
                             "failed.\n OpenSSL error ",
                             0),
                  0u)
            << error.what();
    }
}

}  // namespace
}  // namespace Korvane::Veldra::MessageBus
