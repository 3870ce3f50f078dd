#pragma once

#include <pybind11/pybind11.h>

#include <cstdint>
#include <memory>
#include <mutex>
#include <optional>
#include <shared_mutex>
#include <string>
#include <vector>

#include "Status.h"

namespace kvveldra_python {

class TagHandle;

// What a Client is constructed with; empty members take the library's defaults.
struct InstanceSettings {
    uint64_t instance = 0;
    std::optional<std::string> configuration;
    std::optional<uint32_t> timeoutMs;
    std::optional<bool> allowFallback;
};

// The state behind one kvveldra.Client: the reservation and one initialized
// console instance, which no other open Client of the process shares, and the
// tags opened through it. Calls run under a shared lock and Close under an
// exclusive one, so that a close waits for the calls in flight and no call
// starts after it; neither holds the GIL while it waits.
class Session : public std::enable_shared_from_this<Session> {
public:
    // Reserves and initializes the instance, without the GIL; raises
    // kvveldra.Error when either fails, and ValueError when another open
    // Client has the instance.
    explicit Session(const InstanceSettings& settings);
    // Closes what Close would, when it was not called.
    ~Session();
    Session(const Session&) = delete;
    Session& operator=(const Session&) = delete;

    uint64_t Instance() const { return instance_; }
    bool Closed() const;

    // Runs call(error) -> status without the GIL, unless the session is
    // closed, which raises kvveldra.ClosedError. Call with the GIL held; call
    // must not touch Python.
    template <typename Call>
    int32_t Run(std::string& error, Call&& call) const {
        bool closed = false;
        int32_t status = 0;
        {
            pybind11::gil_scoped_release release;
            std::shared_lock lock(mutex_);
            closed = closed_;
            if (!closed) status = call(error);
        }
        if (closed) RaiseClosed(ClosedText());
        return status;
    }
    // Run, raising kvveldra.Error for a status other than 0.
    template <typename Call>
    void Checked(Call&& call) const {
        std::string error;
        CheckStatus(Run(error, std::forward<Call>(call)), error);
    }

    // Keeps a tag opened through this session, to close it with the session.
    void Track(const std::shared_ptr<TagHandle>& tag);
    // Closes the tracked tags, the instance and the reservation; a second
    // call does nothing. Releases the GIL while it waits.
    void Close();
    std::string ClosedText() const;

private:
    void Shutdown();  // with the exclusive lock

    const uint64_t instance_;
    bool reserved_ = false;
    mutable std::shared_mutex mutex_;
    bool closed_ = false;
    std::mutex tagsMutex_;
    std::vector<std::weak_ptr<TagHandle>> tags_;
};

}  // namespace kvveldra_python
