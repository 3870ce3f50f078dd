#pragma once

#include <cstddef>
#include <cstdint>
#include <deque>
#include <mutex>
#include <string>
#include <utility>

#include "messagebus/concurrency/EmptyTake.h"
#include "messagebus/concurrency/Semaphore.h"

namespace Korvane::Veldra::MessageBus {

// A first-in, first-out hand-off between threads: a deque and a semaphore with
// one count per item, plus one per stored error and one for the close. A take
// always sees the items before a stored error or the end of the stream. The
// mutex is held only to push or pop, never while waiting.
template <typename T>
class SharedQueue {
public:
    // A negative bound means no bound.
    explicit SharedQueue(int32_t bound = -1) : Bound(bound) {}
    SharedQueue(const SharedQueue&) = delete;
    SharedQueue& operator=(const SharedQueue&) = delete;

    // Appends the item unless the queue holds Bound items or is closed; a
    // dropped item is not reported.
    void Add(T item) {
        {
            std::lock_guard<std::mutex> lock(Mutex);
            if (Closed || Items.size() >= static_cast<uint32_t>(Bound)) return;
            Items.push_back(std::move(item));
        }
        Available.Release();
    }

    // Appends the item; on a bounded queue that is full, the oldest item
    // makes room for it.
    void AddEvictingOldest(T item) {
        {
            std::lock_guard<std::mutex> lock(Mutex);
            if (Closed) return;
            if (Bound >= 0 && Items.size() >= static_cast<uint32_t>(Bound)) {
                if (Items.empty()) return;
                // The count of the evicted item stands for the new one.
                Items.pop_front();
                Items.push_back(std::move(item));
                return;
            }
            Items.push_back(std::move(item));
        }
        Available.Release();
    }

    // The items queued at the moment.
    std::size_t Size() const {
        std::lock_guard<std::mutex> lock(Mutex);
        return Items.size();
    }

    // Waits up to timeoutMs (see Semaphore::Acquire) for a count. False, with
    // out unchanged, when none came. With a count, moves the oldest item into
    // out and returns true; with no item throws "End Of Stream." on a closed
    // queue, else the stored error text as Veldra.QueueEmpty.
    bool TryTake(T& out, uint32_t timeoutMs) {
        if (!Available.Acquire(timeoutMs)) return false;
        std::unique_lock<std::mutex> lock(Mutex);
        if (!Items.empty()) {
            out = std::move(Items.front());
            Items.pop_front();
            return true;
        }
        if (Closed) {
            // The end of the stream is seen by every later take too.
            Available.Release();
        }
        const bool closed = Closed;
        const std::string errorText = ErrorText;
        lock.unlock();
        ThrowEmptyTake(closed, errorText);
    }

    // Stores the text and wakes one taker without adding an item.
    void SetError(const std::string& text) {
        {
            std::lock_guard<std::mutex> lock(Mutex);
            ErrorText = text;
        }
        Available.Release();
    }

    // Ends the stream: later items are dropped, and once the queued ones are
    // taken every take throws "End Of Stream.".
    void Close() {
        {
            std::lock_guard<std::mutex> lock(Mutex);
            if (Closed) return;
            Closed = true;
        }
        Available.Release();
    }

    // The threads waiting in TryTake (see Semaphore::Waiters).
    int32_t Takers() const { return Available.Waiters(); }

private:
    mutable std::mutex Mutex;
    Semaphore Available;
    std::deque<T> Items;
    bool Closed = false;
    int32_t Bound;
    std::string ErrorText;
};

}  // namespace Korvane::Veldra::MessageBus
