#pragma once

#include <deque>
#include <mutex>
#include <utility>

#include "messagebus/concurrency/EmptyTake.h"
#include "messagebus/concurrency/Semaphore.h"

namespace Korvane::Veldra::MessageBus {

// The handler queue: producers push at the front, consumers wait without limit
// and take from the back, so items leave first in, first out.
template <typename T>
class BlockingCollection {
public:
    BlockingCollection() = default;
    BlockingCollection(const BlockingCollection&) = delete;
    BlockingCollection& operator=(const BlockingCollection&) = delete;

    void Push(T item) {
        {
            std::lock_guard<std::mutex> lock(Mutex);
            if (Closed) return;
            Items.push_front(std::move(item));
        }
        Available.Release();
    }

    // Waits for an item. Once the collection is closed and drained, throws
    // "End Of Stream." to every consumer, which is how their threads end.
    T Take() {
        Available.Wait();
        std::lock_guard<std::mutex> lock(Mutex);
        if (Items.empty()) {
            if (Closed) Available.Release();
            ThrowEmptyTake(Closed, std::string());
        }
        T item = std::move(Items.back());
        Items.pop_back();
        return item;
    }

    // Drops later pushes and ends the consumers once the queue is drained.
    void Close() {
        {
            std::lock_guard<std::mutex> lock(Mutex);
            if (Closed) return;
            Closed = true;
        }
        Available.Release();
    }

private:
    Semaphore Available;
    std::deque<T> Items;
    std::mutex Mutex;
    bool Closed = false;
};

}  // namespace Korvane::Veldra::MessageBus
