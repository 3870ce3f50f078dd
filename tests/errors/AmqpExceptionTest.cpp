#include <gtest/gtest.h>

#include <string>

#include "errors/AmqpException.h"

namespace Korvane::Veldra::MessageBus {
namespace {

TEST(AmqpException, IsCaughtAsVeldraExceptionWithItsStatus) {
    try {
        throw AmqpException(-251032, "Error publishing message. AMQP status: -9", -9);
    } catch (const VeldraException& e) {
        EXPECT_EQ(e.Code(), -251032);
        EXPECT_EQ(std::string(e.what()), "Error publishing message. AMQP status: -9");
        const auto* amqp = dynamic_cast<const AmqpException*>(&e);
        ASSERT_NE(amqp, nullptr);
        EXPECT_EQ(amqp->Status(), -9);
    }
    EXPECT_EQ(AmqpException(-251017, "no reply").Status(), 0);
}

}  // namespace
}  // namespace Korvane::Veldra::MessageBus
