#pragma once

#include <cstdint>
#include <mutex>
#include <string>

namespace Korvane::Veldra::MessageBus {

// The platform's TLS start-up library, loaded at run time and shared by every
// connection of the process through a count: the first acquire loads it and
// calls its initialisation routine, the last release calls the cleanup
// routine with the context that initialisation returned and unloads it.
class SslInitLibrary {
public:
    // The dynamic loader's three calls; replaceable so that the count and its
    // failures can be exercised without the library.
    struct Loader {
        void* (*open)(const char* name, int flags);
        void* (*symbol)(void* handle, const char* name);
        int (*close)(void* handle);
    };
    static Loader SystemLoader();

    // The instance every connection of the process shares, over
    // "libkvsslinit.so.13".
    static SslInitLibrary& Process();

    explicit SslInitLibrary(std::string libraryName, Loader loader = SystemLoader());
    SslInitLibrary(const SslInitLibrary&) = delete;
    SslInitLibrary& operator=(const SslInitLibrary&) = delete;

    // Raises the count; the first acquire loads and initialises, and on any
    // failure unloads again and throws std::runtime_error with the reason.
    void Acquire();
    // Lowers the count; at zero cleans up and unloads. Does nothing at zero.
    void Release();
    int32_t Count() const;

private:
    using InitRoutine = void* (*)();
    using UninitRoutine = void (*)(void*);

    const std::string libraryName_;
    const Loader loader_;
    mutable std::mutex mutex_;
    int32_t count_ = 0;
    void* handle_ = nullptr;
    void* context_ = nullptr;
    UninitRoutine uninit_ = nullptr;
};

// One acquire of an SslInitLibrary for the lifetime of the object. A failed
// acquire is thrown as VeldraException with the reason's text and the code of
// "Veldra.FailedToInitializeKVSSL".
class SslInitLease {
public:
    explicit SslInitLease(SslInitLibrary& library);
    ~SslInitLease();
    SslInitLease(const SslInitLease&) = delete;
    SslInitLease& operator=(const SslInitLease&) = delete;

private:
    SslInitLibrary& library_;
};

}  // namespace Korvane::Veldra::MessageBus
