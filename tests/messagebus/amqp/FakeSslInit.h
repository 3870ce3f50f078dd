#pragma once

#include <string>

#include "messagebus/amqp/SslInitLibrary.h"

namespace Korvane::Veldra::MessageBus::Testing {

// A stand-in for the dynamic loader and the platform's TLS start-up library:
// a switch for each failure and a count of each call.
struct FakeSslState {
    bool openFails = false, hasInit = true, hasUninit = true, initFails = false;
    int opens = 0, closes = 0, inits = 0, uninits = 0, openFlags = 0;
};

inline FakeSslState fakeSsl;
inline int fakeSslContext = 0;

inline void* FakeInit() {
    ++fakeSsl.inits;
    return fakeSsl.initFails ? nullptr : &fakeSslContext;
}
inline void FakeUninit(void* context) {
    fakeSsl.uninits += context == &fakeSslContext;
}

inline SslInitLibrary::Loader FakeSslLoader() {
    return {[](const char*, int flags) -> void* {
                ++fakeSsl.opens;
                fakeSsl.openFlags = flags;
                return fakeSsl.openFails ? nullptr : &fakeSsl;
            },
            [](void*, const char* name) -> void* {
                const std::string symbol(name);
                if (symbol == "KVSSLINIT_Init" && fakeSsl.hasInit) {
                    return reinterpret_cast<void*>(&FakeInit);
                }
                if (symbol == "KVSSLINIT_Uninit" && fakeSsl.hasUninit) {
                    return reinterpret_cast<void*>(&FakeUninit);
                }
                return nullptr;
            },
            [](void*) { return ++fakeSsl.closes, 0; }};
}

}  // namespace Korvane::Veldra::MessageBus::Testing
