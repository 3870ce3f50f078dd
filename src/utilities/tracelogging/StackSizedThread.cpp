#include "utilities/tracelogging/StackSizedThread.h"

#include <unistd.h>

#include <stdexcept>
#include <system_error>
#include <utility>

namespace Korvane::Veldra::VeldraUtilities::TraceLogging {

std::size_t StackSizedThread::RoundedStackSize(std::size_t stackBytes) {
    const long page = sysconf(_SC_PAGESIZE);
    const std::size_t pageBytes = page > 0 ? static_cast<std::size_t>(page) : 4096u;
    std::size_t rounded = (stackBytes + pageBytes - 1) / pageBytes * pageBytes;
    if (rounded < static_cast<std::size_t>(PTHREAD_STACK_MIN)) {
        rounded = static_cast<std::size_t>(PTHREAD_STACK_MIN);
    }
    return rounded;
}

StackSizedThread::StackSizedThread(std::size_t stackBytes, std::function<void()> body)
    : body_(std::move(body)) {
    pthread_attr_t attributes;
    int result = pthread_attr_init(&attributes);
    if (result != 0) throw std::system_error(result, std::generic_category(), "pthread_attr_init");
    result = pthread_attr_setstacksize(&attributes, RoundedStackSize(stackBytes));
    if (result == 0) result = pthread_create(&thread_, &attributes, &StackSizedThread::Run, this);
    pthread_attr_destroy(&attributes);
    if (result != 0) throw std::system_error(result, std::generic_category(), "pthread_create");
    joinable_ = true;
}

StackSizedThread::~StackSizedThread() {
    if (joinable_ && !IsCurrentThread()) pthread_join(thread_, nullptr);
}

void* StackSizedThread::Run(void* self) {
    static_cast<StackSizedThread*>(self)->body_();
    return nullptr;
}

void StackSizedThread::Join() {
    if (!joinable_) return;
    if (IsCurrentThread()) throw std::runtime_error("boost thread: trying joining itself");
    pthread_join(thread_, nullptr);
    joinable_ = false;
}

bool StackSizedThread::IsCurrentThread() const {
    return joinable_ && pthread_equal(thread_, pthread_self()) != 0;
}

}  // namespace Korvane::Veldra::VeldraUtilities::TraceLogging
