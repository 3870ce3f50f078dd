#pragma once

#include <atomic>
#include <cstddef>
#include <map>
#include <mutex>
#include <utility>
#include <vector>

namespace Korvane::Veldra::MessageBus {

// An ordered map behind a mutex. Every operation holds the mutex for that call
// alone; the compound steps the bus needs (take, conditional erase) are
// operations of their own so that no caller has to hold the lock itself. The
// mutex is never held across a call into another component: predicates given
// to EraseIf must not call out.
template <typename K, typename V>
class ThreadSafeMap {
public:
    ThreadSafeMap() = default;
    ThreadSafeMap(const ThreadSafeMap&) = delete;
    ThreadSafeMap& operator=(const ThreadSafeMap&) = delete;

    // False, and nothing changed, when the key exists.
    bool Insert(const K& key, V value) {
        std::lock_guard<std::mutex> lock(mutex_);
        const bool inserted = map_.emplace(key, std::move(value)).second;
        size_.store(map_.size(), std::memory_order_relaxed);
        return inserted;
    }

    // Inserts or replaces; true when the key was new.
    bool InsertOrAssign(const K& key, V value) {
        std::lock_guard<std::mutex> lock(mutex_);
        const bool inserted = map_.insert_or_assign(key, std::move(value)).second;
        size_.store(map_.size(), std::memory_order_relaxed);
        return inserted;
    }

    bool TryGet(const K& key, V& out) const {
        std::lock_guard<std::mutex> lock(mutex_);
        const auto found = map_.find(key);
        if (found == map_.end()) return false;
        out = found->second;
        return true;
    }

    // Look-up and erase in one step: moves the value out and removes the entry.
    bool TryTake(const K& key, V& out) {
        std::lock_guard<std::mutex> lock(mutex_);
        const auto found = map_.find(key);
        if (found == map_.end()) return false;
        out = std::move(found->second);
        map_.erase(found);
        size_.store(map_.size(), std::memory_order_relaxed);
        return true;
    }

    // TryTake of an entry for which shouldTake(value) is true.
    template <typename Predicate>
    bool TakeIf(const K& key, Predicate shouldTake, V& out) {
        std::lock_guard<std::mutex> lock(mutex_);
        const auto found = map_.find(key);
        if (found == map_.end() || !shouldTake(static_cast<const V&>(found->second))) return false;
        out = std::move(found->second);
        map_.erase(found);
        size_.store(map_.size(), std::memory_order_relaxed);
        return true;
    }
    bool Erase(const K& key) {
        std::lock_guard<std::mutex> lock(mutex_);
        const bool erased = map_.erase(key) != 0;
        size_.store(map_.size(), std::memory_order_relaxed);
        return erased;
    }

    // Erases the entry when it exists and shouldErase(value) is true.
    template <typename Predicate>
    bool EraseIf(const K& key, Predicate shouldErase) {
        std::lock_guard<std::mutex> lock(mutex_);
        const auto found = map_.find(key);
        if (found == map_.end() || !shouldErase(static_cast<const V&>(found->second))) {
            return false;
        }
        map_.erase(found);
        size_.store(map_.size(), std::memory_order_relaxed);
        return true;
    }

    // Erases every entry for which shouldErase(key, value) is true, in one
    // hold of the lock, and returns their keys.
    template <typename Predicate>
    std::vector<K> EraseWhere(Predicate shouldErase) {
        std::lock_guard<std::mutex> lock(mutex_);
        std::vector<K> erased;
        for (auto entry = map_.begin(); entry != map_.end();) {
            if (shouldErase(entry->first, static_cast<const V&>(entry->second))) {
                erased.push_back(entry->first);
                entry = map_.erase(entry);
            } else {
                ++entry;
            }
        }
        size_.store(map_.size(), std::memory_order_relaxed);
        return erased;
    }

    // All keys in key order.
    std::vector<K> Keys() const {
        std::lock_guard<std::mutex> lock(mutex_);
        std::vector<K> keys;
        keys.reserve(map_.size());
        for (const auto& entry : map_) keys.push_back(entry.first);
        return keys;
    }

    std::size_t Size() const {
        std::lock_guard<std::mutex> lock(mutex_);
        return map_.size();
    }

    // Without the lock: whether the map was empty a moment ago. For a quick
    // look before the locked one, where a stale answer does no harm.
    bool SeemsEmpty() const { return size_.load(std::memory_order_relaxed) == 0; }

private:
    mutable std::mutex mutex_;
    std::map<K, V> map_;
    std::atomic<std::size_t> size_{0};  // map_.size() as of the last change
};

}  // namespace Korvane::Veldra::MessageBus
