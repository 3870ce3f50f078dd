#pragma once

#include <algorithm>
#include <chrono>
#include <condition_variable>
#include <mutex>
#include <set>
#include <string>
#include <utility>
#include <vector>

#include "utilities/tracelogging/ITraceLogger.h"

namespace Korvane::Veldra::MessageBus::Testing {

// A trace logger that keeps its entries: "LOG <point> | <text>" and
// "ERROR <text>". Points named in the constructor come back enabled.
class RecordingTraceLogger : public Interfaces::ITraceLogger {
public:
    explicit RecordingTraceLogger(std::set<std::string> enabledPoints = {})
        : enabled_(std::move(enabledPoints)) {}

    TracePoint GetTracePoint(const std::string& name) override {
        TracePoint point(name);
        point.enabled = enabled_.count(name) != 0;
        return point;
    }
    void Log(const TracePoint& point, const std::string& text) override {
        Add("LOG " + point.name + " | " + text);
    }
    void Error(const std::string& text) override { Add("ERROR " + text); }

    std::vector<std::string> Entries() const {
        std::lock_guard<std::mutex> lock(mutex_);
        return entries_;
    }

    // True once the entry is there, false when the timeout ran out first.
    bool WaitFor(const std::string& entry, std::chrono::milliseconds timeout) {
        std::unique_lock<std::mutex> lock(mutex_);
        return added_.wait_for(lock, timeout, [&] {
            return std::find(entries_.begin(), entries_.end(), entry) != entries_.end();
        });
    }

private:
    void Add(std::string entry) {
        {
            std::lock_guard<std::mutex> lock(mutex_);
            entries_.push_back(std::move(entry));
        }
        added_.notify_all();
    }

    const std::set<std::string> enabled_;
    mutable std::mutex mutex_;
    std::condition_variable added_;
    std::vector<std::string> entries_;
};

}  // namespace Korvane::Veldra::MessageBus::Testing
