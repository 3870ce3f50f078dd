#include "TrendHistory.h"

#include <cstdio>

#include "TagGateway.h"
#include "TimeText.h"

namespace kvtag::serve {

bool TrendHistory::Watch(const std::string& path, Clock::time_point now) {
    std::lock_guard<std::mutex> lock(mutex_);
    auto found = series_.find(path);
    if (found == series_.end()) {
        if (series_.size() >= kMaxTags) return false;
        found = series_.emplace(path, Series{}).first;
    }
    found->second.asked = now;
    return true;
}

std::vector<std::string> TrendHistory::ToPoll(Clock::time_point now) {
    std::lock_guard<std::mutex> lock(mutex_);
    std::vector<std::string> paths;
    for (auto it = series_.begin(); it != series_.end();) {
        if (now - it->second.asked > kSpan) {
            it = series_.erase(it);
            continue;
        }
        if (now - it->second.asked <= kWatchFor) paths.push_back(it->first);
        ++it;
    }
    return paths;
}

void TrendHistory::Record(const std::string& path, TrendPoint point) {
    std::lock_guard<std::mutex> lock(mutex_);
    const auto found = series_.find(path);
    if (found != series_.end()) found->second.points.Push(std::move(point));
}

std::vector<TrendPoint> TrendHistory::Points(const std::string& path, TagConsoleTime now) const {
    std::lock_guard<std::mutex> lock(mutex_);
    const auto found = series_.find(path);
    if (found == series_.end()) return {};
    std::vector<TrendPoint> points;
    for (auto& point : found->second.points.Items()) {
        if (now - point.polled <= kSpan) points.push_back(std::move(point));
    }
    return points;
}

TrendPoller::TrendPoller(TagGateway& gateway, TrendHistory& history)
    : gateway_(gateway), history_(history), timer_(gateway.Executor()) {}

void TrendPoller::Start() {
    Schedule();
}

void TrendPoller::Schedule() {
    timer_.expires_after(TrendHistory::kPollEvery);
    timer_.async_wait([this](const boost::system::error_code& error) {
        if (error) return;
        Poll();
        Schedule();
    });
}

void TrendPoller::Poll() {
    const std::vector<std::string> paths = history_.ToPoll(TrendHistory::Clock::now());
    if (paths.empty()) return;
    try {
        const Reading reading = gateway_.Read(paths);
        const TagConsoleTime polled = NowTime();
        for (const auto& value : reading.values) {
            // A tag never written has no value to plot.
            if (value.timestamp == TagConsoleTime::min()) continue;
            history_.Record(value.path, {polled, value.value, value.timestamp});
        }
        lastFailure_.clear();
    } catch (const std::exception& failure) {
        // The page's own reads show the failure; the plot just gets a gap.
        if (lastFailure_ != failure.what()) {
            lastFailure_ = failure.what();
            std::fprintf(stderr, "kvtag serve: polling the plotted tags: %s\n", failure.what());
        }
    }
}

}  // namespace kvtag::serve
