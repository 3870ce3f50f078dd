#include <dlfcn.h>
#include <gtest/gtest.h>

#include <stdexcept>
#include <string>

#include "support/CatchVeldra.h"
#include "FakeSslInit.h"
#include "errors/ErrorCodes.h"
#include "messagebus/amqp/SslInitLibrary.h"

namespace Korvane::Veldra::MessageBus {
namespace {

using Testing::fakeSsl;

TEST(SslInitLibrary, LoadsOnFirstAcquireAndUnloadsOnLastRelease) {
    fakeSsl = {};
    SslInitLibrary library("libfake.so", Testing::FakeSslLoader());
    library.Acquire();
    library.Acquire();
    library.Release();
    EXPECT_EQ(fakeSsl.opens, 1);
    EXPECT_EQ(fakeSsl.openFlags, RTLD_LAZY | RTLD_GLOBAL);
    EXPECT_EQ(fakeSsl.inits, 1);
    EXPECT_EQ(fakeSsl.uninits, 0);
    library.Release();  // the cleanup gets the context that Init returned
    library.Release();  // at zero: nothing
    EXPECT_EQ(fakeSsl.uninits, 1);
    EXPECT_EQ(fakeSsl.closes, 1);
    EXPECT_EQ(library.Count(), 0);
}

TEST(SslInitLibrary, FailedFirstAcquireUnloadsAndGivesTheReason) {
    struct Case {
        void (*arrange)(Testing::FakeSslState&);
        const char* text;
    };
    const Case cases[] = {
        {[](auto& s) { s.openFails = true; }, "Failed to load KV-SSL Initialization library"},
        {[](auto& s) { s.hasInit = false; },
         "Failed to find initialization routine in KV-SSL Initialization library"},
        {[](auto& s) { s.hasUninit = false; },
         "Failed to find cleanup routine in KV-SSL Initialization library"},
        {[](auto& s) { s.initFails = true; },
         "Initialization routine in KV-SSL Initialization library failed"},
    };
    for (const Case& c : cases) {
        fakeSsl = {};
        c.arrange(fakeSsl);
        SslInitLibrary library("libfake.so", Testing::FakeSslLoader());
        EXPECT_THROWS_VELDRA(SslInitLease(library), ErrorCodes::kFailedToInitializeKVSSL,
                             c.text);
        EXPECT_EQ(fakeSsl.closes, fakeSsl.openFails ? 0 : 1) << c.text;
        EXPECT_EQ(library.Count(), 0);
    }
    // The real loader with a library that is not there.
    SslInitLibrary missing("libkvveldra-no-such-library.so.13");
    EXPECT_THROW(missing.Acquire(), std::runtime_error);
}

}  // namespace
}  // namespace Korvane::Veldra::MessageBus
