#pragma once

#include <kvveldra/TagConsole.h>

#include <boost/asio/steady_timer.hpp>
#include <chrono>
#include <cstddef>
#include <map>
#include <mutex>
#include <string>
#include <vector>

namespace kvtag::serve {

class TagGateway;

// One poll of one tag: when it was polled, and the value and time it had.
struct TrendPoint {
    TagConsoleTime polled;
    std::string value;
    TagConsoleTime time;
};

// The newest `capacity` items; older ones are overwritten.
template <typename T>
class RingBuffer {
public:
    explicit RingBuffer(std::size_t capacity) : capacity_(capacity) {}

    void Push(T item) {
        if (items_.size() < capacity_) {
            items_.push_back(std::move(item));
        } else {
            items_[next_] = std::move(item);
        }
        next_ = (next_ + 1) % capacity_;
    }

    // Oldest first.
    std::vector<T> Items() const {
        if (items_.size() < capacity_) return items_;
        std::vector<T> ordered(items_.begin() + static_cast<std::ptrdiff_t>(next_), items_.end());
        ordered.insert(ordered.end(), items_.begin(),
                       items_.begin() + static_cast<std::ptrdiff_t>(next_));
        return ordered;
    }

private:
    std::size_t capacity_;
    std::size_t next_ = 0;
    std::vector<T> items_;
};

// The last 10 minutes of the tags that the page asks about. A tag is
// polled while it was asked about within the last minute; its points are
// forgotten once nobody asked for 10 minutes. Safe to use from any thread.
class TrendHistory {
public:
    using Clock = std::chrono::steady_clock;
    static constexpr std::chrono::minutes kSpan{10};
    static constexpr std::chrono::seconds kPollEvery{1};
    static constexpr std::chrono::minutes kWatchFor{1};
    // 10 minutes of polls once a second, with room for a late poll or two.
    static constexpr std::size_t kCapacity = 610;
    static constexpr std::size_t kMaxTags = 64;

    // Marks the path as asked about at `now`; false when kMaxTags other
    // tags are watched already.
    bool Watch(const std::string& path, Clock::time_point now);
    // The paths to poll at `now`; forgets the tags nobody asked about for
    // kSpan.
    std::vector<std::string> ToPoll(Clock::time_point now);
    void Record(const std::string& path, TrendPoint point);
    // The points of the last kSpan before `now`, oldest first.
    std::vector<TrendPoint> Points(const std::string& path, TagConsoleTime now) const;

private:
    struct Series {
        Clock::time_point asked;
        RingBuffer<TrendPoint> points{kCapacity};
    };
    mutable std::mutex mutex_;
    std::map<std::string, Series> series_;
};

// Polls the watched tags through the gateway, once a second, on the
// gateway's thread, until the gateway stops.
class TrendPoller {
public:
    TrendPoller(TagGateway& gateway, TrendHistory& history);
    void Start();

private:
    void Schedule();
    void Poll();

    TagGateway& gateway_;
    TrendHistory& history_;
    boost::asio::steady_timer timer_;
    std::string lastFailure_;  // told once, not every second
};

}  // namespace kvtag::serve
