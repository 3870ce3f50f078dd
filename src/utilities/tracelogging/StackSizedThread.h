#pragma once

#include <pthread.h>

#include <cstddef>
#include <functional>

namespace Korvane::Veldra::VeldraUtilities::TraceLogging {

// A thread with a stack of a chosen size, rounded up to whole pages. It starts
// at construction; Join, or the destructor, waits for it to end.
class StackSizedThread {
public:
    StackSizedThread(std::size_t stackBytes, std::function<void()> body);
    // Joins when that has not happened yet.
    ~StackSizedThread();
    StackSizedThread(const StackSizedThread&) = delete;
    StackSizedThread& operator=(const StackSizedThread&) = delete;

    // Waits for the body to end. From the thread itself it throws
    // std::runtime_error "boost thread: trying joining itself". A second
    // join does nothing.
    void Join();
    bool IsCurrentThread() const;

    // The size rounded up to whole pages of this machine.
    static std::size_t RoundedStackSize(std::size_t stackBytes);

private:
    static void* Run(void* self);

    std::function<void()> body_;
    pthread_t thread_{};
    bool joinable_ = false;
};

}  // namespace Korvane::Veldra::VeldraUtilities::TraceLogging
