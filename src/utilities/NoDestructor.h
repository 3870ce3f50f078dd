#pragma once

#include <new>
#include <utility>

namespace Korvane::Veldra::VeldraUtilities {

// A process-wide object that is built on first use and never destroyed, so
// that it outlives every static destructor that may still reach it. It lives
// in static storage rather than on the heap: unloading the library then
// leaves no allocation of its own behind.
template <typename T>
class NoDestructor {
public:
    template <typename... Args>
    explicit NoDestructor(Args&&... args) {
        new (storage_) T(std::forward<Args>(args)...);
    }
    NoDestructor(const NoDestructor&) = delete;
    NoDestructor& operator=(const NoDestructor&) = delete;

    T& Get() { return *std::launder(reinterpret_cast<T*>(storage_)); }

private:
    alignas(T) unsigned char storage_[sizeof(T)];
};

}  // namespace Korvane::Veldra::VeldraUtilities
