#include "Session.h"

#include <kvveldra/TagConsole.h>

#include <algorithm>
#include <set>

#include "TagHandle.h"

namespace py = pybind11;

namespace kvveldra_python {
namespace {

// The instances that open Clients of this process hold: a second Client on
// one of them would close it under the first.
std::mutex gInstancesMutex;
std::set<uint64_t> gInstances;

bool ClaimInstance(uint64_t instance) {
    std::lock_guard lock(gInstancesMutex);
    return gInstances.insert(instance).second;
}

void ReleaseInstance(uint64_t instance) {
    std::lock_guard lock(gInstancesMutex);
    gInstances.erase(instance);
}

template <typename T>
const T* PointerTo(const std::optional<T>& value) {
    return value ? &*value : nullptr;
}

}  // namespace

Session::Session(const InstanceSettings& settings) : instance_(settings.instance) {
    if (!ClaimInstance(instance_)) {
        throw py::value_error("kvveldra: instance " + std::to_string(instance_) +
                              " belongs to another open Client of this process; close it first "
                              "or use another instance");
    }
    int32_t status = 0;
    std::string error;
    {
        py::gil_scoped_release release;
        status = TagConsoleReserve(&reserved_);
        if (status == 0) {
            status = TagConsoleInitialize(instance_, PointerTo(settings.configuration),
                                          PointerTo(settings.timeoutMs),
                                          PointerTo(settings.allowFallback), &error);
            // A failed initialize may leave an empty entry behind.
            std::string ignored;
            if (status != 0) TagConsoleCloseInstance(instance_, &ignored);
        }
        // A failed reservation stays counted: it is released all the same.
        if (status != 0) TagConsoleUnreserve(&reserved_);
    }
    if (status != 0) {
        ReleaseInstance(instance_);
        RaiseStatus(status, error);
    }
}

Session::~Session() {
    std::unique_lock lock(mutex_);
    Shutdown();
}

bool Session::Closed() const {
    std::shared_lock lock(mutex_);
    return closed_;
}

void Session::Track(const std::shared_ptr<TagHandle>& tag) {
    std::lock_guard lock(tagsMutex_);
    tags_.erase(std::remove_if(tags_.begin(), tags_.end(),
                               [](const std::weak_ptr<TagHandle>& t) { return t.expired(); }),
                tags_.end());
    tags_.push_back(tag);
}

void Session::Close() {
    py::gil_scoped_release release;
    std::unique_lock lock(mutex_);
    Shutdown();
}

void Session::Shutdown() {
    if (closed_) return;
    closed_ = true;
    {
        std::lock_guard lock(tagsMutex_);
        for (const auto& weak : tags_) {
            if (const auto tag = weak.lock()) tag->CloseReference();
        }
        tags_.clear();
    }
    // Instance 0 lives until the last unreserve (status 1 here).
    std::string ignored;
    TagConsoleCloseInstance(instance_, &ignored);
    TagConsoleUnreserve(&reserved_);
    ReleaseInstance(instance_);
}

std::string Session::ClosedText() const {
    return "kvveldra: the Client of instance " + std::to_string(instance_) +
           " is closed; make a new Client";
}

}  // namespace kvveldra_python
