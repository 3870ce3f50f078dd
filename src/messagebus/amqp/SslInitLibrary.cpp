#include "messagebus/amqp/SslInitLibrary.h"

#include <dlfcn.h>

#include <stdexcept>
#include <utility>

#include "errors/VeldraException.h"
#include "errors/ErrorCodes.h"

#ifndef KVVELDRA_SSLINIT_SONAME
#define KVVELDRA_SSLINIT_SONAME "libkvsslinit.so.13"
#endif

namespace Korvane::Veldra::MessageBus {

SslInitLibrary::Loader SslInitLibrary::SystemLoader() {
    return Loader{[](const char* name, int flags) { return dlopen(name, flags); },
                  [](void* handle, const char* name) { return dlsym(handle, name); },
                  [](void* handle) { return dlclose(handle); }};
}

SslInitLibrary& SslInitLibrary::Process() {
    static SslInitLibrary library(KVVELDRA_SSLINIT_SONAME);
    return library;
}

SslInitLibrary::SslInitLibrary(std::string libraryName, Loader loader)
    : libraryName_(std::move(libraryName)), loader_(loader) {}

void SslInitLibrary::Acquire() {
    std::lock_guard<std::mutex> lock(mutex_);
    if (count_ > 0) {
        ++count_;
        return;
    }
    void* handle = loader_.open(libraryName_.c_str(), RTLD_LAZY | RTLD_GLOBAL);
    if (handle == nullptr) {
        throw std::runtime_error("Failed to load KV-SSL Initialization library");
    }
    auto fail = [&](const char* text) {
        loader_.close(handle);
        throw std::runtime_error(text);
    };
    auto init = reinterpret_cast<InitRoutine>(loader_.symbol(handle, "KVSSLINIT_Init"));
    if (init == nullptr)
        fail("Failed to find initialization routine in KV-SSL Initialization library");
    auto uninit = reinterpret_cast<UninitRoutine>(loader_.symbol(handle, "KVSSLINIT_Uninit"));
    if (uninit == nullptr) fail("Failed to find cleanup routine in KV-SSL Initialization library");
    void* context = init();
    if (context == nullptr) fail("Initialization routine in KV-SSL Initialization library failed");
    handle_ = handle;
    context_ = context;
    uninit_ = uninit;
    count_ = 1;
}

void SslInitLibrary::Release() {
    std::lock_guard<std::mutex> lock(mutex_);
    if (count_ == 0) return;
    if (--count_ > 0) return;
    uninit_(context_);
    loader_.close(handle_);
    handle_ = nullptr;
    context_ = nullptr;
    uninit_ = nullptr;
}

int32_t SslInitLibrary::Count() const {
    std::lock_guard<std::mutex> lock(mutex_);
    return count_;
}

SslInitLease::SslInitLease(SslInitLibrary& library) : library_(library) {
    try {
        library_.Acquire();
    } catch (const std::runtime_error& error) {
        throw VeldraException(ErrorCodes::kFailedToInitializeKVSSL, error.what());
    }
}

SslInitLease::~SslInitLease() {
    library_.Release();
}

}  // namespace Korvane::Veldra::MessageBus
