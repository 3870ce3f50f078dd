#include <gtest/gtest.h>

#include <functional>
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
}

TEST(AmqpConnectionManager, NullChannelIsRefusedBeforeAnyConnectionIsTried) {
    // An empty host would fail too, but only after a connect attempt, which
    // logs its first line.
    AmqpConnectionManager manager{VeldraConfiguration{}};
    manager.SetConnectTimeout(0);
    for (const auto& call :
         {std::function<void()>([&] { manager.AddBinding(nullptr, "q", {"k"}, true); }),
          std::function<void()>([&] { manager.SetQos(nullptr, 0, 1, false); })}) {
        try {
            call();
            ADD_FAILURE() << "a null channel was taken";
        } catch (const VeldraException& error) {
            EXPECT_EQ(error.Code(), ErrorCodes::kException);
            EXPECT_EQ(std::string(error.what()), "No AMQP channel given.");
        }
    }
    std::string line;
    EXPECT_FALSE(manager.TakeLog(line, 0)) << line;
}

}  // namespace
}  // namespace Korvane::Veldra::MessageBus
