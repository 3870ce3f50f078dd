#pragma once

#include <kvveldra/TagConsole.h>

#include <atomic>
#include <boost/asio/any_io_executor.hpp>
#include <boost/asio/thread_pool.hpp>
#include <cstdint>
#include <functional>
#include <string>
#include <vector>

#include "ConsoleSession.h"

namespace kvtag::serve {

// What a read found: the values of the tags that exist, in the order asked,
// and the paths that name no tag.
struct Reading {
    std::vector<TagConsoleValue> values;
    std::vector<std::string> missing;
};

// The one thread that calls the library. Requests of the page and the
// trend poller queue here, so that a slow tag service holds up only the
// answers that need it, never the connections of the HTTP server.
class TagGateway {
public:
    // The most jobs that may wait; more are refused.
    static constexpr std::size_t kMaxQueued = 64;

    explicit TagGateway(const ConsoleInstance& instance);
    ~TagGateway();
    TagGateway(const TagGateway&) = delete;
    TagGateway& operator=(const TagGateway&) = delete;

    // Runs `job` on the library's thread; false, without running it, when
    // kMaxQueued jobs wait already.
    bool Submit(std::function<void()> job);
    boost::asio::any_io_executor Executor();
    // Ends the thread; a job not yet started is dropped.
    void Stop();

    // On the library's thread only. Throw LibraryError, ToolError (no tag
    // to write) and UsageError (a value the tag's type does not take).
    std::string ListJson(const std::string& pattern, uint32_t skip, uint32_t take) const;
    Reading Read(const std::vector<std::string>& paths) const;
    std::string WriteJson(const std::string& path, const std::string& value) const;

private:
    const ConsoleInstance& instance_;
    boost::asio::thread_pool thread_{1};
    std::atomic<std::size_t> queued_{0};
};

}  // namespace kvtag::serve
