#pragma once

#include <exception>
#include <mutex>
#include <string>
#include <thread>
#include <vector>

namespace Korvane::Veldra::Bench {

// Runs work(i) for i from 0 to count - 1, each on a thread of its own, all
// at once, and returns when all are done: the first failure's text (what
// work returned, or the text of what it threw), or an empty text.
template <typename Work>
std::string OnThreads(int count, Work& work) {
    std::mutex mutex;
    std::string failure;
    std::vector<std::thread> threads;
    threads.reserve(static_cast<size_t>(count));
    for (int i = 0; i < count; ++i) {
        threads.emplace_back([&, i] {
            std::string text;
            try {
                text = work(i);
            } catch (const std::exception& error) {
                text = error.what();
            }
            std::lock_guard<std::mutex> lock(mutex);
            if (failure.empty()) failure = text;
        });
    }
    for (std::thread& thread : threads) thread.join();
    return failure;
}

}  // namespace Korvane::Veldra::Bench
