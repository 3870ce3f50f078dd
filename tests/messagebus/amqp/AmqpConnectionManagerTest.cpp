#include <gtest/gtest.h>

#include <string>

#include "errors/AmqpException.h"
#include "messagebus/amqp/AmqpConnectionManager.h"
#include "errors/ErrorCodes.h"

namespace Korvane::Veldra::MessageBus {
namespace {

TEST(AmqpConnectionManager, LastErrorKeepsTextAndCodeUntilReplaced) {
    AmqpConnectionManager manager{VeldraConfiguration{}};
    VeldraException error(0, "");
    EXPECT_FALSE(manager.GetLastError(error));
    manager.SetLastError(AmqpException(ErrorCodes::kBindingQueue, "bind failed", -9));
    for (int read = 0; read < 2; ++read) {
        ASSERT_TRUE(manager.GetLastError(error));
        EXPECT_EQ(error.Code(), ErrorCodes::kBindingQueue);
        EXPECT_EQ(std::string(error.what()), "bind failed");
    }
    manager.SetLastError(VeldraException(ErrorCodes::kException, "later"));
    ASSERT_TRUE(manager.GetLastError(error));
    EXPECT_EQ(std::string(error.what()), "later");
    AmqpConnectionManager::ReleaseInstance();  // none made: nothing happens
    // A null channel is refused before any connection is made.
    EXPECT_THROW(manager.AddBinding(nullptr, "queue", {"key"}, true), VeldraException);
}

}  // namespace
}  // namespace Korvane::Veldra::MessageBus
